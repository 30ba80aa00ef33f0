#include "platform/demo/DemoIncidents.h"

#include "platform/demo/DemoCity.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

namespace orvo {
namespace {

constexpr double Written = 1750000000;

const DemoIncident* find(const std::vector<DemoIncident>& incidents, const std::string& id) {
    const auto found = std::ranges::find(incidents, id, &DemoIncident::id);
    return found == incidents.end() ? nullptr : &*found;
}

bool isCurrent(const DemoIncident& incident, double now) {
    return incident.periods.empty() ||
           std::ranges::any_of(incident.periods, [&](const auto& period) {
               return period.start.value_or(now) <= now && period.end.value_or(now + 1) > now;
           });
}

TEST(DemoIncidents, ShowEveryKindWhenTheyAreWritten) {
    std::size_t current = 0;
    std::size_t coming = 0;
    std::size_t endsSoon = 0;
    std::size_t beginsSoon = 0;
    std::size_t shared = 0;
    for (const auto& incident : DemoIncidents::around(Written)) {
        current += static_cast<std::size_t>(isCurrent(incident, Written));
        shared += static_cast<std::size_t>(incident.selectors.size() > 1);
        for (const auto& period : incident.periods) {
            coming +=
                static_cast<std::size_t>(period.start > Written && *period.start < Written + 86400);
            beginsSoon +=
                static_cast<std::size_t>(period.start > Written && *period.start < Written + 180);
            endsSoon +=
                static_cast<std::size_t>(period.end > Written && *period.end < Written + 180);
        }
    }
    EXPECT_GE(current, 4U);
    EXPECT_GE(coming, 3U);
    EXPECT_EQ(endsSoon, 1U);
    EXPECT_EQ(beginsSoon, 1U);
    EXPECT_GE(shared, 2U);
}

TEST(DemoIncidents, AtLeastThreeOfTheVisitorsLinesAreDisturbedAndOneIsNotUntilTheyAreWrittenAnew) {
    for (const double after : {0.0, DemoIncidents::LifetimeSeconds - 1}) {
        const double now = Written + after;
        std::set<std::string> disturbed;
        for (const auto& incident : DemoIncidents::around(Written)) {
            if (isCurrent(incident, now))
                for (const auto& selector : incident.selectors)
                    disturbed.insert(selector.routeId);
        }
        const auto& favorites = DemoCity::favoriteRouteIds();
        const auto count = std::ranges::count_if(
            favorites, [&](const auto& route) { return disturbed.contains(route); });
        EXPECT_GE(count, 3) << after;
        EXPECT_LT(static_cast<std::size_t>(count), favorites.size()) << after;
    }
}

TEST(DemoIncidents, NameOnlyLinesStopsAndAgenciesOfTheCity) {
    for (const auto& incident : DemoIncidents::around(Written)) {
        EXPECT_FALSE(incident.header.english.empty());
        EXPECT_NE(incident.header.english, incident.header.german);
        for (const auto& [agency, route, stop] : incident.selectors) {
            EXPECT_TRUE(agency.empty() ||
                        std::ranges::count(DemoCity::agencies(), agency, &DemoCity::Agency::id));
            EXPECT_TRUE(route.empty() ||
                        std::ranges::count(DemoCity::lines(), route, &DemoCity::Line::routeId));
            EXPECT_TRUE(stop.empty() ||
                        std::ranges::count(DemoCity::stops(), stop, &DemoCity::Stop::id));
        }
    }
}

TEST(LiveIncidents, ComeAndGoWithinACycle) {
    const auto at = [](double elapsed) {
        return DemoIncidents::live(Written, Written + elapsed);
    };
    EXPECT_EQ(find(at(0), "signals"), nullptr);
    EXPECT_NE(find(at(30), "signals"), nullptr);
    EXPECT_EQ(find(at(120), "signals"), nullptr);
    EXPECT_EQ(find(at(89), "storm"), nullptr);
    EXPECT_NE(find(at(90), "storm"), nullptr);
    EXPECT_EQ(find(at(210), "storm"), nullptr);
}

TEST(LiveIncidents, OneIsAnnouncedAndBeginsAndEndsByItself) {
    const auto incidents = DemoIncidents::live(Written, Written);
    const auto* works = find(incidents, "track-works");
    ASSERT_NE(works, nullptr);
    EXPECT_FALSE(isCurrent(*works, Written));
    EXPECT_TRUE(isCurrent(*works, Written + 61));
    EXPECT_FALSE(isCurrent(*works, Written + 181));
}

TEST(LiveIncidents, BeginAgainAfterACycle) {
    const double later = DemoIncidents::LiveCycleSeconds;
    EXPECT_NE(find(DemoIncidents::live(Written, Written + later + 30), "signals"), nullptr);
    const auto incidents = DemoIncidents::live(Written, Written + later);
    EXPECT_EQ(find(incidents, "track-works")->periods.front().start, Written + later + 60);
}

TEST(LiveIncidents, AClockThatWentBackIsTheBeginning) {
    EXPECT_EQ(find(DemoIncidents::live(Written, Written - 5000), "signals"), nullptr);
}

} // namespace
} // namespace orvo
