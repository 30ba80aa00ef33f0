#pragma once

#include "platform/uikit/UILayoutItem.h"

namespace orvo {

/// A rectangle of a layout that shows nothing. Main thread.
class UILayoutGuide : public UILayoutItem {
public:
    [[nodiscard]] static std::shared_ptr<UILayoutGuide> init();

    /// Nil until a view has added it, and when that view has gone.
    [[nodiscard]] std::shared_ptr<UIView> owningView() const { return _owner.lock(); }
    /// In the coordinates of its owner, as of the latest layout pass.
    [[nodiscard]] CGRect layoutFrame() const noexcept { return _layoutFrame; }

    [[nodiscard]] UIView* _layoutView() const override;
    [[nodiscard]] const CGRect& _placedFrame() const override { return _layoutFrame; }
    [[nodiscard]] std::string className() const override { return "UILayoutGuide"; }

private:
    friend class UIView;

    std::weak_ptr<UIView> _owner;
    CGRect _layoutFrame;
};

} // namespace orvo
