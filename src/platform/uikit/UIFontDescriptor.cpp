#include "platform/uikit/UIFontDescriptor.h"

#include "platform/foundation/Hashing.h"

#include <array>

namespace orvo {

namespace {

constexpr std::size_t Categories = AllContentSizeCategories.size();
// Headlines are as large as the body and stand out by their weight.
constexpr std::array<double, Categories> BodySizes{14, 15, 16, 17, 19, 21, 23, 28, 33, 40, 47, 53};
constexpr std::array<double, Categories> SubheadlineSizes{
    12, 13, 14, 15, 17, 19, 21, 25, 30, 36, 42, 49};

constexpr int RegularWeight = 400;
constexpr int HeadlineWeight = 600;
constexpr int BoldWeight = 700;

} // namespace

std::string_view nameOf(UIFontTextStyle style) {
    switch (style) {
    case UIFontTextStyle::Headline:
        return "Headline";
    case UIFontTextStyle::Subheadline:
        return "Subheadline";
    case UIFontTextStyle::Body:
        break;
    }
    return "Body";
}

double pointSizeOf(UIFontTextStyle style, UIContentSizeCategory category) {
    const auto& sizes = style == UIFontTextStyle::Subheadline ? SubheadlineSizes : BodySizes;
    return sizes.at(static_cast<std::size_t>(category));
}

std::shared_ptr<UIFontDescriptor>
UIFontDescriptor::preferredFontDescriptorWithTextStyle(UIFontTextStyle style) {
    return preferredFontDescriptorWithTextStyle_compatibleWithTraitCollection(
        style, UITraitCollection::system().get());
}

std::shared_ptr<UIFontDescriptor>
UIFontDescriptor::preferredFontDescriptorWithTextStyle_compatibleWithTraitCollection(
    UIFontTextStyle style, const UITraitCollection& traits) {
    auto descriptor = std::make_shared<UIFontDescriptor>();
    descriptor->_textStyle = style;
    descriptor->_pointSize = pointSizeOf(style, traits.preferredContentSizeCategory);
    descriptor->_weight = style == UIFontTextStyle::Headline ? HeadlineWeight : RegularWeight;
    return descriptor;
}

std::shared_ptr<UIFontDescriptor>
UIFontDescriptor::systemFontDescriptorWithSize_weight(double pointSize, int weight) {
    auto descriptor = std::make_shared<UIFontDescriptor>();
    descriptor->_pointSize = pointSize;
    descriptor->_weight = weight;
    return descriptor;
}

int UIFontDescriptor::weight() const noexcept {
    return (_traits & UIFontDescriptorTraitBold) != 0 ? BoldWeight : _weight;
}

std::shared_ptr<UIFontDescriptor>
UIFontDescriptor::fontDescriptorWithSymbolicTraits(UIFontDescriptorSymbolicTraits traits) const {
    auto descriptor = std::make_shared<UIFontDescriptor>();
    descriptor->_textStyle = _textStyle;
    descriptor->_pointSize = _pointSize;
    descriptor->_weight = _weight;
    descriptor->_traits = traits;
    return descriptor;
}

bool UIFontDescriptor::isEqual(const NSObject* other) const {
    const auto* descriptor = dynamic_cast<const UIFontDescriptor*>(other);
    return descriptor && descriptor->_textStyle == _textStyle &&
           descriptor->_pointSize == _pointSize && descriptor->_weight == _weight &&
           descriptor->_traits == _traits;
}

std::uint64_t UIFontDescriptor::hash() const {
    return hashOfDouble(_pointSize) ^
           ((static_cast<std::uint64_t>(_weight) << 8 | _traits) * HashMultiplier);
}

std::string UIFontDescriptor::description() const {
    const std::string style = _textStyle ? std::string(nameOf(*_textStyle)) : "System";
    return rootDescription() + " " + style + " " + std::to_string(_pointSize) + " weight " +
           std::to_string(weight());
}

} // namespace orvo
