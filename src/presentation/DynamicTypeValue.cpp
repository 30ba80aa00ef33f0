#include "presentation/DynamicTypeValue.h"

#include "platform/uikit/UIFont.h"
#include "platform/uikit/UIGeometry.h"

namespace orvo {

std::shared_ptr<DynamicTypeValue> DynamicTypeValue::init() {
    return std::make_shared<DynamicTypeValue>();
}

double DynamicTypeValue::scaledValue() const {
    const auto font = _fontProvider ? _fontProvider() : nullptr;
    return font ? font->_scaledValueForValue(_unscaledValue) : _unscaledValue;
}

double DynamicTypeValue::_scaledValueForView(const UIView* view) const {
    return UIRoundToViewScale(scaledValue(), view);
}

} // namespace orvo
