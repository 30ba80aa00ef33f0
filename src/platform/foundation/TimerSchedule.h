#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

namespace orvo {

class NSTimer;

/// The timers of one run loop, the earliest first; of equal dates the one that was put in first.
/// Keeps them alive. Dates are seconds since the reference date. Used on the loop's thread.
class TimerSchedule {
public:
    /// `changed` is called after every change.
    explicit TimerSchedule(std::function<void()> changed)
        : _changed(std::move(changed)) {}

    [[nodiscard]] std::size_t count() const noexcept { return _items.size(); }
    /// The latest moment to wake at that keeps every timer within its tolerance.
    [[nodiscard]] std::optional<double> nextWake() const;
    /// Timers put in from now on have this number or a higher one.
    [[nodiscard]] std::uint64_t nextNumber() const noexcept { return _nextNumber; }
    /// The earliest timer whose date lies before `now`, of those with a lower number. Nil for none.
    [[nodiscard]] std::shared_ptr<NSTimer> firstDue(double now, std::uint64_t belowNumber) const;

    /// Puts a timer in, or in another place. A date that is no number is never reached.
    void put(const std::shared_ptr<NSTimer>& timer, double date, double tolerance);
    void remove(const NSTimer& timer);
    /// Empties the schedule.
    [[nodiscard]] std::vector<std::shared_ptr<NSTimer>> takeAll();

private:
    struct Item {
        double date;
        double tolerance;
        std::uint64_t number;
        std::shared_ptr<NSTimer> timer;
    };
    /// Nil when it is not there.
    std::shared_ptr<NSTimer> take(const NSTimer& timer);

    std::function<void()> _changed;
    std::vector<Item> _items;
    std::uint64_t _nextNumber = 0;
};

} // namespace orvo
