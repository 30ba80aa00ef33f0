#include "platform/feeds/http/RetryPauses.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

constexpr double Now = 784111777; // Sun, 06 Nov 1994 08:49:37 GMT

TEST(RetryDelay, SecondsAreTakenAsTheyStand) {
    EXPECT_EQ(retryDelay("120", "", Now), 120);
    EXPECT_EQ(retryDelay("0", "", Now), 0);
}

TEST(RetryDelay, DatesCountFromTheServersOwnDate) {
    EXPECT_EQ(retryDelay("Sun, 06 Nov 1994 09:00:00 GMT", "Sun, 06 Nov 1994 08:59:00 GMT", 5), 60);
}

TEST(RetryDelay, WithoutTheServersDateTheyCountFromNow) {
    EXPECT_EQ(retryDelay("Sun, 06 Nov 1994 08:50:37 GMT", "", Now), 60);
    EXPECT_EQ(retryDelay("Sun, 06 Nov 1994 08:50:37 GMT", "yesterday", Now), 60);
}

TEST(RetryDelay, PastDatesAreNoDelay) {
    EXPECT_EQ(retryDelay("Sun, 06 Nov 1994 08:00:00 GMT", "", Now), 0);
}

TEST(RetryDelay, IsADayAtMost) {
    EXPECT_EQ(retryDelay("100000", "", Now), RetryPauses::Longest);
    EXPECT_EQ(retryDelay("99999999999999999999999", "", Now), RetryPauses::Longest);
    EXPECT_EQ(retryDelay("Sun, 06 Nov 2094 08:00:00 GMT", "", Now), RetryPauses::Longest);
}

TEST(RetryDelay, OtherWordsAreNothing) {
    EXPECT_EQ(retryDelay("", "", Now), std::nullopt);
    EXPECT_EQ(retryDelay("soon", "", Now), std::nullopt);
    EXPECT_EQ(retryDelay("-5", "", Now), std::nullopt);
    EXPECT_EQ(retryDelay("1.5", "", Now), std::nullopt);
}

TEST(RetryPauses, PendUntilTheirEnd) {
    RetryPauses pauses;
    EXPECT_FALSE(pauses.pending("a", 0));
    pauses.note("a", 60, 503, 1000);
    const auto pause = pauses.pending("a", 1059);
    ASSERT_TRUE(pause);
    EXPECT_EQ(pause->seconds, 1);
    EXPECT_EQ(pause->status, 503);
    EXPECT_FALSE(pauses.pending("b", 1059));
    EXPECT_FALSE(pauses.pending("a", 1060));
}

TEST(RetryPauses, TheLastWordHolds) {
    RetryPauses pauses;
    pauses.note("a", 60, 503, 1000);
    pauses.note("a", 10, 429, 1000);
    EXPECT_FALSE(pauses.pending("a", 1010));
}

} // namespace
} // namespace orvo
