#include "platform/uikit/UIFont.h"

#include "platform/foundation/Hashing.h"
#include "platform/uikit/text/TextMeasurer.h"

namespace orvo {

std::shared_ptr<UIFont> UIFont::preferredFontForTextStyle(UIFontTextStyle style) {
    return fontWithDescriptor_size(UIFontDescriptor::preferredFontDescriptorWithTextStyle(style),
                                   0);
}

std::shared_ptr<UIFont>
UIFont::fontWithDescriptor_size(const std::shared_ptr<UIFontDescriptor>& descriptor,
                                double pointSize) {
    auto font = std::make_shared<UIFont>();
    font->_descriptor = descriptor;
    font->_face = {.pointSize = pointSize > 0 ? pointSize : descriptor->pointSize(),
                   .weight = descriptor->weight()};
    font->_metrics = TextMeasurer::shared().get()->metricsOf(font->_face);
    return font;
}

std::shared_ptr<UIFont> UIFont::systemFontOfSize_weight(double pointSize, int weight) {
    return fontWithDescriptor_size(
        UIFontDescriptor::systemFontDescriptorWithSize_weight(pointSize, weight), 0);
}

double UIFont::_scaledValueForValue(double value) const {
    const auto style = _descriptor->textStyle();
    if (!style)
        return value;
    const auto category = UITraitCollection::system().get().preferredContentSizeCategory;
    return value * pointSizeOf(*style, category) / pointSizeOf(*style, UIContentSizeCategory::L);
}

bool UIFont::isEqual(const NSObject* other) const {
    const auto* font = dynamic_cast<const UIFont*>(other);
    return font && font->_face == _face && equal(font->_descriptor, _descriptor);
}

std::uint64_t UIFont::hash() const {
    return hashOf(_descriptor) ^ hashOfDouble(_face.pointSize);
}

std::string UIFont::description() const {
    return rootDescription() + " " + std::to_string(_face.pointSize) + " weight " +
           std::to_string(_face.weight);
}

} // namespace orvo
