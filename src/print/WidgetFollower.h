#pragma once

#include "platform/foundation/NSTimer.h"
#include "print/PrintedWidget.h"

#include <functional>
#include <memory>

namespace orvo {

class WidgetScene;

/// Goes on asking the widget of a scene for updates, and tells what it shows: when an update has
/// ended, and when an incident begins or ends. Main thread.
class WidgetFollower {
public:
    /// May be told the same twice.
    using Handler = std::function<void(const PrintedWidget& widget)>;

    /// `interval` in seconds, failed updates included. `willUpdate`, which may be empty, is called
    /// before each update.
    WidgetFollower(WidgetScene& scene,
                   NSTimeInterval interval,
                   std::function<void()> willUpdate,
                   Handler handler);
    WidgetFollower(const WidgetFollower&) = delete;
    WidgetFollower& operator=(const WidgetFollower&) = delete;
    ~WidgetFollower();

private:
    struct State;

    std::shared_ptr<State> _state;
    std::shared_ptr<NSTimer> _timer;
};

} // namespace orvo
