#include "platform/foundation/Clock.h"

#include "platform/foundation/NSDate.h"

#include <ctime>

namespace orvo {

namespace {

double read(clockid_t clock) {
    timespec time{};
    clock_gettime(clock, &time);
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * 1e-9;
}

class SystemWallClock final : public WallClock {
public:
    double timeIntervalSinceReferenceDate() const override {
        timespec time{};
        clock_gettime(CLOCK_REALTIME, &time);
        // Whole seconds first: the difference is exact, so the fraction keeps its digits.
        return (static_cast<double>(time.tv_sec) - NSTimeIntervalSince1970) +
               static_cast<double>(time.tv_nsec) * 1e-9;
    }
};

class StandingWallClock final : public WallClock {
public:
    explicit StandingWallClock(double now)
        : _now(now) {}
    double timeIntervalSinceReferenceDate() const override { return _now; }

private:
    double _now;
};

class ShiftedWallClock final : public WallClock {
public:
    // Time asleep counts too, as it does for the machine's own time of day.
    explicit ShiftedWallClock(double now)
        : _start(now)
        , _startReading(read(CLOCK_BOOTTIME)) {}
    double timeIntervalSinceReferenceDate() const override {
        return _start + (read(CLOCK_BOOTTIME) - _startReading);
    }

private:
    double _start;
    double _startReading;
};

class SystemMonotonicClock final : public MonotonicClock {
public:
    double seconds() const override { return read(CLOCK_MONOTONIC); }
};

} // namespace

std::shared_ptr<WallClock> WallClock::system() {
    return std::make_shared<SystemWallClock>();
}
std::shared_ptr<WallClock> WallClock::standingAt(double now) {
    return std::make_shared<StandingWallClock>(now);
}
std::shared_ptr<WallClock> WallClock::startingAt(double now) {
    return std::make_shared<ShiftedWallClock>(now);
}
std::shared_ptr<MonotonicClock> MonotonicClock::system() {
    return std::make_shared<SystemMonotonicClock>();
}

} // namespace orvo
