#include "platform/foundation/KernelTimer.h"

#include <gtest/gtest.h>

#include <limits>
#include <poll.h>
#include <sys/timerfd.h>

namespace orvo {
namespace {

bool readableWithin(const KernelTimer& timer, int milliseconds) {
    pollfd watched{timer.fileDescriptor(), POLLIN, 0};
    return poll(&watched, 1, milliseconds) == 1;
}

double secondsLeft(const KernelTimer& timer) {
    itimerspec alarm{};
    timerfd_gettime(timer.fileDescriptor(), &alarm);
    return static_cast<double>(alarm.it_value.tv_sec) +
           static_cast<double>(alarm.it_value.tv_nsec) * 1e-9;
}

TEST(KernelTimer, GoesOffAndIsQuietOnceAcknowledged) {
    KernelTimer timer;
    timer.armIn(0.0001);
    EXPECT_TRUE(readableWithin(timer, 30000));
    timer.acknowledge();
    EXPECT_FALSE(readableWithin(timer, 0));
}

TEST(KernelTimer, GoesOffAtOnceForWhatIsPast) {
    KernelTimer timer;
    timer.armIn(-1e300);
    EXPECT_TRUE(readableWithin(timer, 30000));
}

TEST(KernelTimer, StaysArmedForDatesBeyondAllReckoning) {
    KernelTimer timer;
    for (const double seconds :
         {std::numeric_limits<double>::max(), std::numeric_limits<double>::infinity()}) {
        timer.armIn(seconds);
        EXPECT_GT(secondsLeft(timer), 9e8);
    }
}

TEST(KernelTimer, CarriesANearlyWholeSecondOver) {
    KernelTimer timer;
    for (const double seconds : {59.9999999999, 60.0, 60.5}) {
        timer.armIn(seconds);
        EXPECT_NEAR(secondsLeft(timer), seconds, 5);
    }
}

TEST(KernelTimer, IsQuietOnceDisarmed) {
    KernelTimer timer;
    timer.armIn(0);
    timer.disarm();
    EXPECT_FALSE(readableWithin(timer, 0));
    EXPECT_EQ(secondsLeft(timer), 0);
}

} // namespace
} // namespace orvo
