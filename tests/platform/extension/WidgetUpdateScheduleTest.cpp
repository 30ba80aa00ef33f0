#include "platform/extension/WidgetUpdateSchedule.h"

#include "platform/foundation/RunLoop.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

class WidgetUpdateScheduleTest : public ::testing::Test {
protected:
    /// Just past the tolerance of what was planned.
    void wait(double minutes) {
        clock->advance(minutes * 60 * 1.1 + 1);
        RunLoop::main().checkTimers();
    }
    void expectSilenceFor(double minutes) {
        const int before = asked;
        clock->advance(minutes * 60);
        RunLoop::main().checkTimers();
        EXPECT_EQ(asked, before);
    }

    testing::StoppedClock clock;
    int asked = 0;
    std::shared_ptr<WidgetUpdateSchedule> schedule =
        WidgetUpdateSchedule::scheduleWithRequest([this] { ++asked; });
};

TEST_F(WidgetUpdateScheduleTest, AsksOnBecomingVisibleOnce) {
    schedule->setVisible(true);
    schedule->setVisible(true);
    EXPECT_EQ(asked, 1);
    schedule->setVisible(false);
    schedule->setVisible(true);
    EXPECT_EQ(asked, 2);
}

TEST_F(WidgetUpdateScheduleTest, AsksAgainAfterOneTwoFiveAndThenEveryFifteenMinutes) {
    schedule->setVisible(true);
    for (const double minutes : {1, 2, 5, 15, 15, 15}) {
        const int before = asked;
        schedule->didAnswer(false);
        clock->advance(minutes * 60 - 1);
        RunLoop::main().checkTimers();
        EXPECT_EQ(asked, before) << minutes;
        clock->advance(minutes * 60 * 0.1 + 2);
        RunLoop::main().checkTimers();
        EXPECT_EQ(asked, before + 1) << minutes;
    }
}

TEST_F(WidgetUpdateScheduleTest, ASuccessEndsThePlanAndLeavesNoTimer) {
    const auto timers = RunLoop::main().scheduledTimers();
    schedule->setVisible(true);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), timers) << "idle";
    schedule->didAnswer(false);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), timers + 1);
    schedule->didAnswer(true);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), timers);
    expectSilenceFor(600);
    schedule->didAnswer(false);
    wait(1);
    EXPECT_EQ(asked, 2) << "it begins with a minute again";
}

TEST_F(WidgetUpdateScheduleTest, FailuresOfRequestsThatRanTogetherCountOnce) {
    schedule->setVisible(true);
    schedule->didAnswer(false);
    schedule->didAnswer(false);
    wait(1);
    EXPECT_EQ(asked, 2);
    schedule->didAnswer(false);
    wait(2);
    EXPECT_EQ(asked, 3);
}

TEST_F(WidgetUpdateScheduleTest, WhileInvisibleNothingAsksAndNothingIsPlanned) {
    schedule->somethingChanged();
    schedule->didAnswer(false);
    expectSilenceFor(60);
    schedule->setVisible(true);
    schedule->didAnswer(false);
    schedule->setVisible(false);
    expectSilenceFor(60);
    EXPECT_EQ(asked, 1);
}

TEST_F(WidgetUpdateScheduleTest, AChangeAsksAtOnceAndBeginsAnew) {
    schedule->setVisible(true);
    schedule->didAnswer(false);
    wait(1);
    schedule->didAnswer(false);
    schedule->somethingChanged();
    EXPECT_EQ(asked, 3);
    schedule->didAnswer(false);
    wait(1);
    EXPECT_EQ(asked, 4) << "after a minute, not five";
}

TEST_F(WidgetUpdateScheduleTest, PlansEndWithIt) {
    schedule->setVisible(true);
    schedule->didAnswer(false);
    const auto timers = RunLoop::main().scheduledTimers();
    schedule = nullptr;
    EXPECT_EQ(RunLoop::main().scheduledTimers(), timers - 1);
}

} // namespace
} // namespace orvo
