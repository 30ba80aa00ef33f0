#include "platform/foundation/LoopPort.h"
#include "platform/foundation/WakeSignal.h"

#include <gtest/gtest.h>

#include <vector>

namespace orvo {
namespace {

TEST(PlainLoopPort, CallsForEachDescriptorThatIsReadable) {
    const auto port = LoopPort::plain();
    WakeSignal up;
    WakeSignal down;
    int calledUp = 0;
    int calledDown = 0;
    port->watch(up.fileDescriptor(), [&] { ++calledUp; });
    port->watch(down.fileDescriptor(), [&] { ++calledDown; });
    up.raise();
    port->turn(std::nullopt);
    port->turn(0);
    EXPECT_EQ(calledUp, 2);
    EXPECT_EQ(calledDown, 0);
}

TEST(PlainLoopPort, ComesBackWhenNothingHappens) {
    const auto port = LoopPort::plain();
    port->turn(0);
    port->turn(-1);
    port->turn(0.001);
}

TEST(PlainLoopPort, LeavesTheInnermostRunWithItsCode) {
    const auto port = LoopPort::plain();
    WakeSignal signal;
    std::vector<int> codes;
    int calls = 0;
    port->watch(signal.fileDescriptor(), [&] {
        if (++calls == 1)
            codes.push_back(port->run());
        EXPECT_TRUE(port->leave(calls));
    });
    signal.raise();
    codes.push_back(port->run());
    EXPECT_EQ(codes.front(), 2);
    EXPECT_EQ(codes.size(), 2U);
}

TEST(PlainLoopPort, SaysThatThereIsNothingToLeave) {
    EXPECT_FALSE(LoopPort::plain()->leave(1));
}

} // namespace
} // namespace orvo
