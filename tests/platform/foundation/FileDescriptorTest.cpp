#include "platform/foundation/FileDescriptor.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <optional>
#include <utility>

namespace orvo {
namespace {

bool isOpenInTheKernel(int number) {
    return fcntl(number, F_GETFD) >= 0;
}

/// One that nobody else closes.
int newDescriptor() {
    return open("/dev/null", O_RDONLY | O_CLOEXEC);
}

TEST(FileDescriptor, IsClosedAtTheEndOfItsScope) {
    const int number = newDescriptor();
    {
        const FileDescriptor file(number);
        EXPECT_TRUE(file.isOpen());
        EXPECT_EQ(file.number(), number);
        EXPECT_TRUE(isOpenInTheKernel(number));
    }
    EXPECT_FALSE(isOpenInTheKernel(number));
}

TEST(FileDescriptor, OneThatCouldNotBeOpenedIsNone) {
    const FileDescriptor none(-1);
    EXPECT_FALSE(none.isOpen());
    EXPECT_EQ(none.number(), -1);
}

TEST(FileDescriptor, BelongsToOneAtATime) {
    const int number = newDescriptor();
    std::optional<FileDescriptor> giver(number);
    const FileDescriptor taker(std::move(*giver));
    giver.reset();
    EXPECT_EQ(taker.number(), number);
    EXPECT_TRUE(isOpenInTheKernel(number));
}

} // namespace
} // namespace orvo
