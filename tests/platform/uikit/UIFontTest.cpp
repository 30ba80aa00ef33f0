#include "platform/uikit/UIFont.h"

#include "ViewTest.h"

#include <array>

namespace orvo {
namespace {

class FontTest : public testing::ViewTest {
protected:
    static auto in(UIContentSizeCategory category) {
        return UITraitCollection::system().overrideWith({.preferredContentSizeCategory = category});
    }
};

TEST_F(FontTest, TextStylesHaveTheirSizeInEachOfTheTwelveCategories) {
    constexpr std::array Body{
        14.0, 15.0, 16.0, 17.0, 19.0, 21.0, 23.0, 28.0, 33.0, 40.0, 47.0, 53.0};
    constexpr std::array Subheadline{
        12.0, 13.0, 14.0, 15.0, 17.0, 19.0, 21.0, 25.0, 30.0, 36.0, 42.0, 49.0};
    for (const auto category : AllContentSizeCategories) {
        const auto index = static_cast<std::size_t>(category);
        const auto scope = in(category);
        EXPECT_EQ(UIFont::preferredFontForTextStyle(UIFontTextStyleHeadline)->pointSize(),
                  Body.at(index))
            << nameOf(category);
        EXPECT_EQ(UIFont::preferredFontForTextStyle(UIFontTextStyleBody)->pointSize(),
                  Body.at(index));
        EXPECT_EQ(UIFont::preferredFontForTextStyle(UIFontTextStyleSubheadline)->pointSize(),
                  Subheadline.at(index));
    }
}

TEST_F(FontTest, LengthsScaleWithTheStyleFromTheDefaultCategory) {
    const auto scaled = [](UIContentSizeCategory category, UIFontTextStyle style, double value) {
        const auto scope = in(category);
        return UIFont::preferredFontForTextStyle(style)->_scaledValueForValue(value);
    };
    EXPECT_DOUBLE_EQ(scaled(UIContentSizeCategory::L, UIFontTextStyleHeadline, 21), 21);
    EXPECT_DOUBLE_EQ(scaled(UIContentSizeCategory::AX5, UIFontTextStyleHeadline, 17), 53);
    EXPECT_DOUBLE_EQ(scaled(UIContentSizeCategory::XS, UIFontTextStyleSubheadline, 30), 24);
}

TEST_F(FontTest, LengthsFollowTheCategoryOfNowNotThatOfTheFont) {
    const auto font = UIFont::preferredFontForTextStyle(UIFontTextStyleBody);
    const auto scope = in(UIContentSizeCategory::AX5);
    EXPECT_DOUBLE_EQ(font->_scaledValueForValue(17), 53);
}

TEST_F(FontTest, FixedSizeScalesNothing) {
    const auto scope = in(UIContentSizeCategory::AX5);
    EXPECT_EQ(UIFont::systemFontOfSize_weight(13, 500)->_scaledValueForValue(10), 10);
}

TEST_F(FontTest, BoldTraitMakesTheSameStyleBold) {
    const auto plain =
        UIFontDescriptor::preferredFontDescriptorWithTextStyle(UIFontTextStyleHeadline);
    const auto bold = plain->fontDescriptorWithSymbolicTraits(UIFontDescriptorTraitBold);
    EXPECT_EQ(plain->weight(), 600);
    EXPECT_EQ(bold->weight(), 700);
    EXPECT_EQ(bold->symbolicTraits(), 2U);
    EXPECT_EQ(bold->textStyle(), UIFontTextStyleHeadline);
    const auto font = UIFont::fontWithDescriptor_size(bold, 0);
    EXPECT_EQ(font->face(), (FontFace{.pointSize = 17, .weight = 700}));
    EXPECT_EQ(UIFont::fontWithDescriptor_size(bold, 20)->pointSize(), 20);
}

TEST_F(FontTest, MetricsAreThoseOfTheMeasurer) {
    const auto font = UIFont::systemFontOfSize_weight(10, 400);
    EXPECT_EQ(font->ascender(), 8);
    EXPECT_EQ(font->descender(), -2);
    EXPECT_EQ(font->capHeight(), 7);
    EXPECT_EQ(font->leading(), 0);
    EXPECT_EQ(font->lineHeight(), 10);
}

TEST_F(FontTest, FontsAreEqualByWhatTheyAre) {
    const auto a = UIFont::preferredFontForTextStyle(UIFontTextStyleBody);
    const auto b = UIFont::preferredFontForTextStyle(UIFontTextStyleBody);
    const auto c = UIFont::preferredFontForTextStyle(UIFontTextStyleHeadline);
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_EQ(a->hash(), b->hash());
    EXPECT_FALSE(a->isEqual(c.get()));
    EXPECT_FALSE(a->isEqual(nullptr));
    const auto fixed = UIFont::systemFontOfSize_weight(17, 400);
    EXPECT_FALSE(a->isEqual(fixed.get())); // one grows, the other does not
}

TEST(ContentSizeCategory, IsFoundByItsName) {
    EXPECT_EQ(contentSizeCategoryNamed("XS"), UIContentSizeCategory::XS);
    EXPECT_EQ(contentSizeCategoryNamed("AX5"), UIContentSizeCategory::AX5);
    for (const auto category : AllContentSizeCategories)
        EXPECT_EQ(contentSizeCategoryNamed(nameOf(category)), category);
    EXPECT_EQ(contentSizeCategoryNamed("xs"), std::nullopt);
    EXPECT_EQ(contentSizeCategoryNamed(""), std::nullopt);
}

} // namespace
} // namespace orvo
