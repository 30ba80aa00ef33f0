#include "platform/feeds/alerts/IncidentDates.h"

#include <gtest/gtest.h>

namespace orvo::testing {

TEST(IncidentDates, AreThoseOfTheirSecondsWhateverWasAskedBefore) {
    IncidentDates dates;
    for (int round = 0; round < 2; ++round)
        for (std::int64_t seconds = -500; seconds < 500; ++seconds)
            ASSERT_EQ(dates.date(seconds)->timeIntervalSince1970(), static_cast<double>(seconds));
}

TEST(IncidentDates, LikeDatesInARowAreOneObject) {
    IncidentDates dates;
    const auto first = dates.date(1750000000);
    EXPECT_EQ(dates.date(1750000000), first);
    EXPECT_NE(dates.date(1750000001), first);
}

TEST(IncidentDates, TheFirstMomentOfTheCountIsADateAsWell) {
    IncidentDates dates;
    ASSERT_NE(dates.date(0), nullptr);
    EXPECT_EQ(dates.date(0)->timeIntervalSince1970(), 0);
}

} // namespace orvo::testing
