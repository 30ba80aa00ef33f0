#include "print/WidgetFollower.h"

#include "platform/foundation/DispatchQueue.h"
#include "print/WidgetScene.h"

namespace orvo {

/// What calls that come later need; they find it gone when the follower is.
struct WidgetFollower::State {
    WidgetScene& scene;
    std::function<void()> willUpdate;
    Handler handler;
    bool hasRows = false;

    void tell() const {
        if (hasRows)
            handler(scene.printed());
    }
};

WidgetFollower::WidgetFollower(WidgetScene& scene,
                               NSTimeInterval interval,
                               std::function<void()> willUpdate,
                               Handler handler)
    : _state(std::make_shared<State>(State{
          .scene = scene, .willUpdate = std::move(willUpdate), .handler = std::move(handler)})) {
    const std::weak_ptr<State> weak = _state;
    const auto update = [weak] {
        const auto state = weak.lock();
        if (!state)
            return;
        if (state->willUpdate)
            state->willUpdate();
        state->scene.host()->requestUpdate([weak](NCUpdateResult) {
            if (const auto answered = weak.lock()) {
                answered->hasRows = true;
                answered->tell();
            }
        });
    };
    // In the turn after: while it speaks, the widget is still changing.
    scene.host()->setContentTold([weak] {
        DispatchQueue::mainQueue()->async([weak] {
            if (const auto state = weak.lock())
                state->tell();
        });
    });
    update();
    _timer = NSTimer::scheduledTimerWithTimeInterval_repeats_block(
        interval, true, [update](const auto&) { update(); });
}

WidgetFollower::~WidgetFollower() {
    _timer->invalidate();
    _state->scene.host()->setContentTold({});
}

} // namespace orvo
