#include "presentation/HeightConstrainedView.h"

namespace orvo {

std::shared_ptr<HeightConstrainedView> HeightConstrainedView::init() {
    return initWithFrame({});
}

std::shared_ptr<HeightConstrainedView> HeightConstrainedView::initWithFrame(CGRect frame) {
    auto view = std::make_shared<HeightConstrainedView>();
    return view->_initWithFrame(frame) ? view : nullptr;
}

const std::shared_ptr<NSLayoutConstraint>& HeightConstrainedView::heightConstraint() {
    if (!_heightConstraint)
        _heightConstraint = heightAnchor().constraintEqualToConstant(0);
    return _heightConstraint;
}

} // namespace orvo
