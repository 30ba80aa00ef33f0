#pragma once

#include "platform/uikit/UIView.h"

namespace orvo {

/// Shows a part of what may be larger than itself. Main thread.
class UIScrollView : public UIView {
public:
    [[nodiscard]] static std::shared_ptr<UIScrollView> init();
    [[nodiscard]] static std::shared_ptr<UIScrollView> initWithFrame(CGRect frame);

    [[nodiscard]] CGSize contentSize() const noexcept { return _contentSize; }
    /// The offset stays within it.
    void setContentSize(CGSize size);
    /// What of the content stands at the top left.
    [[nodiscard]] CGPoint contentOffset() const noexcept { return bounds().origin; }
    /// The nearest offset that shows content only.
    void setContentOffset(CGPoint offset);
    /// The offset at the far end; 0 along a side on which everything is seen.
    [[nodiscard]] CGPoint _maximumContentOffset() const noexcept;

    /// Moves the content by a distance, to higher offsets where that is positive: a wheel, two
    /// fingers. Answers whether it moved; a host passes on what did not.
    virtual bool scrollBy(CGPoint distance);
    /// As little as is needed; where it does not fit, its top.
    void scrollRectToVisible(const CGRect& rect);

    void layoutSubviews() override;
    [[nodiscard]] std::string className() const override { return "UIScrollView"; }

protected:
    bool _initWithFrame(CGRect frame);

private:
    CGSize _contentSize;
};

} // namespace orvo
