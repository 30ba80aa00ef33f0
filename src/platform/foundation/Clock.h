#pragma once

#include <functional>
#include <memory>

namespace orvo {

/// The time of day: dates, periods, ages. It can stand still or be set, and may jump.
class WallClock {
public:
    WallClock() = default;
    WallClock(const WallClock&) = delete;
    WallClock& operator=(const WallClock&) = delete;
    virtual ~WallClock() = default;

    /// Seconds since 2001-01-01 00:00 UTC. Any thread.
    [[nodiscard]] virtual double timeIntervalSinceReferenceDate() const = 0;

    /// The machine's clock.
    [[nodiscard]] static std::shared_ptr<WallClock> system();
    /// A clock that stands still.
    [[nodiscard]] static std::shared_ptr<WallClock> standingAt(double secondsSinceReferenceDate);
    /// A clock that shows the given time now and runs on from there at the machine's pace.
    [[nodiscard]] static std::shared_ptr<WallClock> startingAt(double secondsSinceReferenceDate);
};

/// The clock of time-outs, retries and animation: it never jumps and runs on when the wall clock
/// stands.
class MonotonicClock {
public:
    MonotonicClock() = default;
    MonotonicClock(const MonotonicClock&) = delete;
    MonotonicClock& operator=(const MonotonicClock&) = delete;
    virtual ~MonotonicClock() = default;

    /// Seconds since some moment. Any thread.
    [[nodiscard]] virtual double seconds() const = 0;

    [[nodiscard]] static std::shared_ptr<MonotonicClock> system();
};

} // namespace orvo
