#include "platform/foundation/TimerSchedule.h"

#include "platform/foundation/NSTimer.h"

#include <gtest/gtest.h>

#include <limits>

namespace orvo {
namespace {

class TimerScheduleTest : public ::testing::Test {
protected:
    int changes = 0;
    TimerSchedule schedule{[this] {
        ++changes;
    }};
    std::shared_ptr<NSTimer> a = std::make_shared<NSTimer>();
    std::shared_ptr<NSTimer> b = std::make_shared<NSTimer>();
};

TEST_F(TimerScheduleTest, WakesWhenTheFirstToleranceIsUsedUp) {
    EXPECT_EQ(schedule.nextWake(), std::nullopt);
    schedule.put(a, 10, 5);
    EXPECT_EQ(schedule.nextWake(), 15);
    schedule.put(b, 12, 0);
    EXPECT_EQ(schedule.nextWake(), 12);
}

TEST_F(TimerScheduleTest, NamesTheEarliestTimerWhoseDateHasPassed) {
    schedule.put(b, 12, 0);
    schedule.put(a, 10, 0);
    const auto all = schedule.nextNumber();
    EXPECT_EQ(schedule.firstDue(10, all), nullptr);
    EXPECT_EQ(schedule.firstDue(13, all), a);
    schedule.remove(*a);
    EXPECT_EQ(schedule.firstDue(13, all), b);
}

TEST_F(TimerScheduleTest, LeavesOutTimersPutInSinceTheNumberWasTaken) {
    const auto before = schedule.nextNumber();
    schedule.put(a, 10, 0);
    EXPECT_EQ(schedule.firstDue(11, before), nullptr);
    const auto between = schedule.nextNumber();
    schedule.put(b, 5, 0);
    EXPECT_EQ(schedule.firstDue(11, between), a);
    schedule.put(a, 10, 0);
    EXPECT_EQ(schedule.firstDue(11, between), nullptr);
}

TEST_F(TimerScheduleTest, MovesATimerThatIsThere) {
    schedule.put(a, 10, 0);
    schedule.put(a, 20, 0);
    EXPECT_EQ(schedule.count(), 1U);
    EXPECT_EQ(schedule.nextWake(), 20);
}

TEST_F(TimerScheduleTest, NeverReachesADateThatIsNoNumber) {
    schedule.put(a, std::numeric_limits<double>::quiet_NaN(), 0);
    EXPECT_EQ(schedule.firstDue(std::numeric_limits<double>::max(), schedule.nextNumber()),
              nullptr);
}

TEST_F(TimerScheduleTest, TellsOfEveryChange) {
    schedule.put(a, 10, 0);
    schedule.remove(*b);
    EXPECT_EQ(changes, 1);
    schedule.remove(*a);
    EXPECT_EQ(changes, 2);
}

TEST_F(TimerScheduleTest, KeepsItsTimersAlive) {
    const std::weak_ptr<NSTimer> watch = a;
    schedule.put(a, 10, 0);
    a.reset();
    EXPECT_FALSE(watch.expired());
    (void)schedule.takeAll();
    EXPECT_TRUE(watch.expired());
    EXPECT_EQ(schedule.count(), 0U);
}

} // namespace
} // namespace orvo
