#include "platform/foundation/DispatchQueue.h"

#include "platform/foundation/RunLoop.h"
#include "platform/foundation/WorkerThreads.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <future>
#include <latch>
#include <set>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

namespace orvo {
namespace {

constexpr double Patience = 30; // seconds; only a failure waits so long

template <class T>
T take(std::future<T> future) {
    if (future.wait_for(std::chrono::duration<double>(Patience)) != std::future_status::ready)
        throw std::runtime_error("nobody answered");
    return future.get();
}

TEST(MainQueue, RunsBlocksInOrderAndNeverInsideTheCall) {
    std::vector<int> ran;
    for (int i = 0; i < 3; ++i)
        DispatchQueue::mainQueue()->async([&ran, i] { ran.push_back(i); });
    EXPECT_TRUE(ran.empty());
    RunLoop::main().runOnce();
    EXPECT_EQ(ran, (std::vector{0, 1, 2}));
}

TEST(MainQueue, RunsABlockSubmittedWithinABlockInALaterTurn) {
    std::vector<std::string> ran;
    DispatchQueue::mainQueue()->async([&] {
        DispatchQueue::mainQueue()->async([&] { ran.emplace_back("inner"); });
        ran.emplace_back("outer");
    });
    RunLoop::main().runOnce();
    EXPECT_EQ(ran, (std::vector<std::string>{"outer"}));
    RunLoop::main().runOnce();
    EXPECT_EQ(ran, (std::vector<std::string>{"outer", "inner"}));
}

TEST(MainQueue, TakesUpWaitingBlocksInAnInnerTurnOfABlock) {
    std::vector<int> ran;
    DispatchQueue::mainQueue()->async([&] {
        EXPECT_TRUE(RunLoop::main().runUntil([&] { return ran.size() == 2; }, Patience));
        ran.push_back(3);
    });
    DispatchQueue::mainQueue()->async([&] { ran.push_back(1); });
    DispatchQueue::mainQueue()->async([&] { ran.push_back(2); });
    EXPECT_TRUE(RunLoop::main().runUntil([&] { return ran.size() == 3; }, Patience));
    EXPECT_EQ(ran, (std::vector{1, 2, 3}));
}

TEST(MainQueue, WakesTheLoopFromOtherThreadsAndKeepsTheOrderOfEach) {
    constexpr int each = 500;
    std::vector<std::vector<int>> ran(3);
    {
        std::vector<std::jthread> threads;
        for (std::size_t t = 0; t < ran.size(); ++t)
            threads.emplace_back([&ran, t] {
                for (int i = 0; i < each; ++i)
                    DispatchQueue::mainQueue()->async([&ran, t, i] {
                        EXPECT_TRUE(DispatchQueue::mainQueue()->isCurrent());
                        ran[t].push_back(i);
                    });
            });
        EXPECT_TRUE(RunLoop::main().runUntil(
            [&] { return ran[0].size() + ran[1].size() + ran[2].size() == 3 * each; }, Patience));
    }
    for (const auto& numbers : ran)
        for (int i = 0; i < each; ++i)
            EXPECT_EQ(numbers.at(static_cast<std::size_t>(i)), i);
}

TEST(MainQueue, IsCurrentOnlyOnTheMainThread) {
    EXPECT_TRUE(DispatchQueue::mainQueue()->isCurrent());
    bool elsewhere = true;
    std::thread([&] { elsewhere = DispatchQueue::mainQueue()->isCurrent(); }).join();
    EXPECT_FALSE(elsewhere);
}

TEST(SerialQueue, RunsBlocksInOrderOnOneThreadOfItsOwn) {
    const auto queue = DispatchQueue::serialQueue("test");
    std::vector<int> ran;
    std::set<std::thread::id> threads;
    std::promise<void> done;
    for (int i = 0; i < 100; ++i)
        queue->async([&, i] {
            ran.push_back(i);
            threads.insert(std::this_thread::get_id());
        });
    queue->async([&] { done.set_value(); });
    take(done.get_future());
    ASSERT_EQ(ran.size(), 100U);
    EXPECT_TRUE(std::ranges::is_sorted(ran));
    EXPECT_EQ(threads.size(), 1U);
    EXPECT_FALSE(threads.contains(std::this_thread::get_id()));
}

TEST(SerialQueue, IsCurrentInItsOwnBlocksAlone) {
    const auto queue = DispatchQueue::serialQueue("test");
    const auto other = DispatchQueue::serialQueue("other");
    std::promise<std::pair<bool, bool>> seen;
    queue->async([&] { seen.set_value({queue->isCurrent(), other->isCurrent()}); });
    EXPECT_EQ(take(seen.get_future()), (std::pair{true, false}));
    EXPECT_FALSE(queue->isCurrent());
}

TEST(SerialQueue, ItsBlocksRunUnderItsWholeNameHoweverLongThatIs) {
    const auto nameIn = [](const std::shared_ptr<DispatchQueue>& queue) {
        std::promise<std::string> name;
        queue->async([&] { name.set_value(WorkerThreads::currentName()); });
        return take(name.get_future());
    };
    EXPECT_EQ(nameIn(DispatchQueue::serialQueue("a.name.longer.than.the.system.keeps")),
              "a.name.longer.than.the.system.keeps");
    EXPECT_EQ(nameIn(DispatchQueue::globalQueue()), "worker");
    EXPECT_EQ(WorkerThreads::currentName(), "") << "the main thread is no worker";
}

TEST(SerialQueue, StillRunsItsBlocksAfterTheLastReferenceHasGone) {
    std::promise<void> gate;
    std::promise<int> last;
    {
        const auto queue = DispatchQueue::serialQueue("test");
        queue->async([opened = gate.get_future().share()] { opened.wait(); });
        queue->async([&] { last.set_value(7); });
    }
    gate.set_value();
    EXPECT_EQ(take(last.get_future()), 7);
}

TEST(SerialQueue, MayLoseItsLastReferenceInsideABlock) {
    std::promise<void> done;
    auto queue = DispatchQueue::serialQueue("test");
    auto* bare = queue.get();
    bare->async([&done, held = std::move(queue)]() mutable {
        held->async([&done] { done.set_value(); });
        held.reset();
    });
    take(done.get_future());
}

TEST(GlobalQueue, RunsBlocksSideBySide) {
    // Each block waits for the other three.
    std::latch meeting(4);
    std::latch left(4);
    for (int i = 0; i < 4; ++i)
        DispatchQueue::globalQueue()->async([&] {
            meeting.arrive_and_wait();
            left.count_down();
        });
    left.wait();
}

TEST(GlobalQueue, RunsEveryBlockOffTheMainThread) {
    constexpr int blocks = 2000;
    std::atomic<int> ran = 0;
    std::atomic<int> onMain = 0;
    std::latch done(blocks);
    for (int i = 0; i < blocks; ++i)
        DispatchQueue::globalQueue()->async([&] {
            ++ran;
            if (RunLoop::isMainThread() || !DispatchQueue::globalQueue()->isCurrent())
                ++onMain;
            done.count_down();
        });
    done.wait();
    EXPECT_EQ(ran, blocks);
    EXPECT_EQ(onMain, 0);
    EXPECT_FALSE(DispatchQueue::globalQueue()->isCurrent());
}

TEST(WorkerThreads, LetTheProcessEndWhileBlocksWaitAndOneIsStuck) {
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    EXPECT_EXIT(
        {
            const auto serial = DispatchQueue::serialQueue("stuck");
            std::promise<void> started;
            serial->async([&] {
                started.set_value();
                std::promise<void>().get_future().wait();
            });
            serial->async([] { std::abort(); }); // never reached
            DispatchQueue::globalQueue()->async([] {});
            started.get_future().wait();
            std::exit(3);
        },
        ::testing::ExitedWithCode(3),
        "");
}

TEST(WorkerThreads, FinishTheBlockUnderWayBeforeTheProcessEnds) {
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    EXPECT_EXIT(
        {
            std::promise<void> started;
            DispatchQueue::globalQueue()->async([&] {
                started.set_value();
                for (int i = 0; i < 20; ++i) // on a busy machine each takes a while
                    std::this_thread::yield();
                fputs("finished\n", stderr);
            });
            started.get_future().wait();
            std::exit(0);
        },
        ::testing::ExitedWithCode(0),
        "finished");
}

} // namespace
} // namespace orvo
