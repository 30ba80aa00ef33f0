#include "print/TerminationSignals.h"

#include <gtest/gtest.h>

#include <unistd.h>

namespace orvo {
namespace {

constexpr int Told = 42;

/// In processes of their own, which have no other threads that could take the signals.
class TerminationSignalsTest : public ::testing::Test {
protected:
    TerminationSignalsTest() { GTEST_FLAG_SET(death_test_style, "threadsafe"); }
};

[[noreturn]] void tellOf(int signal) {
    const TerminationSignals signals([] { _exit(Told); });
    kill(getpid(), signal);
    while (true)
        pause();
}

[[noreturn]] void terminateAfterwards() {
    {
        const TerminationSignals signals([] { _exit(Told); });
    }
    kill(getpid(), SIGTERM);
    while (true)
        pause();
}

TEST_F(TerminationSignalsTest, TellsOfBothSignals) {
    EXPECT_EXIT(tellOf(SIGINT), ::testing::ExitedWithCode(Told), "");
    EXPECT_EXIT(tellOf(SIGTERM), ::testing::ExitedWithCode(Told), "");
}

TEST_F(TerminationSignalsTest, AfterwardsTheSignalsActAsBefore) {
    EXPECT_EXIT(terminateAfterwards(), ::testing::KilledBySignal(SIGTERM), "");
}

} // namespace
} // namespace orvo
