#include "platform/foundation/WakeSignal.h"

#include <cerrno>
#include <cstdint>
#include <sys/eventfd.h>
#include <system_error>
#include <unistd.h>

namespace orvo {

WakeSignal::WakeSignal()
    : _fd(eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {
    if (_fd < 0)
        throw std::system_error(errno, std::generic_category(), "eventfd");
}

WakeSignal::~WakeSignal() {
    close(_fd);
}

// NOLINTBEGIN(readability-make-member-function-const): they change what the kernel keeps
void WakeSignal::raise() noexcept {
    const std::uint64_t one = 1;
    // It fails only where the counter is full, and then the flag is up.
    [[maybe_unused]] const auto written = write(_fd, &one, sizeof one);
}

void WakeSignal::lower() noexcept {
    std::uint64_t count = 0;
    // It fails only where the flag is down already.
    [[maybe_unused]] const auto got = read(_fd, &count, sizeof count);
}
// NOLINTEND(readability-make-member-function-const)

} // namespace orvo
