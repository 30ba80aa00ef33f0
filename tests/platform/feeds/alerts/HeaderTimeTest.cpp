#include "platform/feeds/alerts/HeaderTime.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {
constexpr double Now = 1750000000;
constexpr double Fetched = Now - 30;
} // namespace

TEST(HeaderTime, IsTheTimestamp) {
    EXPECT_EQ(headerTime(1749999000, Fetched, Now), 1749999000);
    EXPECT_EQ(headerTime(1750000000, Fetched, Now), Now);
}

TEST(HeaderTime, ZeroAndTheFutureAreReplacedByTheTimeOfFetching) {
    EXPECT_EQ(headerTime(0, Fetched, Now), Fetched);
    EXPECT_EQ(headerTime(1750000001, Fetched, Now), Fetched);
    EXPECT_EQ(headerTime(~0ULL, Fetched, Now), Fetched);
}

TEST(HeaderTime, MoreThanADayAgoTellsNothing) {
    EXPECT_EQ(headerTime(1750000000 - 86400, Fetched, Now), Now - 86400);
    EXPECT_EQ(headerTime(1750000000 - 86401, Fetched, Now), std::nullopt);
    EXPECT_EQ(headerTime(1, Fetched, Now), std::nullopt);
}

TEST(HeaderTime, MillisecondsAreRead) {
    EXPECT_EQ(headerTime(1749999000999, Fetched, Now), 1749999000);
    EXPECT_EQ(wholeSeconds(100'000'000'000), 100'000'000'000U);
    EXPECT_EQ(wholeSeconds(100'000'000'001), 100'000'000U);
}

} // namespace orvo::testing
