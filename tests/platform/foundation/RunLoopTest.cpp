#include "platform/foundation/RunLoop.h"

#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/NSTimer.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

namespace orvo {
namespace {

constexpr double Patience = 30; // seconds; only a failure waits so long

TEST(RunLoop, OfTheMainThreadIsTheCurrentOneThereAndNowhereElse) {
    EXPECT_TRUE(RunLoop::isMainThread());
    EXPECT_EQ(&RunLoop::current(), &RunLoop::main());
    std::thread([main = &RunLoop::main()] {
        EXPECT_FALSE(RunLoop::isMainThread());
        EXPECT_NE(&RunLoop::current(), main);
        EXPECT_EQ(&RunLoop::main(), main);
    }).join();
}

TEST(RunLoop, RunsUntilStoppedAndAnswersTheCode) {
    DispatchQueue::mainQueue()->async([] { RunLoop::main().stop(5); });
    EXPECT_EQ(RunLoop::main().run(), 5);
}

TEST(RunLoop, FinishesTheTurnInWhichItIsStopped) {
    std::vector<int> ran;
    DispatchQueue::mainQueue()->async([&] {
        RunLoop::main().stop();
        ran.push_back(1);
    });
    DispatchQueue::mainQueue()->async([&] { ran.push_back(2); });
    EXPECT_EQ(RunLoop::main().run(), 0);
    EXPECT_EQ(ran, (std::vector{1, 2}));
}

TEST(RunLoop, IsStoppedFromAnotherThread) {
    std::thread stopper;
    DispatchQueue::mainQueue()->async(
        [&] { stopper = std::thread([] { RunLoop::main().stop(9); }); });
    EXPECT_EQ(RunLoop::main().run(), 9);
    stopper.join();
}

TEST(RunLoop, RemembersAStopThatCameBeforeTheRun) {
    RunLoop::main().stop(4);
    RunLoop::main().runOnce();
    EXPECT_EQ(RunLoop::main().run(), 4);
}

TEST(RunLoop, EndsOnlyTheInnermostRun) {
    std::vector<int> codes;
    DispatchQueue::mainQueue()->async([&] {
        DispatchQueue::mainQueue()->async([] { RunLoop::main().stop(1); });
        codes.push_back(RunLoop::main().run());
        DispatchQueue::mainQueue()->async([] { RunLoop::main().stop(2); });
    });
    codes.push_back(RunLoop::main().run());
    EXPECT_EQ(codes, (std::vector{1, 2}));
}

TEST(RunLoop, AsksWhetherItIsDoneBeforeTheFirstTurn) {
    bool ran = false;
    DispatchQueue::mainQueue()->async([&] { ran = true; });
    EXPECT_TRUE(RunLoop::main().runUntil([] { return true; }, Patience));
    EXPECT_FALSE(ran);
    RunLoop::main().runOnce();
    EXPECT_TRUE(ran);
}

TEST(RunLoop, GivesUpAtItsLimit) {
    int asked = 0;
    EXPECT_FALSE(RunLoop::main().runUntil(
        [&] {
            ++asked;
            return false;
        },
        0.001));
    EXPECT_GE(asked, 2);
}

TEST(RunLoop, TakesOneTurnEvenWithoutTime) {
    bool ran = false;
    DispatchQueue::mainQueue()->async([&] { ran = true; });
    EXPECT_TRUE(RunLoop::main().runUntil([&] { return ran; }, 0));
}

TEST(RunLoop, RunsTimersOnAThreadThatIsNotTheMainOne) {
    int fired = 0;
    std::thread::id firedOn;
    std::thread thread([&] {
        const auto timer =
            NSTimer::scheduledTimerWithTimeInterval_repeats_block(0, true, [&](const auto&) {
                ++fired;
                firedOn = std::this_thread::get_id();
            });
        EXPECT_EQ(RunLoop::current().scheduledTimers(), 1U);
        EXPECT_TRUE(RunLoop::current().runUntil([&] { return fired >= 3; }, Patience));
        EXPECT_FALSE(RunLoop::current().runUntil([] { return false; }, 0));
    });
    const auto id = thread.get_id();
    thread.join();
    EXPECT_EQ(firedOn, id);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
}

TEST(RunLoop, OfAnotherThreadIsStoppedFromHere) {
    std::atomic<RunLoop*> loop = nullptr;
    int code = 0;
    std::thread thread([&] {
        NSTimer::scheduledTimerWithTimeInterval_repeats_block(
            0, false, [&](const auto&) { loop = &RunLoop::current(); });
        code = RunLoop::current().run();
    });
    while (!loop)
        std::this_thread::yield();
    loop.load()->stop(6);
    thread.join();
    EXPECT_EQ(code, 6);
}

TEST(RunLoop, InvalidatesTheTimersOfAThreadThatEnds) {
    std::shared_ptr<NSTimer> timer;
    auto held = std::make_shared<int>(0);
    const std::weak_ptr<int> watch = held;
    std::thread([&, held = std::move(held)]() mutable {
        timer = NSTimer::scheduledTimerWithTimeInterval_repeats_block(
            1000, true, [held](const auto&) {});
        held.reset();
    }).join();
    EXPECT_FALSE(timer->isValid());
    EXPECT_TRUE(watch.expired());
}

} // namespace
} // namespace orvo
