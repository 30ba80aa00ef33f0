#include "shared/NSDate_OrvoSharedExtras.h"

#include <gtest/gtest.h>

#include <limits>

namespace orvo {
namespace {

using OrvoSharedExtras::_orvo_timeIntervalRoundedToMinutesFromTimeInterval;

double rounded(double seconds) {
    return _orvo_timeIntervalRoundedToMinutesFromTimeInterval(seconds);
}

TEST(RoundedToMinutes, TakesTheNearestMinute) {
    EXPECT_EQ(rounded(0), 0);
    EXPECT_EQ(rounded(29.99), 0);
    EXPECT_EQ(rounded(89.9), 60);
    EXPECT_EQ(rounded(60), 60);
    EXPECT_EQ(rounded(-29.99), 0);
    EXPECT_EQ(rounded(-89.9), -60);
}

TEST(RoundedToMinutes, TakesHalvesAwayFromZero) {
    EXPECT_EQ(rounded(30), 60);
    EXPECT_EQ(rounded(90), 120);
    EXPECT_EQ(rounded(150), 180);
    EXPECT_EQ(rounded(-30), -60);
    EXPECT_EQ(rounded(-90), -120);
}

TEST(RoundedToMinutes, StopsAtTheLimitsOf32Bits) {
    EXPECT_EQ(rounded(1e12), 128849018820.0);
    EXPECT_EQ(rounded(-1e12), -128849018880.0);
    EXPECT_EQ(rounded(128849018820.0), 128849018820.0);
    EXPECT_EQ(rounded(128849018820.0 - 60), 128849018760.0);
    EXPECT_EQ(rounded(std::numeric_limits<double>::infinity()), 128849018820.0);
    EXPECT_EQ(rounded(-std::numeric_limits<double>::infinity()), -128849018880.0);
}

TEST(RoundedToMinutes, OfNotANumberIsZero) {
    EXPECT_EQ(rounded(std::numeric_limits<double>::quiet_NaN()), 0);
}

} // namespace
} // namespace orvo
