#pragma once

#include "platform/foundation/NSTimer.h"

#include <functional>
#include <memory>

namespace orvo {

/// Decides when a widget is asked for an update: when something speaks for it, and again some time
/// after an answer that was a failure. Only while the widget is visible. Main thread.
class WidgetUpdateSchedule final : public virtual NSObject {
public:
    /// `request` asks the widget, which answers through `didAnswer` later.
    [[nodiscard]] static std::shared_ptr<WidgetUpdateSchedule>
    scheduleWithRequest(std::function<void()> request);
    ~WidgetUpdateSchedule() override;

    /// Becoming visible asks at once; becoming invisible ends what was planned.
    void setVisible(bool visible);
    /// The machine woke, or the network is another one: asks at once, where the widget is visible.
    void somethingChanged();
    /// After a failure it plans to ask again; a success ends that.
    void didAnswer(bool success);

    /// Seconds from the failure number `failures`, counted from 1, to the next question.
    [[nodiscard]] static NSTimeInterval delayAfter(std::size_t failures);

private:
    void ask();
    void endPlan();

    std::function<void()> _request;
    std::shared_ptr<NSTimer> _retry;
    std::size_t _failures = 0;
    bool _visible = false;
};

} // namespace orvo
