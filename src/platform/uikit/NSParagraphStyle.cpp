#include "platform/uikit/NSParagraphStyle.h"

#include "platform/foundation/Hashing.h"

namespace orvo {

std::shared_ptr<NSParagraphStyle> NSParagraphStyle::defaultParagraphStyle() {
    static const auto style = std::make_shared<NSParagraphStyle>();
    return style;
}

std::shared_ptr<NSObject> NSParagraphStyle::copy() const {
    auto style = std::make_shared<NSParagraphStyle>();
    style->_lineSpacing = _lineSpacing;
    style->_alignment = _alignment;
    style->_lineBreakMode = _lineBreakMode;
    return style;
}

std::shared_ptr<NSMutableParagraphStyle> NSParagraphStyle::mutableCopy() const {
    auto style = std::make_shared<NSMutableParagraphStyle>();
    style->setLineSpacing(_lineSpacing);
    style->setAlignment(_alignment);
    style->setLineBreakMode(_lineBreakMode);
    return style;
}

bool NSParagraphStyle::isEqual(const NSObject* other) const {
    const auto* style = dynamic_cast<const NSParagraphStyle*>(other);
    return style && style->_lineSpacing == _lineSpacing && style->_alignment == _alignment &&
           style->_lineBreakMode == _lineBreakMode;
}

std::uint64_t NSParagraphStyle::hash() const {
    return hashOfDouble(_lineSpacing) ^ ((static_cast<std::uint64_t>(_alignment) << 8 |
                                          static_cast<std::uint64_t>(_lineBreakMode)) *
                                         HashMultiplier);
}

std::string NSParagraphStyle::description() const {
    return rootDescription() + " lineSpacing " + std::to_string(_lineSpacing);
}

} // namespace orvo
