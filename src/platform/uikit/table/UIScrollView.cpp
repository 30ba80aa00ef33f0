#include "platform/uikit/table/UIScrollView.h"

#include <algorithm>

namespace orvo {

namespace {

/// The offset nearest to `offset` at which a stretch is seen, or as much of its beginning as can
/// be.
CGFloat offsetShowing(CGFloat begin, CGFloat length, CGFloat offset, CGFloat shown) {
    if (begin < offset || length > shown)
        return begin;
    return std::max(offset, begin + length - shown);
}

} // namespace

std::shared_ptr<UIScrollView> UIScrollView::init() {
    return initWithFrame({});
}

std::shared_ptr<UIScrollView> UIScrollView::initWithFrame(CGRect frame) {
    auto view = std::make_shared<UIScrollView>();
    return view->_initWithFrame(frame) ? view : nullptr;
}

bool UIScrollView::_initWithFrame(CGRect frame) {
    setClipsToBounds(true);
    return UIView::_initWithFrame(frame);
}

void UIScrollView::setContentSize(CGSize size) {
    if (size == _contentSize)
        return;
    _contentSize = size;
    setContentOffset(contentOffset());
}

void UIScrollView::setContentOffset(CGPoint offset) {
    const auto most = _maximumContentOffset();
    const CGPoint within{std::clamp(offset.x, 0.0, most.x), std::clamp(offset.y, 0.0, most.y)};
    if (within == contentOffset())
        return;
    setBounds({within, frame().size});
    setNeedsLayout();
}

CGPoint UIScrollView::_maximumContentOffset() const noexcept {
    return {std::max(0.0, _contentSize.width - frame().size.width),
            std::max(0.0, _contentSize.height - frame().size.height)};
}

bool UIScrollView::scrollBy(CGPoint distance) {
    const auto before = contentOffset();
    setContentOffset({before.x + distance.x, before.y + distance.y});
    return contentOffset() != before;
}

void UIScrollView::scrollRectToVisible(const CGRect& rect) {
    const auto offset = contentOffset();
    const auto shown = frame().size;
    setContentOffset({offsetShowing(rect.origin.x, rect.size.width, offset.x, shown.width),
                      offsetShowing(rect.origin.y, rect.size.height, offset.y, shown.height)});
}

void UIScrollView::layoutSubviews() {
    UIView::layoutSubviews();
    setContentOffset(contentOffset()); // the view may have become larger
}

} // namespace orvo
