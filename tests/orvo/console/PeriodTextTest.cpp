#include "orvo/console/PeriodText.h"

#include "platform/foundation/ISO8601.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Text.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

double at(const char* time) {
    return ISO8601::parse(time).value();
}

class PeriodTextTest : public ::testing::Test {
protected:
    std::string period(std::optional<double> start, std::optional<double> end) const {
        return PeriodText::period(start, end, now, "Europe/Berlin");
    }

    EnvironmentSlot<std::string>::Override language = Text::locale().overrideWith("de");
    double now = at("2024-07-24T10:00:00Z");
};

TEST_F(PeriodTextTest, DatesAreSecondsSince1970AndNilIsNone) {
    EXPECT_EQ(PeriodText::secondsOf(NSDate::dateWithTimeIntervalSince1970(1234.5)), 1234.5);
    EXPECT_EQ(PeriodText::secondsOf(nullptr), std::nullopt);
}

TEST_F(PeriodTextTest, UsesTheClockOfThePlace) {
    EXPECT_EQ(period({}, at("2024-07-24T12:30:00Z")), "until 14:30");
    EXPECT_EQ(PeriodText::moment(at("2024-07-24T12:30:00Z"), now, "America/New_York"), "08:30");
}

TEST_F(PeriodTextTest, AnUnknownPlaceIsTheMachines) {
    EXPECT_EQ(PeriodText::moment(now, now, "Nowhere/Town"),
              PeriodText::moment(now, now, std::nullopt));
}

TEST_F(PeriodTextTest, SaysWhatIsKnownOfBothEnds) {
    const double start = at("2024-07-24T09:00:00Z");
    const double end = at("2024-07-24T11:00:00Z");
    EXPECT_EQ(period(start, end), "since 11:00, until 13:00");
    EXPECT_EQ(period(start, {}), "since 11:00");
    EXPECT_EQ(period({}, {}), "until further notice");
}

TEST_F(PeriodTextTest, AComingPeriodIsAnnounced) {
    const double start = at("2024-07-24T11:00:00Z");
    EXPECT_EQ(period(start, at("2024-07-24T12:00:00Z")), "13:00 – 14:00");
    EXPECT_EQ(period(start, {}), "from 13:00");
    now = start;
    EXPECT_EQ(period(start, {}), "since 13:00");
}

TEST_F(PeriodTextTest, NamesTheDayAndTheYearOnlyWhereTheyDiffer) {
    EXPECT_EQ(period({}, at("2024-07-25T12:30:00Z")), "until 25. Juli, 14:30");
    EXPECT_EQ(period({}, at("2025-01-02T12:30:00Z")), "until 2. Jan. 2025, 13:30");
    // Another day there, the same day in UTC.
    EXPECT_EQ(period({}, at("2024-07-24T22:30:00Z")), "until 25. Juli, 00:30");
}

TEST_F(PeriodTextTest, WordsChangeWhenItBeginsAndAtMidnightOfThePlace) {
    const auto change = [&](std::optional<double> start, std::optional<double> end) {
        return PeriodText::nextChange(start, end, now, "Europe/Berlin");
    };
    const double midnight = at("2024-07-24T22:00:00Z");
    EXPECT_EQ(change(now + 60, now + 120), now + 60);
    EXPECT_EQ(change(now, now + 120), midnight);
    EXPECT_EQ(change({}, now + 120), midnight);
    EXPECT_EQ(change(midnight + 60, {}), midnight);
    EXPECT_EQ(change({}, {}), std::nullopt);
    now = midnight;
    EXPECT_EQ(change(now - 60, {}), midnight + 86400);
}

TEST_F(PeriodTextTest, ADayIsAsLongAsItIsThere) {
    const auto midnightAfter = [](const char* time) {
        return PeriodText::nextChange(std::nullopt, 0, at(time), "Europe/Berlin");
    };
    EXPECT_EQ(midnightAfter("2024-03-30T23:30:00Z"), at("2024-03-31T22:00:00Z"));
    EXPECT_EQ(midnightAfter("2024-10-26T22:30:00Z"), at("2024-10-27T23:00:00Z"));
}

TEST_F(PeriodTextTest, AgesAreTheLargestWholeUnit) {
    EXPECT_EQ(PeriodText::age(59), "less than a minute");
    EXPECT_EQ(PeriodText::age(60), "1 minute");
    EXPECT_EQ(PeriodText::age(3599), "59 minutes");
    EXPECT_EQ(PeriodText::age(7200), "2 hours");
    EXPECT_EQ(PeriodText::age(200000), "2 days");
}

} // namespace
} // namespace orvo
