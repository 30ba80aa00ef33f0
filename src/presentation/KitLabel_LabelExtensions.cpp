#include "presentation/KitLabel_LabelExtensions.h"

#include "platform/uikit/NSAttributedString.h"
#include "platform/uikit/NSParagraphStyle.h"
#include "platform/uikit/UIFont.h"

namespace orvo::LabelExtensions {

namespace {

/// Nil for an empty text, or one without a style.
std::shared_ptr<NSParagraphStyle>
styleAtBeginning(const std::shared_ptr<NSAttributedString>& text) {
    if (!text || text->length() == 0)
        return nullptr;
    return std::dynamic_pointer_cast<NSParagraphStyle>(
        text->attribute_atIndex_effectiveRange(NSParagraphStyleAttributeName, 0, nullptr));
}

} // namespace

std::shared_ptr<KitLabel> multiLineLabelWithFont(const std::shared_ptr<UIFont>& font) {
    auto label = KitLabel::initWithFrame({});
    label->setLineBreakMode(NSLineBreakByWordWrapping);
    label->setTranslatesAutoresizingMaskIntoConstraints(false);
    label->setNumberOfLines(0);
    label->setTextAlignment(NSTextAlignmentNatural);
    label->setFont(font);
    return label;
}

double _orvo_lineSpacing(const KitLabel& label) {
    const auto style = styleAtBeginning(label.attributedText());
    return style ? style->lineSpacing() : 0.0;
}

void _orvo_setLineSpacing(KitLabel& label, double lineSpacing) {
    const auto text = label.attributedText();
    if (!text || text->length() == 0 || _orvo_lineSpacing(label) == lineSpacing)
        return;
    const auto old = styleAtBeginning(text);
    const auto style = (old ? old : NSParagraphStyle::defaultParagraphStyle())->mutableCopy();
    style->setLineSpacing(lineSpacing);
    const auto changed = text->mutableCopy();
    changed->addAttribute_value_range(NSParagraphStyleAttributeName, style, {0, changed->length()});
    label.setAttributedText(changed);
}

} // namespace orvo::LabelExtensions
