#include "shared/NSTimer_OrvoSharedExtras.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/RunLoop.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <limits>
#include <memory>
#include <thread>

namespace orvo {
namespace {

using OrvoSharedExtras::_orvo_scheduledTimerWithFireDate_block;
using testing::StoppedClock;

constexpr double now = 1750000000;

class TimerWithFireDate : public ::testing::Test {
protected:
    void TearDown() override { timer->invalidate(); }
    void turnTo(double secondsSince1970) {
        clock->setSince1970(secondsSince1970);
        RunLoop::current().checkTimers();
    }

    RunLoop& _loop = RunLoop::main();
    StoppedClock clock{now};
    int fired = 0;
    std::shared_ptr<NSTimer> firedTimer;
    std::shared_ptr<NSTimer> timer = _orvo_scheduledTimerWithFireDate_block(
        NSDate::dateWithTimeIntervalSince1970(now + 600), [this](const auto& itself) {
            ++fired;
            firedTimer = itself;
        });
};

TEST_F(TimerWithFireDate, IsScheduledOnTheCurrentRunLoopWithTheGivenDate) {
    EXPECT_EQ(RunLoop::current().scheduledTimers(), 1U);
    EXPECT_TRUE(timer->isValid());
    EXPECT_FALSE(timer->repeats());
    EXPECT_EQ(timer->timeInterval(), 0); // as that of every timer that does not repeat
    EXPECT_EQ(timer->fireDate()->timeIntervalSince1970(), now + 600);
}

TEST_F(TimerWithFireDate, IsThatOfTheThreadThatAsks) {
    std::thread::id firedOn;
    std::thread::id asker;
    std::thread([&] {
        asker = std::this_thread::get_id();
        const auto other = _orvo_scheduledTimerWithFireDate_block(
            NSDate::dateWithTimeIntervalSince1970(now + 600),
            [&](const auto&) { firedOn = std::this_thread::get_id(); });
        EXPECT_EQ(RunLoop::current().scheduledTimers(), 1U);
        turnTo(now + 600.1);
        EXPECT_EQ(RunLoop::current().scheduledTimers(), 0U);
    }).join();
    EXPECT_EQ(firedOn, asker);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U);
    EXPECT_EQ(fired, 0);
}

TEST_F(TimerWithFireDate, DoesNotFireBeforeItsDate) {
    turnTo(now + 599.9);
    EXPECT_EQ(fired, 0);
}

TEST_F(TimerWithFireDate, FiresOnceAfterItsDateWithItselfAsTheArgument) {
    turnTo(now + 600.1);
    EXPECT_EQ(fired, 1);
    EXPECT_EQ(firedTimer, timer);
    EXPECT_FALSE(timer->isValid());
    turnTo(now + 6000);
    EXPECT_EQ(fired, 1);
}

TEST_F(TimerWithFireDate, ADatePassedIsReachedAtOnceButNotInsideTheCall) {
    int called = 0;
    const auto late = _orvo_scheduledTimerWithFireDate_block(
        NSDate::dateWithTimeIntervalSince1970(now - 1), [&](const auto&) { ++called; });
    EXPECT_EQ(called, 0);
    RunLoop::current().checkTimers();
    EXPECT_EQ(called, 1);
    EXPECT_FALSE(late->isValid());
}

/// Shows `now`, but when it is read first after a timer was scheduled: there it shows the last
/// moment that a clock can show, and the run loop looks at its timers.
class LeapingClock final : public WallClock {
public:
    double timeIntervalSinceReferenceDate() const override {
        if (!_leaping && !_hasLeapt && RunLoop::current().scheduledTimers() > 0) {
            _leaping = true;
            RunLoop::current().checkTimers();
            _leaping = false;
            _hasLeapt = true;
        }
        return _leaping ? std::numeric_limits<double>::max() : now - NSTimeIntervalSince1970;
    }
    [[nodiscard]] bool hasLeapt() const { return _hasLeapt; }

private:
    mutable bool _leaping = false;
    mutable bool _hasLeapt = false;
};

TEST_F(TimerWithFireDate, CannotFireBeforeItsDateIsSetHoweverFarTheClockLeapsUntilThen) {
    timer->invalidate(); // or its date would be passed too
    const auto leaping = std::make_shared<LeapingClock>();
    const auto leapingClock = Environment::wallClock().overrideWith(leaping);
    const auto date = NSDate::dateWithTimeIntervalSince1970(now + 600);
    int called = 0;
    timer = _orvo_scheduledTimerWithFireDate_block(date, [&](const auto&) { ++called; });
    EXPECT_TRUE(leaping->hasLeapt());
    EXPECT_EQ(called, 0);
    EXPECT_TRUE(timer->isValid());
    EXPECT_TRUE(equal(timer->fireDate(), date));
}

TEST_F(TimerWithFireDate, NeedsADateAndABlockAndSchedulesNothingWithoutThem) {
    EXPECT_THROW(_orvo_scheduledTimerWithFireDate_block(nullptr, [](const auto&) {}),
                 NSInvalidArgumentException);
    EXPECT_THROW(_orvo_scheduledTimerWithFireDate_block(timer->fireDate(), nullptr),
                 NSInvalidArgumentException);
    EXPECT_EQ(RunLoop::current().scheduledTimers(), 1U);
}

} // namespace
} // namespace orvo
