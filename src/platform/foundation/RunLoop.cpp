#include "platform/foundation/RunLoop.h"

#include "platform/foundation/Environment.h"
#include "platform/foundation/KernelTimer.h"
#include "platform/foundation/LoopPort.h"
#include "platform/foundation/MainQueue.h"
#include "platform/foundation/NSTimer.h"
#include "platform/foundation/TimerSchedule.h"
#include "platform/foundation/WakeSignal.h"

#include <chrono>
#include <mutex>
#include <optional>
#include <unistd.h>

namespace orvo {

namespace {

/// A timer fires when the clock shows later than its date. Dates of our time are some tenths of a
/// microsecond apart, so this much after the date it does.
constexpr double JustLater = 1e-6;

double wallClockNow() {
    return Environment::wallClock().get()->timeIntervalSinceReferenceDate();
}

} // namespace

struct RunLoop::Private {
    std::shared_ptr<TimerSchedule> timers =
        std::make_shared<TimerSchedule>([this] { armKernelTimer(); });
    KernelTimer kernelTimer;
    double readingWhenArmed = 0;
    WakeSignal stopSignal;
    std::mutex stopMutex;
    std::optional<int> stopCode;
    std::unique_ptr<LoopPort> port;

    void usePort(std::unique_ptr<LoopPort> chosen) {
        port = std::move(chosen);
        port->watch(kernelTimer.fileDescriptor(), [this] { kernelTimerWentOff(); });
        port->watch(stopSignal.fileDescriptor(), [this] { stopWasAsked(); });
    }

    void armKernelTimer() {
        const auto wake = timers->nextWake();
        if (!wake)
            return kernelTimer.disarm();
        readingWhenArmed = wallClockNow();
        kernelTimer.armIn(*wake - readingWhenArmed + JustLater);
    }

    void kernelTimerWentOff() {
        kernelTimer.acknowledge();
        const double before = readingWhenArmed;
        const bool fired = fireTimers(timers->nextNumber());
        // A clock that stands still reaches no date, however often one looks.
        if (fired || wallClockNow() != before)
            armKernelTimer();
    }

    bool fireTimers(std::uint64_t belowNumber) {
        bool fired = false;
        while (const auto timer = timers->firstDue(wallClockNow(), belowNumber)) {
            timer->reachDate(wallClockNow());
            fired = true;
        }
        return fired;
    }

    std::optional<int> takeStopCode() {
        const std::lock_guard lock(stopMutex);
        return std::exchange(stopCode, std::nullopt);
    }

    void stopWasAsked() {
        stopSignal.lower();
        const std::lock_guard lock(stopMutex);
        if (stopCode && port->leave(*stopCode))
            stopCode.reset();
    }
};

RunLoop::RunLoop()
    : _private(std::make_unique<Private>()) {}

RunLoop::~RunLoop() {
    for (const auto& timer : _private->timers->takeAll())
        timer->invalidate();
}

RunLoop& RunLoop::main() {
    // Never destroyed: other threads may stop it until the very end of the process.
    static auto& loop = *new RunLoop;
    if (isMainThread() && !loop._private->port) {
        loop._private->usePort(LoopPort::application());
        loop._private->port->watch(MainQueue::shared()->fileDescriptor(),
                                   [] { MainQueue::shared()->drain(); });
    }
    return loop;
}

RunLoop& RunLoop::current() {
    if (isMainThread())
        return main();
    thread_local RunLoop loop;
    if (!loop._private->port)
        loop._private->usePort(LoopPort::plain());
    return loop;
}

bool RunLoop::isMainThread() {
    thread_local const bool isMain = gettid() == getpid();
    return isMain;
}

int RunLoop::run() {
    if (const auto code = _private->takeStopCode())
        return *code;
    return _private->port->run();
}

void RunLoop::stop(int exitCode) {
    const std::lock_guard lock(_private->stopMutex);
    _private->stopCode = exitCode;
    _private->stopSignal.raise();
}

void RunLoop::runOnce() {
    const auto numberAfterAllNow = _private->timers->nextNumber();
    _private->port->turn(0);
    _private->fireTimers(numberAfterAllNow);
    _private->armKernelTimer();
}

bool RunLoop::runUntil(const std::function<bool()>& done, NSTimeInterval limit) {
    using Seconds = std::chrono::duration<double>;
    const auto start = std::chrono::steady_clock::now();
    for (bool inTime = true; !done();) {
        if (!inTime)
            return false;
        const double left = limit - Seconds(std::chrono::steady_clock::now() - start).count();
        inTime = left > 0;
        _private->port->turn(inTime ? left : 0);
    }
    return true;
}

void RunLoop::checkTimers() {
    _private->fireTimers(_private->timers->nextNumber());
    _private->armKernelTimer();
}

std::size_t RunLoop::scheduledTimers() const {
    return _private->timers->count();
}

const std::shared_ptr<TimerSchedule>& RunLoop::timers() const {
    return _private->timers;
}

} // namespace orvo
