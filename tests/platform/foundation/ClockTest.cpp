#include "platform/foundation/Clock.h"

#include "platform/foundation/NSDate.h"

#include <gtest/gtest.h>

#include <ctime>

namespace orvo {
namespace {

TEST(WallClock, OfTheMachineShowsItsTimeOfDay) {
    const auto clock = WallClock::system();
    timespec before{};
    clock_gettime(CLOCK_REALTIME, &before);
    const double shown = clock->timeIntervalSinceReferenceDate() + NSTimeIntervalSince1970;
    timespec after{};
    clock_gettime(CLOCK_REALTIME, &after);
    EXPECT_GE(shown, static_cast<double>(before.tv_sec));
    EXPECT_LE(shown, static_cast<double>(after.tv_sec) + 1);
}

TEST(WallClock, StandsStillWhereAsked) {
    const auto clock = WallClock::standingAt(-12.5);
    EXPECT_EQ(clock->timeIntervalSinceReferenceDate(), -12.5);
    EXPECT_EQ(clock->timeIntervalSinceReferenceDate(), -12.5);
}

TEST(WallClock, RunsOnFromTheTimeGiven) {
    const auto clock = WallClock::startingAt(1000);
    const auto machine = MonotonicClock::system();
    const double first = clock->timeIntervalSinceReferenceDate();
    const double start = machine->seconds();
    EXPECT_GE(first, 1000);
    while (machine->seconds() - start < 0.001) {
    }
    EXPECT_GE(clock->timeIntervalSinceReferenceDate(), first + 0.0009);
    EXPECT_LT(clock->timeIntervalSinceReferenceDate(), 1060);
}

TEST(MonotonicClock, NeverGoesBack) {
    const auto clock = MonotonicClock::system();
    double last = clock->seconds();
    for (int i = 0; i < 1000; ++i) {
        const double now = clock->seconds();
        EXPECT_GE(now, last);
        last = now;
    }
}

} // namespace
} // namespace orvo
