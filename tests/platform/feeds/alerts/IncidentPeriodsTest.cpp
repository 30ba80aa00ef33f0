#include "platform/feeds/alerts/IncidentPeriods.h"

#include "TestLines.h"

#include <gtest/gtest.h>

#include <ostream>

namespace orvo {

void PrintTo(const IncidentPeriod& period, std::ostream* out) {
    const auto side = [](const std::optional<std::int64_t>& seconds) {
        return seconds ? std::to_string(*seconds) : std::string("open");
    };
    *out << '[' << side(period.start) << ", " << side(period.end) << ']';
}

} // namespace orvo

namespace orvo::testing {

namespace {

using Periods = std::vector<IncidentPeriod>;

constexpr std::int64_t At = 1750000000;
constexpr std::optional<std::int64_t> Open;

std::optional<IncidentPeriod> published(std::optional<std::uint64_t> start,
                                        std::optional<std::uint64_t> end) {
    return IncidentPeriods::fromPublished({start, end});
}

Periods shown(Periods periods, double now = At) {
    IncidentPeriods::keepCurrentAndComing(periods, now);
    return periods;
}

Periods ofAlert(const Alert& alert) {
    Periods periods = {{7, 8}}; // what is there stays
    IncidentPeriods::addOfAlert(alert, periods);
    EXPECT_EQ(periods.front(), (IncidentPeriod{7, 8}));
    periods.erase(periods.begin());
    return periods;
}

} // namespace

TEST(IncidentPeriods, MissingAndZeroSidesAreOpen) {
    EXPECT_EQ(published(std::nullopt, std::nullopt), (IncidentPeriod{Open, Open}));
    EXPECT_EQ(published(0, 0), (IncidentPeriod{Open, Open}));
    EXPECT_EQ(published(5, std::nullopt), (IncidentPeriod{5, Open}));
    EXPECT_EQ(published(5, 0), (IncidentPeriod{5, Open}));
    EXPECT_EQ(published(std::nullopt, 5), (IncidentPeriod{Open, 5}));
}

TEST(IncidentPeriods, ValuesAbove100000000000AreMilliseconds) {
    EXPECT_EQ(published(1749999990999, 1750000010000), (IncidentPeriod{1749999990, 1750000010}));
    EXPECT_EQ(published(1, 100'000'000'000), (IncidentPeriod{1, 100'000'000'000}));
    EXPECT_EQ(published(1, 100'000'000'001), (IncidentPeriod{1, 100'000'000}));
}

TEST(IncidentPeriods, EndsAfterTheYear9999AreOpen) {
    EXPECT_EQ(published(1, ~0ULL), (IncidentPeriod{1, Open}));
    EXPECT_EQ(published(1, 253'402'300'800'000), (IncidentPeriod{1, Open}));
    EXPECT_EQ(published(1, 253'402'300'799'000), (IncidentPeriod{1, 253'402'300'799}));
}

TEST(IncidentPeriods, TheLastYearInSecondsIsOpenToo) {
    EXPECT_EQ(published(1, 253'402'300'799), (IncidentPeriod{1, Open}));
    EXPECT_EQ(published(1, 253'370'764'800), (IncidentPeriod{1, Open}));
    EXPECT_EQ(published(1, 253'402'300'800), (IncidentPeriod{1, Open})); // at its very end
    EXPECT_EQ(published(1, 253'402'300'799 + 12 * 3600), (IncidentPeriod{1, Open}));
}

TEST(IncidentPeriods, NegativeSidesAreOpen) {
    constexpr auto firstYear = static_cast<std::uint64_t>(-62'135'596'800); // of our calendar
    EXPECT_EQ(published(~0ULL, ~0ULL), (IncidentPeriod{Open, Open}));
    EXPECT_EQ(published(firstYear, 5), (IncidentPeriod{Open, 5}));
    EXPECT_EQ(published(5, firstYear), (IncidentPeriod{5, Open}));
}

TEST(IncidentPeriods, EmptyOnesAndThoseThatNeverBeginAreNone) {
    EXPECT_EQ(published(10, 10), std::nullopt);
    EXPECT_EQ(published(10, 9), std::nullopt);
    EXPECT_EQ(published(253'402'300'800'000, 0), std::nullopt);
    EXPECT_EQ(published(~0ULL >> 1U, 0), std::nullopt);
}

TEST(IncidentPeriods, ImpactComesBeforeCommunicationBeforeActive) {
    Alert alert;
    alert.activePeriods = {{1, 2}};
    EXPECT_EQ(ofAlert(alert), (Periods{{1, 2}}));
    alert.communicationPeriods = {{3, 4}};
    EXPECT_EQ(ofAlert(alert), (Periods{{3, 4}}));
    alert.impactPeriods = {{5, 6}};
    EXPECT_EQ(ofAlert(alert), (Periods{{5, 6}}));
    alert.communicationPeriods.clear();
    EXPECT_EQ(ofAlert(alert), (Periods{{5, 6}}));
}

TEST(IncidentPeriods, WithoutAnyItHoldsAsLongAsItIsInTheFeed) {
    EXPECT_EQ(ofAlert(Alert{}), (Periods{{Open, Open}}));
}

TEST(IncidentPeriods, OnlyEmptyOnesMeanNever) {
    Alert alert;
    alert.activePeriods = {{10, 9}};
    EXPECT_TRUE(ofAlert(alert).empty());
}

TEST(IncidentPeriods, TheEarliestStartIsOfThePeriodsThatCount) {
    Alert alert;
    EXPECT_EQ(IncidentPeriods::earliestStart(alert), std::nullopt);
    alert.activePeriods = {{30, 40}, {20, 25}};
    EXPECT_EQ(IncidentPeriods::earliestStart(alert), 20);
    alert.impactPeriods = {{50, 60}};
    EXPECT_EQ(IncidentPeriods::earliestStart(alert), 50);
    alert.communicationPeriods = {{45, 60}};
    EXPECT_EQ(IncidentPeriods::earliestStart(alert), 45);
}

TEST(IncidentPeriods, OneThatIsOverIsDroppedAndOneThatEndsNowIsNot) {
    EXPECT_EQ(shown({{1, At - 1}}), Periods{});
    EXPECT_EQ(shown({{1, At}}), (Periods{{1, At}}));
    EXPECT_EQ(shown({{1, At}}, At + 0.5), Periods{});
}

TEST(IncidentPeriods, OneThatBeginsWithinADayIsShownAndLaterOnesAreNot) {
    EXPECT_EQ(shown({{At + 86400, Open}}), (Periods{{At + 86400, Open}}));
    EXPECT_EQ(shown({{At + 86401, Open}}), Periods{});
}

TEST(IncidentPeriods, AreSorted) {
    EXPECT_EQ(shown({{At + 500, At + 600}, {Open, At + 10}, {At + 200, At + 300}}),
              (Periods{{Open, At + 10}, {At + 200, At + 300}, {At + 500, At + 600}}));
}

TEST(IncidentPeriods, ThoseThatOverlapTouchOrLieLessThanAMinuteApartAreJoined) {
    EXPECT_EQ(shown({{At, At + 100}, {At + 50, At + 200}}), (Periods{{At, At + 200}}));
    EXPECT_EQ(shown({{At, At + 100}, {At + 20, At + 30}}), (Periods{{At, At + 100}}));
    EXPECT_EQ(shown({{At, At + 100}, {At + 100, At + 200}}), (Periods{{At, At + 200}}));
    EXPECT_EQ(shown({{At, At + 100}, {At + 159, At + 200}}), (Periods{{At, At + 200}}));
    EXPECT_EQ(shown({{At, At + 100}, {At + 160, At + 200}}),
              (Periods{{At, At + 100}, {At + 160, At + 200}}));
}

TEST(IncidentPeriods, AnOpenEndSwallowsAllThatFollows) {
    EXPECT_EQ(shown({{At, Open}, {At + 500, At + 600}}), (Periods{{At, Open}}));
    EXPECT_EQ(shown({{At, At + 600}, {At + 500, Open}}), (Periods{{At, Open}}));
    EXPECT_EQ(shown({{Open, At + 5}, {Open, Open}}), (Periods{{Open, Open}}));
}

TEST(IncidentPeriods, OneThatIsOverJoinsNothing) {
    EXPECT_EQ(shown({{At - 50, At - 10}, {At + 20, At + 90}}), (Periods{{At + 20, At + 90}}));
}

TEST(IncidentPeriods, NoTwoAreEverCurrentTogether) {
    const Periods periods = shown({{At, At + 60},
                                   {At + 60, At + 90},
                                   {At + 200, At + 260},
                                   {At + 10, At + 80},
                                   {At + 261, At + 300}});
    for (std::int64_t now = At; now < At + 320; ++now) {
        int current = 0;
        for (const IncidentPeriod& period : periods)
            current += IncidentPeriods::isCurrent(period, static_cast<double>(now)) ? 1 : 0;
        EXPECT_LE(current, 1) << now - At;
    }
}

} // namespace orvo::testing
