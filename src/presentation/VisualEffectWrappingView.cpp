#include "presentation/VisualEffectWrappingView.h"

namespace orvo {

std::shared_ptr<VisualEffectWrappingView>
VisualEffectWrappingView::initWithEffect(const std::shared_ptr<UIVibrancyEffect>& effect) {
    auto view = std::make_shared<VisualEffectWrappingView>();
    return view->_initWithEffect(effect) ? view : nullptr;
}

void VisualEffectWrappingView::setWrappedView(const std::shared_ptr<UIView>& view) {
    if (view == _wrappedView)
        return;
    if (_wrappedView && _wrappedView->superview() == contentView())
        _wrappedView->removeFromSuperview();
    _wrappedView = view;
    if (!view)
        return;
    view->setTranslatesAutoresizingMaskIntoConstraints(false);
    contentView()->addSubview(view);
    // To the effect view, which others constrain; what its content view's size is, is its affair.
    NSLayoutConstraint::activateConstraints({
        view->leadingAnchor().constraintEqualToAnchor(leadingAnchor()),
        view->trailingAnchor().constraintEqualToAnchor(trailingAnchor()),
        view->topAnchor().constraintEqualToAnchor(topAnchor()),
        view->bottomAnchor().constraintEqualToAnchor(bottomAnchor()),
    });
}

std::shared_ptr<UIView> VisualEffectWrappingView::viewForFirstBaselineLayout() {
    return _wrappedView;
}

std::shared_ptr<UIView> VisualEffectWrappingView::viewForLastBaselineLayout() {
    return _wrappedView;
}

} // namespace orvo
