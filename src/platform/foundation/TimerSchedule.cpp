#include "platform/foundation/TimerSchedule.h"

#include "platform/foundation/NSTimer.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace orvo {

std::optional<double> TimerSchedule::nextWake() const {
    std::optional<double> wake;
    for (const auto& item : _items) {
        const double latest = item.date + item.tolerance;
        wake = std::min(wake.value_or(latest), latest);
    }
    return wake;
}

std::shared_ptr<NSTimer> TimerSchedule::firstDue(double now, std::uint64_t belowNumber) const {
    for (const auto& item : _items) {
        if (!(item.date < now))
            break;
        if (item.number < belowNumber)
            return item.timer;
    }
    return nullptr;
}

void TimerSchedule::put(const std::shared_ptr<NSTimer>& timer, double date, double tolerance) {
    (void)take(*timer);
    if (std::isnan(date))
        date = std::numeric_limits<double>::infinity();
    const auto place = std::ranges::upper_bound(_items, date, {}, &Item::date);
    _items.insert(place, {date, tolerance, _nextNumber++, timer});
    _changed();
}

void TimerSchedule::remove(const NSTimer& timer) {
    const auto removed = take(timer); // goes after the schedule is whole again
    if (removed)
        _changed();
}

std::vector<std::shared_ptr<NSTimer>> TimerSchedule::takeAll() {
    std::vector<std::shared_ptr<NSTimer>> timers;
    for (auto& item : std::exchange(_items, {}))
        timers.push_back(std::move(item.timer));
    return timers;
}

std::shared_ptr<NSTimer> TimerSchedule::take(const NSTimer& timer) {
    const auto found = std::ranges::find(
        _items, &timer, [](const Item& item) -> const NSTimer* { return item.timer.get(); });
    if (found == _items.end())
        return nullptr;
    auto taken = std::move(found->timer);
    _items.erase(found);
    return taken;
}

} // namespace orvo
