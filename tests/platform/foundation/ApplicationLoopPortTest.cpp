#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/NSTimer.h"
#include "platform/foundation/RunLoop.h"

#include <QCoreApplication>
#include <QEventLoop>
#include <QTimer>
#include <gtest/gtest.h>

#include <cstdlib>

namespace orvo {
namespace {

constexpr double Patience = 30; // seconds; only a failure waits so long

/// What the toolkit wants of a `main`.
struct CommandLine {
    int count = 1;
    char name[5] = "test";
    char* words[2] = {name, nullptr};
};

/// Blocks and timers reach the calling thread's loop.
bool loopWorks() {
    bool block = false;
    bool timer = false;
    DispatchQueue::mainQueue()->async([&] { block = true; });
    NSTimer::scheduledTimerWithTimeInterval_repeats_block(
        0, false, [&](const auto&) { timer = true; });
    return RunLoop::main().runUntil([&] { return block && timer; }, Patience);
}

// Each stands in a process of its own, in which nobody has asked for the run loop yet.
class ApplicationLoopPortTest : public ::testing::Test {
protected:
    void SetUp() override { GTEST_FLAG_SET(death_test_style, "threadsafe"); }
    template <class Steps>
    static void expectTrueInAnotherProcess(const Steps& steps) {
        EXPECT_EXIT(std::exit(steps() ? 0 : 1), ::testing::ExitedWithCode(0), "");
    }
};

TEST_F(ApplicationLoopPortTest, StandsOnTheApplicationThatTheProgramMade) {
    expectTrueInAnotherProcess([] {
        CommandLine line;
        const QCoreApplication application(line.count, line.words);
        return loopWorks() && QCoreApplication::instance() == &application;
    });
}

TEST_F(ApplicationLoopPortTest, MakesAnApplicationWhereThereIsNone) {
    expectTrueInAnotherProcess([] {
        return !QCoreApplication::instance() && loopWorks() && QCoreApplication::instance();
    });
}

TEST_F(ApplicationLoopPortTest, MovesToTheNextApplication) {
    expectTrueInAnotherProcess([] {
        CommandLine line;
        {
            const QCoreApplication first(line.count, line.words);
            if (!loopWorks())
                return false;
        }
        const QCoreApplication second(line.count, line.words);
        return loopWorks();
    });
}

TEST_F(ApplicationLoopPortTest, KeepsBlocksSubmittedBeforeTheApplicationIsMade) {
    expectTrueInAnotherProcess([] {
        bool ran = false;
        DispatchQueue::mainQueue()->async([&] { ran = true; });
        if (QCoreApplication::instance())
            return false;
        CommandLine line;
        const QCoreApplication application(line.count, line.words);
        return RunLoop::main().runUntil([&] { return ran; }, Patience);
    });
}

TEST_F(ApplicationLoopPortTest, WorksWhereTheProgramRunsTheToolkitsLoopItself) {
    expectTrueInAnotherProcess([] {
        CommandLine line;
        QCoreApplication application(line.count, line.words);
        (void)RunLoop::main();
        DispatchQueue::mainQueue()->async([] { RunLoop::main().stop(7); });
        return QCoreApplication::exec() == 7;
    });
}

TEST_F(ApplicationLoopPortTest, HandsOutBlocksInTheToolkitsInnerLoops) {
    expectTrueInAnotherProcess([] {
        bool ran = false;
        DispatchQueue::mainQueue()->async([&] {
            QEventLoop menu;
            DispatchQueue::mainQueue()->async([&] {
                ran = true;
                menu.quit();
            });
            menu.exec();
            RunLoop::main().stop();
        });
        RunLoop::main().run();
        return ran;
    });
}

TEST_F(ApplicationLoopPortTest, EndsTheRunWhenTheApplicationQuits) {
    expectTrueInAnotherProcess([] {
        (void)RunLoop::main();
        QTimer::singleShot(0, [] { QCoreApplication::quit(); });
        return RunLoop::main().run() == 0;
    });
}

TEST_F(ApplicationLoopPortTest, DeletesWhatTheToolkitDeletesLater) {
    expectTrueInAnotherProcess([] {
        (void)RunLoop::main();
        bool gone = false;
        auto* object = new QObject;
        QObject::connect(object, &QObject::destroyed, [&] { gone = true; });
        object->deleteLater();
        return RunLoop::main().runUntil([&] { return gone; }, Patience);
    });
}

TEST_F(ApplicationLoopPortTest, DropsTimersAndBlocksThatAreLeftAtTheEnd) {
    expectTrueInAnotherProcess([] {
        CommandLine line;
        const QCoreApplication application(line.count, line.words);
        NSTimer::scheduledTimerWithTimeInterval_repeats_block(1000, true, [](const auto&) {});
        DispatchQueue::mainQueue()->async([] { std::abort(); });
        return RunLoop::main().scheduledTimers() == 1;
    });
}

} // namespace
} // namespace orvo
