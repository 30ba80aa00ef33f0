#include "platform/uikit/UILayoutGuide.h"

#include "platform/uikit/UIView.h"

namespace orvo {

std::shared_ptr<UILayoutGuide> UILayoutGuide::init() {
    return std::make_shared<UILayoutGuide>();
}

UIView* UILayoutGuide::_layoutView() const {
    return _owner.lock().get();
}

} // namespace orvo
