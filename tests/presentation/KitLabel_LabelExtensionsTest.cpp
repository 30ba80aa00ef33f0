#include "presentation/KitLabel_LabelExtensions.h"

#include "platform/foundation/Exceptions.h"
#include "platform/uikit/NSAttributedString.h"
#include "platform/uikit/NSParagraphStyle.h"
#include "platform/uikit/UIFont.h"

#include <gtest/gtest.h>

#include <string>

namespace orvo {
namespace {

using namespace LabelExtensions;

/// Counts how often its text is set.
class CountingLabel final : public KitLabel {
public:
    void setAttributedText(const std::shared_ptr<NSAttributedString>& text) override {
        ++assignments;
        KitLabel::setAttributedText(text);
    }
    int assignments = 0;
};

std::shared_ptr<NSParagraphStyle> style(double lineSpacing, NSTextAlignment alignment) {
    auto style = NSParagraphStyle::defaultParagraphStyle()->mutableCopy();
    style->setLineSpacing(lineSpacing);
    style->setAlignment(alignment);
    return style;
}

std::shared_ptr<NSParagraphStyle> styleAt(const KitLabel& label, std::size_t index) {
    return std::dynamic_pointer_cast<NSParagraphStyle>(
        label.attributedText()->attribute_atIndex_effectiveRange(
            NSParagraphStyleAttributeName, index, nullptr));
}

std::shared_ptr<NSAttributedString> twoStyles() {
    auto text = NSAttributedString::initWithString("one two")->mutableCopy();
    text->addAttribute_value_range(
        NSParagraphStyleAttributeName, style(3, NSTextAlignment::Center), {0, 3});
    text->addAttribute_value_range(
        NSParagraphStyleAttributeName, style(9, NSTextAlignment::Right), {3, 4});
    return text;
}

TEST(KitLabelLabelExtensions, AMultiLineLabelWrapsWordsAndIsPlacedByConstraints) {
    const auto font = UIFont::preferredFontForTextStyle(UIFontTextStyle::Body);
    const auto label = multiLineLabelWithFont(font);
    EXPECT_EQ(label->frame(), CGRect{});
    EXPECT_EQ(label->lineBreakMode(), NSLineBreakByWordWrapping);
    EXPECT_FALSE(label->translatesAutoresizingMaskIntoConstraints());
    EXPECT_EQ(label->numberOfLines(), 0);
    EXPECT_EQ(static_cast<int>(label->textAlignment()), 4);
    EXPECT_EQ(label->font(), font);
    EXPECT_EQ(label->className(), "KitLabel");
}

TEST(KitLabelLabelExtensions, LineSpacingIsThatOfTheBeginning) {
    const auto label = KitLabel::init();
    EXPECT_EQ(_orvo_lineSpacing(*label), 0);
    label->setAttributedText(NSAttributedString::initWithString(""));
    EXPECT_EQ(_orvo_lineSpacing(*label), 0);
    label->setAttributedText(NSAttributedString::initWithString("no style"));
    EXPECT_EQ(_orvo_lineSpacing(*label), 0);
    label->setAttributedText(twoStyles());
    EXPECT_EQ(_orvo_lineSpacing(*label), 3);
}

TEST(KitLabelLabelExtensions, SettingLineSpacingTakesTheFirstStyleForTheWholeText) {
    const auto label = KitLabel::init();
    label->setAttributedText(twoStyles());
    _orvo_setLineSpacing(*label, 5);
    for (const std::size_t index : {0U, 6U}) {
        EXPECT_EQ(styleAt(*label, index)->lineSpacing(), 5);
        EXPECT_EQ(styleAt(*label, index)->alignment(), NSTextAlignment::Center);
    }
    EXPECT_EQ(label->attributedText()->string(), "one two");
}

TEST(KitLabelLabelExtensions, WithoutAStyleTheDefaultOneIsTaken) {
    const auto label = KitLabel::init();
    label->setAttributedText(NSAttributedString::initWithString("text"));
    _orvo_setLineSpacing(*label, 5);
    EXPECT_EQ(_orvo_lineSpacing(*label), 5);
    EXPECT_EQ(NSParagraphStyle::defaultParagraphStyle()->lineSpacing(), 0);
}

TEST(KitLabelLabelExtensions, SettingTheSameLineSpacingDoesNotReassignTheText) {
    const auto label = std::make_shared<CountingLabel>();
    label->setAttributedText(twoStyles());
    _orvo_setLineSpacing(*label, 3);
    EXPECT_EQ(label->assignments, 1);
    _orvo_setLineSpacing(*label, 4);
    EXPECT_EQ(label->assignments, 2);
    _orvo_setLineSpacing(*label, 4);
    EXPECT_EQ(label->assignments, 2);
}

TEST(KitLabelLabelExtensions, AnEmptyTextStaysAsItIs) {
    const auto label = std::make_shared<CountingLabel>();
    _orvo_setLineSpacing(*label, 4);
    EXPECT_EQ(label->attributedText(), nullptr);
    label->setAttributedText(NSAttributedString::initWithString(""));
    _orvo_setLineSpacing(*label, 4);
    EXPECT_EQ(label->assignments, 1);
}

} // namespace
} // namespace orvo
