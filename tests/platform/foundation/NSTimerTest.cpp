#include "platform/foundation/NSTimer.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/RunLoop.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <vector>

namespace orvo {
namespace {

constexpr double Patience = 30; // seconds; only a failure waits so long
constexpr double Start = 1750000000;

std::shared_ptr<NSDate> startPlus(double seconds) {
    return NSDate::dateWithTimeIntervalSince1970(Start + seconds);
}

class Target : public virtual NSObject {
public:
    Method methodForSelector(const Selector& selector) override {
        if (selector == Selector("timerFired:"))
            return [this](const auto& sender) -> std::shared_ptr<NSObject> {
                calls.push_back(sender.get());
                return nullptr;
            };
        return NSObject::methodForSelector(selector);
    }
    std::vector<const NSObject*> calls; // by their senders
};

/// Timers on a clock that the test turns.
class NSTimerTest : public ::testing::Test {
protected:
    ~NSTimerTest() override {
        for (const auto& timer : _timers)
            timer->invalidate();
        EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
    }

    std::shared_ptr<NSTimer> timer(double interval, bool repeats, std::string name = "timer") {
        return timer(interval, repeats, [this, name = std::move(name)](const auto&) {
            fired.push_back(name);
        });
    }
    std::shared_ptr<NSTimer> timer(double interval, bool repeats, NSTimer::Block block) {
        _timers.push_back(NSTimer::scheduledTimerWithTimeInterval_repeats_block(
            interval, repeats, std::move(block)));
        return _timers.back();
    }
    void turnClockTo(double seconds) {
        clock->setSince1970(Start + seconds);
        RunLoop::main().checkTimers();
    }

