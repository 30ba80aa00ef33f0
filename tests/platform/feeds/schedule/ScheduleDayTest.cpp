#include "platform/feeds/schedule/ScheduleDay.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(ScheduleDay, EndsAtMidnightOfItsZone) {
    EXPECT_EQ(endOfDay("2024-12-31", "UTC"), 1735689600);
    EXPECT_EQ(endOfDay("2024-12-31", "America/New_York"), 1735689600 + 5 * 3600);
    EXPECT_EQ(endOfDay("2024-02-28", "UTC"), 1709164800);
}

TEST(ScheduleDay, AnUnknownZoneCountsAsUtc) {
    EXPECT_EQ(endOfDay("2024-12-31", "Nowhere/City"), 1735689600);
    EXPECT_EQ(endOfDay("2024-12-31", ""), 1735689600);
}

TEST(ScheduleDay, NoDateHasNoEnd) {
    EXPECT_FALSE(endOfDay("", "UTC"));
    EXPECT_FALSE(endOfDay("2024-12-3x", "UTC"));
}

} // namespace
} // namespace orvo
