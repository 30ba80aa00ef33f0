#include "platform/uikit/UIGeometry.h"

#include "platform/uikit/UIScreen.h"
#include "platform/uikit/UIView.h"

#include <cmath>

namespace orvo {

CGFloat UIRoundToScale(CGFloat value, CGFloat scale) {
    return std::round(value * scale) / scale;
}

CGFloat UIRoundToViewScale(CGFloat value, const UIView* view) {
    return UIRoundToScale(
        value, view ? view->traitCollection().displayScale : UIScreen::mainScreen()->scale());
}

} // namespace orvo
