#pragma once

#include "platform/uikit/UIView.h"

namespace orvo {

/// A view with a constraint of its height at hand, for those who want to give it one. No screen
/// uses it at present. Main thread.
class HeightConstrainedView : public UIView {
public:
    [[nodiscard]] static std::shared_ptr<HeightConstrainedView> init();
    [[nodiscard]] static std::shared_ptr<HeightConstrainedView> initWithFrame(CGRect frame);

    /// Its height is 0. Made when first asked for, always the same one, inactive until somebody
    /// activates it.
    [[nodiscard]] const std::shared_ptr<NSLayoutConstraint>& heightConstraint();
    [[nodiscard]] std::string className() const override { return "HeightConstrainedView"; }

private:
    std::shared_ptr<NSLayoutConstraint> _heightConstraint;
};

} // namespace orvo