    testing::StoppedClock clock{Start};
    std::vector<std::string> fired;

private:
    std::vector<std::shared_ptr<NSTimer>> _timers;
};

using Names = std::vector<std::string>;

TEST_F(NSTimerTest, FiresOnlyWhenTheClockShowsLaterThanItsDate) {
    const auto one = timer(10, false);
    EXPECT_TRUE(one->fireDate()->isEqual(startPlus(10).get()));
    turnClockTo(9.999);
    turnClockTo(10);
    EXPECT_EQ(fired, Names{});
    turnClockTo(10.000001);
    EXPECT_EQ(fired, Names{"timer"});
}

TEST_F(NSTimerTest, IsInvalidAfterItFiredUnlessItRepeats) {
    const auto once = timer(10, false);
    const auto again = timer(10, true);
    EXPECT_TRUE(once->isValid());
    turnClockTo(11);
    EXPECT_FALSE(once->isValid());
    EXPECT_TRUE(again->isValid());
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U);
    EXPECT_EQ(once->timeInterval(), 0);
    EXPECT_EQ(again->timeInterval(), 10);
    EXPECT_FALSE(once->repeats());
    EXPECT_TRUE(again->repeats());
}

TEST_F(NSTimerTest, CallsItsTargetWithItselfAndKeepsItAliveUntilInvalidated) {
    auto target = std::make_shared<Target>();
    const std::weak_ptr<Target> watch = target;
    auto info = NSString::string("info");
    const auto repeating = NSTimer::scheduledTimerWithTimeInterval_target_selector_userInfo_repeats(
        10, target, Selector("timerFired:"), info, true);
    EXPECT_EQ(repeating->userInfo(), info);
    target.reset();
    ASSERT_FALSE(watch.expired());
    turnClockTo(11);
    EXPECT_EQ(watch.lock()->calls, (std::vector<const NSObject*>{repeating.get()}));
    repeating->invalidate();
    EXPECT_TRUE(watch.expired());
    repeating->invalidate();
    EXPECT_FALSE(repeating->isValid());
}

TEST_F(NSTimerTest, LetsItsTargetGoAfterItFiredOnce) {
    auto target = std::make_shared<Target>();
    const std::weak_ptr<Target> watch = target;
    const auto once = NSTimer::scheduledTimerWithTimeInterval_target_selector_userInfo_repeats(
        10, std::move(target), Selector("timerFired:"), nullptr, false);
    once->fire();
    EXPECT_FALSE(once->isValid());
    EXPECT_TRUE(watch.expired());
}

TEST_F(NSTimerTest, RaisesForATargetThatCannotBeCalled) {
    const auto make = [](std::shared_ptr<NSObject> target, const char* selector) {
        return NSTimer::scheduledTimerWithTimeInterval_target_selector_userInfo_repeats(
            1, std::move(target), Selector(selector), nullptr, false);
    };
    EXPECT_THROW(make(nullptr, "timerFired:"), NSInvalidArgumentException);
    EXPECT_THROW(make(std::make_shared<Target>(), "other:"), NSInvalidArgumentException);
    EXPECT_THROW(timer(1, false, NSTimer::Block()), NSInvalidArgumentException);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
}

TEST_F(NSTimerTest, LivesOnWithoutAnyReferenceButTheRunLoops) {
    const std::weak_ptr<NSTimer> watch = NSTimer::scheduledTimerWithTimeInterval_repeats_block(
        10, false, [this](const auto&) { fired.emplace_back("timer"); });
    EXPECT_FALSE(watch.expired());
    turnClockTo(11);
    EXPECT_EQ(fired, Names{"timer"});
    EXPECT_TRUE(watch.expired());
}

TEST_F(NSTimerTest, KeepsItsPhaseAndSkipsTheDatesThatItMissed) {
    const auto repeating = timer(10, true);
    turnClockTo(13);
    EXPECT_TRUE(repeating->fireDate()->isEqual(startPlus(20).get()));
    turnClockTo(47);
    EXPECT_EQ(fired.size(), 2U);
    EXPECT_TRUE(repeating->fireDate()->isEqual(startPlus(50).get()));
    turnClockTo(50);
    EXPECT_EQ(fired.size(), 2U);
}

TEST_F(NSTimerTest, SurvivesARepeatTooShortForTheClockToTell) {
    const auto repeating = timer(1e-30, true);
    turnClockTo(1);
    EXPECT_EQ(fired.size(), 1U);
    EXPECT_GT(repeating->fireDate()->timeIntervalSinceNow(), 0);
    turnClockTo(2);
    EXPECT_EQ(fired.size(), 2U);
}

TEST_F(NSTimerTest, CountsAnIntervalThatIsNotAboveZeroAsATenthOfAMillisecond) {
    for (const double interval : {0.0, -5.0, std::numeric_limits<double>::quiet_NaN()})
        EXPECT_NEAR(
            timer(interval, false)->fireDate()->timeIntervalSince1970(), Start + 0.0001, 0.000001);
}

TEST_F(NSTimerTest, TakesTheLargestIntervalAndAFireDateInItsPlace) {
    const auto one = timer(std::numeric_limits<double>::max(), false);
    turnClockTo(1e12);
    EXPECT_EQ(fired, Names{});
    EXPECT_TRUE(one->isValid());
    one->setFireDate(startPlus(1e12 + 5));
    turnClockTo(1e12 + 6);
    EXPECT_EQ(fired, Names{"timer"});
}

TEST_F(NSTimerTest, NeverReachesADateThatIsNoNumber) {
    const auto broken = timer(1, false, "broken");
    const auto sound = timer(1, false, "sound");
    broken->setFireDate(
        NSDate::dateWithTimeIntervalSinceReferenceDate(std::numeric_limits<double>::quiet_NaN()));
    turnClockTo(2);
    EXPECT_EQ(fired, Names{"sound"});
}

TEST_F(NSTimerTest, ReachesAPastDateInTheNextTurnAndNotInsideTheCall) {
    const auto one = timer(10, false);
    one->setFireDate(startPlus(-5));
    EXPECT_EQ(fired, Names{});
    EXPECT_TRUE(RunLoop::main().runUntil([&] { return !fired.empty(); }, Patience));
}

TEST_F(NSTimerTest, WaitsForTheNextTurnWhenScheduledInTheTurnUnderWay) {
    timer(1, false, [this](const auto&) {
        fired.emplace_back("outer");
        timer(1, false, "inner")->setFireDate(startPlus(-1));
    });
    clock->advance(5);
    RunLoop::main().runOnce();
    EXPECT_EQ(fired, Names{"outer"});
    RunLoop::main().runOnce();
    EXPECT_EQ(fired, (Names{"outer", "inner"}));
}

TEST_F(NSTimerTest, FiresInOrderOfDateThenOfScheduling) {
    timer(20, false, "late");
    timer(10, false, "first of two");
    timer(10, false, "second of two");
    timer(5, false, "early");
    turnClockTo(30);
    EXPECT_EQ(fired, (Names{"early", "first of two", "second of two", "late"}));
}

TEST_F(NSTimerTest, InvalidatesItselfAndOthersInACallback) {
    std::shared_ptr<NSTimer> other;
    const auto own = timer(1, true, [&](const std::shared_ptr<NSTimer>& self) {
        fired.emplace_back("own");
        self->invalidate();
        other->invalidate();
    });
    other = timer(2, false, "other");
    turnClockTo(5);
    turnClockTo(10);
    EXPECT_EQ(fired, Names{"own"});
    EXPECT_FALSE(own->isValid());
}

TEST_F(NSTimerTest, KeepsACallbackWholeThatInvalidatesItsTimer) {
    timer(1, true, [this, text = std::string("still here")](const auto& self) {
        self->invalidate();
        fired.push_back(text);
    });
    turnClockTo(2);
    EXPECT_EQ(fired, Names{"still here"});
}

TEST_F(NSTimerTest, TakesANewDateInItsOwnCallback) {
    const auto repeating = timer(10, true, [&](const std::shared_ptr<NSTimer>& self) {
        fired.emplace_back("timer");
        self->setFireDate(startPlus(100));
    });
    turnClockTo(11);
    EXPECT_TRUE(repeating->fireDate()->isEqual(startPlus(100).get()));
    turnClockTo(99);
    EXPECT_EQ(fired.size(), 1U);
    turnClockTo(101);
    EXPECT_EQ(fired.size(), 2U);
}

TEST_F(NSTimerTest, IsNotCalledInsideItsOwnCallback) {
    for (const bool repeats : {false, true})
        timer(1, repeats, [this](const auto&) {
            fired.emplace_back("in");
            clock->advance(10);
            RunLoop::main().checkTimers();
            fired.emplace_back("out");
        });
    // The two interleave, each of them once.
    turnClockTo(2);
    EXPECT_EQ(fired, (Names{"in", "in", "out", "out"}));
}

TEST_F(NSTimerTest, FiredByHandKeepsItsDates) {
    const auto once = timer(10, false, "once");
    const auto again = timer(10, true, "again");
    once->fire();
    again->fire();
    once->fire();
    EXPECT_EQ(fired, (Names{"once", "again"}));
    EXPECT_FALSE(once->isValid());
    EXPECT_TRUE(again->fireDate()->isEqual(startPlus(10).get()));
    turnClockTo(11);
    EXPECT_EQ(fired, (Names{"once", "again", "again"}));
}

TEST_F(NSTimerTest, IgnoresANewDateOnceInvalid) {
    const auto one = timer(10, false);
    one->invalidate();
    one->setFireDate(startPlus(1));
    EXPECT_TRUE(one->fireDate()->isEqual(startPlus(10).get()));
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
    turnClockTo(20);
    EXPECT_EQ(fired, Names{});
}

TEST_F(NSTimerTest, HasNoToleranceAtFirstAndNoneBelowZero) {
    const auto one = timer(10, true);
    EXPECT_EQ(one->tolerance(), 0);
    one->setTolerance(3);
    EXPECT_EQ(one->tolerance(), 3);
    one->setTolerance(-1);
    EXPECT_EQ(one->tolerance(), 0);
}

TEST_F(NSTimerTest, FiresADueTimerWithToleranceAtAnotherOnesWakeUp) {
    timer(10, false, "tolerant")->setTolerance(5);
    timer(12, false, "exact");
    turnClockTo(12.5);
    EXPECT_EQ(fired, (Names{"tolerant", "exact"}));
}

TEST_F(NSTimerTest, DoesNotKeepTheLoopBusyWhenAStandingClockShowsItsVeryDate) {
    timer(10, false)->setFireDate(startPlus(0));
    int turns = 0;
    RunLoop::main().runUntil(
        [&] {
            ++turns;
            return false;
        },
        0.02);
    EXPECT_LT(turns, 10);
    EXPECT_EQ(fired, Names{});
}

TEST(NSTimerOnARunningClock, FiresByItselfAndNeverEarly) {
    for (int i = 0; i < 20; ++i) {
        std::optional<double> lateness;
        NSTimer::scheduledTimerWithTimeInterval_repeats_block(
            0.0007, false, [&](const std::shared_ptr<NSTimer>& self) {
                lateness = -self->fireDate()->timeIntervalSinceNow();
            });
        ASSERT_TRUE(RunLoop::main().runUntil([&] { return lateness.has_value(); }, Patience));
        EXPECT_GT(*lateness, 0);
    }
}

TEST(NSTimerOnARunningClock, FollowsAClockThatShowsAnotherTime) {
    const auto shifted = Environment::wallClock().overrideWith(WallClock::startingAt(-5e9));
    std::optional<double> lateness;
    NSTimer::scheduledTimerWithTimeInterval_repeats_block(
        0.001, false, [&](const std::shared_ptr<NSTimer>& self) {
            EXPECT_LT(self->fireDate()->timeIntervalSinceReferenceDate(), -4e9);
            lateness = -self->fireDate()->timeIntervalSinceNow();
        });
    ASSERT_TRUE(RunLoop::main().runUntil([&] { return lateness.has_value(); }, Patience));
    EXPECT_GT(*lateness, 0);
}

TEST(NSTimerOnARunningClock, SharesOneWakeUpWithinTheTolerance) {
    // Both are due when the second must fire, so that the first one waits for it.
    std::vector<std::string> fired;
    int turnsBetween = 0;
    const auto tolerant = NSTimer::scheduledTimerWithTimeInterval_repeats_block(
        0.002, false, [&](const auto&) { fired.emplace_back("tolerant"); });
    tolerant->setTolerance(1000);
    NSTimer::scheduledTimerWithTimeInterval_repeats_block(
        0.02, false, [&](const auto&) { fired.emplace_back("exact"); });
    ASSERT_TRUE(RunLoop::main().runUntil(
        [&] {
            turnsBetween += fired.size() == 1;
            return fired.size() == 2;
        },
        Patience));
    EXPECT_EQ(fired, (std::vector<std::string>{"tolerant", "exact"}));
    EXPECT_EQ(turnsBetween, 0);
}

} // namespace
} // namespace orvo
