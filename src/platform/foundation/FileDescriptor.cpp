#include "platform/foundation/FileDescriptor.h"

#include <unistd.h>
#include <utility>

namespace orvo {

FileDescriptor::FileDescriptor(FileDescriptor&& other) noexcept
    : _number(std::exchange(other._number, -1)) {}

FileDescriptor::~FileDescriptor() {
    if (isOpen())
        close(_number);
}

} // namespace orvo
