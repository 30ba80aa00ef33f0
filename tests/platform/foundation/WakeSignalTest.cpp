#include "platform/foundation/WakeSignal.h"

#include <gtest/gtest.h>

#include <poll.h>

namespace orvo {
namespace {

bool isReadable(const WakeSignal& signal) {
    pollfd watched{signal.fileDescriptor(), POLLIN, 0};
    return poll(&watched, 1, 0) == 1;
}

TEST(WakeSignal, IsReadableWhileItIsUp) {
    WakeSignal signal;
    EXPECT_FALSE(isReadable(signal));
    signal.raise();
    signal.raise();
    EXPECT_TRUE(isReadable(signal));
    signal.lower();
    EXPECT_FALSE(isReadable(signal));
    signal.lower();
    EXPECT_FALSE(isReadable(signal));
}

} // namespace
} // namespace orvo
