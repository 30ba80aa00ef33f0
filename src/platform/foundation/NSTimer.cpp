#include "platform/foundation/NSTimer.h"

#include "platform/foundation/Environment.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/RunLoop.h"
#include "platform/foundation/TimerSchedule.h"

#include <cmath>
#include <fmt/format.h>
#include <limits>

namespace orvo {

namespace {

constexpr NSTimeInterval ShortestInterval = 0.0001;

/// The first of `date`, `date + interval`, `date + 2 interval`, … that lies after `now`.
double dateAfter(double date, NSTimeInterval interval, double now) {
    const double passed = std::floor((now - date) / interval);
    const double next = date + std::max(passed + 1, 1.0) * interval;
    if (std::isfinite(next) && next <= now) // the interval is too short for a date to tell
        return std::nextafter(now, std::numeric_limits<double>::infinity());
    return next;
}

} // namespace

struct NSTimer::Private {
    NSTimeInterval interval = 0;
    bool repeats = false;
    Block block; // empty when invalid
    std::shared_ptr<NSObject> userInfo;
    double date = 0;
    NSTimeInterval tolerance = 0;
    bool calling = false;
    std::weak_ptr<TimerSchedule> schedule;
};

NSTimer::NSTimer()
    : _private(std::make_unique<Private>()) {}

NSTimer::~NSTimer() = default;

std::shared_ptr<NSTimer> NSTimer::scheduledTimerWithTimeInterval_target_selector_userInfo_repeats(
    NSTimeInterval interval,
    std::shared_ptr<NSObject> target,
    Selector selector,
    std::shared_ptr<NSObject> userInfo,
    bool repeats) {
    if (!target)
        throw NSInvalidArgumentException("a timer needs a target");
    if (!target->respondsToSelector(selector))
        throw NSInvalidArgumentException(fmt::format(
            "a timer's target of class {} has no method {}", target->className(), selector.name()));
    auto timer = scheduledTimerWithTimeInterval_repeats_block(
        interval,
        repeats,
        [target = std::move(target),
         selector = std::move(selector)](const std::shared_ptr<NSTimer>& sender) {
            target->performSelector_withObject(selector, sender);
        });
    timer->_private->userInfo = std::move(userInfo);
    return timer;
}

std::shared_ptr<NSTimer> NSTimer::scheduledTimerWithTimeInterval_repeats_block(
    NSTimeInterval interval, bool repeats, Block block) {
    if (!block)
        throw NSInvalidArgumentException("a timer needs a block");
    auto timer = std::make_shared<NSTimer>();
    auto& self = *timer->_private;
    self.interval = interval > 0 ? interval : ShortestInterval;
    self.repeats = repeats;
    self.block = std::move(block);
    self.date = Environment::wallClock().get()->timeIntervalSinceReferenceDate() + self.interval;
    self.schedule = RunLoop::current().timers();
    timer->reschedule();
    return timer;
}

NSTimeInterval NSTimer::timeInterval() const noexcept {
    return _private->repeats ? _private->interval : 0;
}

bool NSTimer::repeats() const noexcept {
    return _private->repeats;
}

std::shared_ptr<NSObject> NSTimer::userInfo() const {
    return _private->userInfo;
}

std::shared_ptr<NSDate> NSTimer::fireDate() const {
    return NSDate::dateWithTimeIntervalSinceReferenceDate(_private->date);
}

void NSTimer::setFireDate(const std::shared_ptr<NSDate>& date) {
    if (!date)
        throw NSInvalidArgumentException("a timer needs a fire date");
    if (!isValid())
        return;
    _private->date = date->timeIntervalSinceReferenceDate();
    reschedule();
}

NSTimeInterval NSTimer::tolerance() const noexcept {
    return _private->tolerance;
}

void NSTimer::setTolerance(NSTimeInterval seconds) {
    _private->tolerance = seconds > 0 ? seconds : 0;
    if (isValid())
        reschedule();
}

bool NSTimer::isValid() const noexcept {
    return static_cast<bool>(_private->block);
}

void NSTimer::fire() {
    if (isValid())
        call();
}

void NSTimer::invalidate() {
    const auto self = strong(this); // the schedule may have held the last reference
    if (const auto schedule = _private->schedule.lock())
        schedule->remove(*this);
    const auto released = std::exchange(_private->block, nullptr);
    _private->userInfo = nullptr;
}

void NSTimer::reachDate(double now) {
    if (_private->repeats) {
        _private->date = dateAfter(_private->date, _private->interval, now);
        reschedule();
    }
    if (!_private->calling) // a callback that turns the run loop is not called inside itself
        call();
}

void NSTimer::call() {
    const auto self = strong(this);
    const auto block = _private->block; // stays whole when it invalidates the timer
    if (!_private->repeats)
        if (const auto schedule = _private->schedule.lock())
            schedule->remove(*this);
    _private->calling = true;
    block(self);
    _private->calling = false;
    if (!_private->repeats)
        invalidate();
}

void NSTimer::reschedule() {
    if (const auto schedule = _private->schedule.lock())
        schedule->put(strong(this), _private->date, _private->tolerance);
}

} // namespace orvo
