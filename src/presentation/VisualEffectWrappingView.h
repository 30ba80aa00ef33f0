#pragma once

#include "platform/uikit/UIVisualEffectView.h"

namespace orvo {

/// Shows one view in the look of an effect, and stands for it in layout: its baselines are those of
/// the view. Main thread.
class VisualEffectWrappingView : public UIVisualEffectView {
public:
    /// Nothing is wrapped yet.
    [[nodiscard]] static std::shared_ptr<VisualEffectWrappingView>
    initWithEffect(const std::shared_ptr<UIVibrancyEffect>& effect);

    /// Nil: none.
    [[nodiscard]] const std::shared_ptr<UIView>& wrappedView() const noexcept {
        return _wrappedView;
    }
    /// Fills the effect view with it. The view before it goes, unless it lies elsewhere by now. The
    /// same view again does nothing.
    void setWrappedView(const std::shared_ptr<UIView>& view);

    /// The wrapped view, nil without one.
    [[nodiscard]] std::shared_ptr<UIView> viewForFirstBaselineLayout() override;
    [[nodiscard]] std::shared_ptr<UIView> viewForLastBaselineLayout() override;
    [[nodiscard]] std::string className() const override { return "VisualEffectWrappingView"; }

private:
    std::shared_ptr<UIView> _wrappedView;
};

} // namespace orvo
