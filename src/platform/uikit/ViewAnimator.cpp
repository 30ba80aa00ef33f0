#include "platform/uikit/ViewAnimator.h"

#include "platform/foundation/Environment.h"
#include "platform/uikit/UIView.h"

#include <algorithm>

namespace orvo {

namespace {

double now() {
    return Environment::monotonicClock().get()->seconds();
}

double easeInOut(double progress) {
    return progress * progress * (3 - 2 * progress);
}

} // namespace

EnvironmentSlot<std::shared_ptr<ViewAnimator>>& ViewAnimator::shared() {
    static EnvironmentSlot<std::shared_ptr<ViewAnimator>> slot(
        [] { return std::make_shared<ViewAnimator>(); });
    return slot;
}

void ViewAnimator::setFrameRequest(std::function<void()> requestFrame) {
    _requestFrame = std::move(requestFrame);
    if (_requestFrame)
        return;
    const auto changes = std::exchange(_changes, {});
    for (const auto& change : changes) {
        if (const auto view = change->view.lock())
            change->step(1);
    }
}

void ViewAnimator::animate(
    UIView& view, const std::string& name, double delay, double seconds, Step step) {
    cancel(view, name);
    if (!_requestFrame || view.traitCollection().reducesMotion) {
        step(1);
        return;
    }
    const bool wasRunning = isRunning();
    auto change = std::make_shared<Change>();
    change->view = strong(&view);
    change->name = name;
    change->start = now() + delay;
    change->seconds = seconds;
    change->step = std::move(step);
    _changes.push_back(change);
    change->step(0);
    if (!wasRunning && _requestFrame)
        _requestFrame();
}

void ViewAnimator::cancel(const UIView& view, const std::string& name) {
    std::erase_if(_changes, [&](const auto& change) {
        return change->view.lock().get() == &view && change->name == name;
    });
}

void ViewAnimator::advance() {
    const double time = now();
    // A step may begin or cancel changes.
    const auto changes = _changes;
    for (const auto& change : changes) {
        if (std::ranges::find(_changes, change) == _changes.end())
            continue;
        const auto view = change->view.lock();
        const double passed = time - change->start;
        const bool ends = !view || passed >= change->seconds;
        if (ends)
            std::erase(_changes, change);
        if (view && passed >= 0)
            change->step(ends ? 1 : easeInOut(passed / change->seconds));
    }
}

} // namespace orvo
