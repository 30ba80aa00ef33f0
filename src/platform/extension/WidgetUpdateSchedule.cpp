#include "platform/extension/WidgetUpdateSchedule.h"

#include <algorithm>
#include <array>

namespace orvo {

namespace {

constexpr NSTimeInterval Minute = 60;
constexpr std::array Delays{1 * Minute, 2 * Minute, 5 * Minute, 15 * Minute};
/// So that the wake-up can be shared.
constexpr double ToleranceShare = 0.1;

} // namespace

std::shared_ptr<WidgetUpdateSchedule>
WidgetUpdateSchedule::scheduleWithRequest(std::function<void()> request) {
    auto schedule = std::make_shared<WidgetUpdateSchedule>();
    schedule->_request = std::move(request);
    return schedule;
}

WidgetUpdateSchedule::~WidgetUpdateSchedule() {
    if (_retry)
        _retry->invalidate();
}

NSTimeInterval WidgetUpdateSchedule::delayAfter(std::size_t failures) {
    return Delays[std::clamp<std::size_t>(failures, 1, Delays.size()) - 1];
}

void WidgetUpdateSchedule::setVisible(bool visible) {
    if (visible == _visible)
        return;
    _visible = visible;
    endPlan();
    if (visible)
        ask();
}

void WidgetUpdateSchedule::somethingChanged() {
    if (!_visible)
        return;
    endPlan();
    ask();
}

void WidgetUpdateSchedule::didAnswer(bool success) {
    if (success || !_visible) {
        endPlan();
        return;
    }
    // Several requests that ran at once fail together: that is one failure.
    if (_retry)
        return;
    ++_failures;
    const auto delay = delayAfter(_failures);
    _retry = NSTimer::scheduledTimerWithTimeInterval_repeats_block(
        delay, false, [weak = std::weak_ptr<WidgetUpdateSchedule>(strong(this))](const auto&) {
            if (const auto self = weak.lock()) {
                self->_retry = nullptr;
                self->ask();
            }
        });
    _retry->setTolerance(delay * ToleranceShare);
}

void WidgetUpdateSchedule::ask() {
    _request();
}

void WidgetUpdateSchedule::endPlan() {
    _failures = 0;
    if (_retry)
        _retry->invalidate();
    _retry = nullptr;
}

} // namespace orvo
