#include "platform/uikit/NSAttributedString.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"
#include "platform/uikit/NSParagraphStyle.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

std::shared_ptr<NSObject> mark(const char* text) {
    return NSString::string(text);
}

std::string nameAt(const NSAttributedString& text, std::size_t index, NSRange* range = nullptr) {
    return descriptionOf(text.attribute_atIndex_effectiveRange("name", index, range));
}

TEST(NSAttributedString, RunsCoverTheTextWithoutAGap) {
    const auto text = NSAttributedString::initWithString("abcdef")->mutableCopy();
    text->addAttribute_value_range("name", mark("x"), {2, 2});
    ASSERT_EQ(text->runs().size(), 3U);
    EXPECT_EQ(text->runs()[0].range, (NSRange{0, 2}));
    EXPECT_EQ(text->runs()[1].range, (NSRange{2, 2}));
    EXPECT_EQ(text->runs()[2].range, (NSRange{4, 2}));
    NSRange range;
    EXPECT_EQ(nameAt(*text, 3, &range), "x");
    EXPECT_EQ(range, (NSRange{2, 2}));
    EXPECT_EQ(nameAt(*text, 4), "(null)");
}

TEST(NSAttributedString, AttributeOverTheWholeReplacesThoseFurtherOn) {
    const auto text = NSAttributedString::initWithString("abcdef")->mutableCopy();
    text->addAttribute_value_range("name", mark("x"), {0, 3});
    text->addAttribute_value_range("name", mark("y"), {3, 3});
    text->addAttribute_value_range("name", mark("z"), {0, 6});
    ASSERT_EQ(text->runs().size(), 1U);
    EXPECT_EQ(nameAt(*text, 5), "z");
}

TEST(NSAttributedString, NeighboursThatAreAlikeAreOneRun) {
    const auto text = NSAttributedString::initWithString("abcdef")->mutableCopy();
    text->addAttribute_value_range("name", mark("x"), {0, 3});
    text->addAttribute_value_range("name", mark("x"), {3, 3});
    EXPECT_EQ(text->runs().size(), 1U);
}

TEST(NSAttributedString, CopiesDoNotFollowTheirOriginal) {
    const auto text = NSAttributedString::initWithString("abc")->mutableCopy();
    const auto copy = std::dynamic_pointer_cast<NSAttributedString>(text->copy());
    EXPECT_TRUE(copy->isEqual(text.get()));
    EXPECT_EQ(copy->hash(), text->hash());
    text->addAttribute_value_range("name", mark("x"), {0, 3});
    EXPECT_FALSE(copy->isEqual(text.get()));
    EXPECT_FALSE(text->isEqual(copy.get()));
}

TEST(NSAttributedString, PastTheEndIsAProgrammingError) {
    const auto text = NSAttributedString::initWithString("abc")->mutableCopy();
    EXPECT_THROW(std::ignore = nameAt(*text, 3), NSInvalidArgumentException);
    EXPECT_THROW(text->addAttribute_value_range("name", mark("x"), {2, 2}),
                 NSInvalidArgumentException);
    EXPECT_THROW(text->addAttribute_value_range("name", mark("x"), {4, 0}),
                 NSInvalidArgumentException);
    EXPECT_THROW(text->addAttribute_value_range("name", nullptr, {0, 1}),
                 NSInvalidArgumentException);
}

TEST(NSAttributedString, EmptyTextHasNoRuns) {
    EXPECT_TRUE(NSAttributedString::initWithString("")->runs().empty());
}

TEST(NSParagraphStyle, DefaultIsNaturalAndUnspaced) {
    const auto style = NSParagraphStyle::defaultParagraphStyle();
    EXPECT_EQ(style->lineSpacing(), 0);
    EXPECT_EQ(style->alignment(), NSTextAlignmentNatural);
    EXPECT_EQ(style->lineBreakMode(), NSLineBreakByWordWrapping);
    EXPECT_EQ(style, NSParagraphStyle::defaultParagraphStyle());
}

TEST(NSParagraphStyle, MutableCopyIsEqualUntilItChanges) {
    const auto style = NSParagraphStyle::defaultParagraphStyle();
    const auto copy = style->mutableCopy();
    EXPECT_TRUE(copy->isEqual(style.get()));
    EXPECT_EQ(copy->hash(), style->hash());
    copy->setLineSpacing(3);
    EXPECT_FALSE(copy->isEqual(style.get()));
    EXPECT_EQ(style->lineSpacing(), 0);
    const auto back = std::dynamic_pointer_cast<NSParagraphStyle>(copy->copy());
    EXPECT_EQ(back->lineSpacing(), 3);
    EXPECT_EQ(std::dynamic_pointer_cast<NSMutableParagraphStyle>(back), nullptr);
}

} // namespace
} // namespace orvo
