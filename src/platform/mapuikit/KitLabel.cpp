#include "platform/mapuikit/KitLabel.h"

namespace orvo {

std::shared_ptr<KitLabel> KitLabel::init() {
    return initWithFrame({});
}

std::shared_ptr<KitLabel> KitLabel::initWithFrame(CGRect frame) {
    auto label = std::make_shared<KitLabel>();
    return label->_initWithFrame(frame) ? label : nullptr;
}

} // namespace orvo
