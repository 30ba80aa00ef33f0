#pragma once

#include "platform/foundation/Environment.h"
#include "platform/foundation/NSDate.h"

#include <atomic>
#include <memory>

namespace orvo::testing {

/// A wall clock that shows what the test says. Whoever turns it while timers are scheduled calls
/// `RunLoop::checkTimers()`.
class ManualWallClock final : public WallClock {
public:
    explicit ManualWallClock(double secondsSince1970)
        : _now(secondsSince1970 - NSTimeIntervalSince1970) {}

    double timeIntervalSinceReferenceDate() const override { return _now; }
    void setSince1970(double seconds) { _now = seconds - NSTimeIntervalSince1970; }
    void advance(double seconds) { _now = _now + seconds; }

private:
    std::atomic<double> _now;
};

class ManualMonotonicClock final : public MonotonicClock {
public:
    double seconds() const override { return _now; }
    void advance(double seconds) { _now = _now + seconds; }

private:
    std::atomic<double> _now = 1000;
};

/// Stops the wall clock at a moment for the scope of a test: `StoppedClock clock(1750000000);`
class StoppedClock {
public:
    explicit StoppedClock(double secondsSince1970 = 1750000000)
        : _clock(std::make_shared<ManualWallClock>(secondsSince1970))
        , _override(Environment::wallClock().overrideWith(_clock)) {}

    ManualWallClock* operator->() const { return _clock.get(); }

private:
    std::shared_ptr<ManualWallClock> _clock;
    EnvironmentSlot<std::shared_ptr<WallClock>>::Override _override;
};

} // namespace orvo::testing
