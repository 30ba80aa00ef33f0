#include "platform/foundation/KernelTimer.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstdint>
#include <ctime>
#include <sys/timerfd.h>
#include <system_error>
#include <unistd.h>

namespace orvo {

namespace {

constexpr double FarthestSeconds = 1e9;
constexpr long NanosecondsPerSecond = 1'000'000'000;

} // namespace

KernelTimer::KernelTimer()
    : _fd(timerfd_create(CLOCK_REALTIME, TFD_CLOEXEC | TFD_NONBLOCK)) {
    if (_fd < 0)
        throw std::system_error(errno, std::generic_category(), "timerfd_create");
}

KernelTimer::~KernelTimer() {
    close(_fd);
}

// NOLINTBEGIN(readability-make-member-function-const): they change what the kernel keeps
void KernelTimer::armIn(double seconds) noexcept {
    const double bounded = std::clamp(seconds, 0.0, FarthestSeconds);
    const double whole = std::floor(bounded);
    itimerspec alarm{};
    clock_gettime(CLOCK_REALTIME, &alarm.it_value);
    alarm.it_value.tv_sec += static_cast<time_t>(whole);
    alarm.it_value.tv_nsec +=
        static_cast<long>(std::ceil((bounded - whole) * NanosecondsPerSecond));
    if (alarm.it_value.tv_nsec >= NanosecondsPerSecond) {
        alarm.it_value.tv_nsec -= NanosecondsPerSecond;
        ++alarm.it_value.tv_sec;
    }
    timerfd_settime(_fd, TFD_TIMER_ABSTIME | TFD_TIMER_CANCEL_ON_SET, &alarm, nullptr);
}

void KernelTimer::disarm() noexcept {
    const itimerspec never{};
    timerfd_settime(_fd, 0, &never, nullptr);
}

void KernelTimer::acknowledge() noexcept {
    std::uint64_t expirations = 0;
    // Not ready, or the clock was set: either way whoever asks looks at the dates again.
    [[maybe_unused]] const auto got = read(_fd, &expirations, sizeof expirations);
}
// NOLINTEND(readability-make-member-function-const)

} // namespace orvo
