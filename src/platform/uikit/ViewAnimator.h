#pragma once

#include "platform/foundation/EnvironmentSlot.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace orvo {

class UIView;

/// Changes of views that take a moment. It draws nothing itself: whoever shows views asks for
/// frames through it and moves it on before each of them. Where nobody does (prints, snapshots),
/// and where the view's traits ask for less motion, a change happens at once. Main thread.
class ViewAnimator {
public:
    /// `progress` goes from 0 to 1, slowly at both ends.
    using Step = std::function<void(double progress)>;

    /// What all views use. Default: one that nobody asks for frames.
    static EnvironmentSlot<std::shared_ptr<ViewAnimator>>& shared();

    /// `requestFrame` is called when frames are needed and were not, never inside `advance`. Empty:
    /// no more frames come, and what runs ends at once.
    void setFrameRequest(std::function<void()> requestFrame);

    /// Calls `step` with 0 now, then in every frame after `delay` seconds, and with 1 when
    /// `seconds` more have passed. It takes the place of a change of the same view and name that
    /// still runs, whose end never comes. A view that goes takes its changes along.
    void animate(UIView& view, const std::string& name, double delay, double seconds, Step step);
    /// Ends the change where it is. Nothing where none runs.
    void cancel(const UIView& view, const std::string& name);

    /// Whether frames are still needed.
    [[nodiscard]] bool isRunning() const noexcept { return !_changes.empty(); }
    /// Brings every change to where it is now by the monotonic clock of the environment.
    void advance();

private:
    struct Change {
        std::weak_ptr<UIView> view;
        std::string name;
        double start = 0;
        double seconds = 0;
        Step step;
    };

    std::function<void()> _requestFrame;
    std::vector<std::shared_ptr<Change>> _changes; // in order of their beginning
};

} // namespace orvo
