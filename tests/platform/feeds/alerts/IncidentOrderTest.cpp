#include "platform/feeds/alerts/IncidentOrder.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace orvo::testing {

namespace {

struct Example {
    IncidentSeverity severity = IncidentSeverity::Warning;
    IncidentEffect effect = IncidentEffect::Detour;
    bool isPart = false;
    std::optional<double> start = 1000;
    std::uint64_t muid = 5;
    std::optional<double> end = 2000;

    std::shared_ptr<FeedTransitIncident> make() const {
        const auto date = [](std::optional<double> seconds) {
            return seconds ? NSDate::dateWithTimeIntervalSince1970(*seconds) : nullptr;
        };
        TransitIncidentRecord::Fields fields;
        fields.muid = muid;
        fields.startDate = date(start);
        fields.endDate = date(end);
        FeedTransitIncident::Details details;
        details.severity = severity;
        details.effect = effect;
        details.isPartOfLine = isPart;
        return FeedTransitIncident::initWithFields_details(fields, details);
    }
};

Example with(const std::function<void(Example&)>& change) {
    Example example;
    change(example);
    return example;
}

/// Each stands before all that follow it, and none before itself or one before it.
void expectOrder(const std::vector<Example>& examples) {
    for (std::size_t a = 0; a < examples.size(); ++a)
        for (std::size_t b = 0; b < examples.size(); ++b)
            EXPECT_EQ(standsBefore(*examples[a].make(), *examples[b].make()), a < b)
                << a << " " << b;
}

} // namespace

TEST(IncidentOrder, TheWorstSeverityIsFirstAndAnUntoldOneLast) {
    expectOrder({with([](auto& e) { e.severity = IncidentSeverity::Severe; }),
                 with([](auto& e) { e.severity = IncidentSeverity::Warning; }),
                 with([](auto& e) { e.severity = IncidentSeverity::Info; }),
                 with([](auto& e) { e.severity = IncidentSeverity::Unknown; })});
}

TEST(IncidentOrder, ThenTheEffectNoServiceFirst) {
    expectOrder({with([](auto& e) { e.effect = IncidentEffect::NoService; }),
                 with([](auto& e) { e.effect = IncidentEffect::ReducedService; }),
                 with([](auto& e) { e.effect = IncidentEffect::Detour; }),
                 with([](auto& e) { e.effect = IncidentEffect::StopMoved; })});
}

TEST(IncidentOrder, ThenTheWholeLineBeforePartOfIt) {
    expectOrder({with([](auto& e) { e.isPart = false; }), with([](auto& e) { e.isPart = true; })});
}

TEST(IncidentOrder, ThenTheNewestStartAndAnOpenOneLast) {
    expectOrder({with([](auto& e) { e.start = 1200; }),
                 with([](auto& e) { e.start = 1000; }),
                 with([](auto& e) { e.start = std::nullopt; })});
}

TEST(IncidentOrder, ThenTheNumberThenTheEnd) {
    expectOrder({with([](auto& e) { e.muid = 4; }),
                 with([](auto& e) { e.end = std::nullopt; }),
                 with([](auto& e) { e.end = 3000; }),
                 with([](auto& e) { e.end = 2000; }),
                 with([](auto& e) { e.muid = 1ULL << 63U; })});
}

TEST(IncidentOrder, EarlierRulesCountMoreThanLaterOnes) {
    expectOrder({with([](auto& e) {
                     e.severity = IncidentSeverity::Severe;
                     e.effect = IncidentEffect::StopMoved;
                 }),
                 with([](auto& e) {
                     e.effect = IncidentEffect::NoService;
                     e.isPart = true;
                 }),
                 with([](auto& e) { e.start = std::nullopt; }),
                 with([](auto& e) {
                     e.isPart = true;
                     e.start = 1900;
                     e.muid = 1;
                 })});
}

} // namespace orvo::testing
