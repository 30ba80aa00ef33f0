#include "platform/settings/DesktopAppearance.h"

#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <limits>

namespace orvo {
namespace {

using Category = UIContentSizeCategory;

TEST(DesktopAppearance, TextScalesBecomeTheNearestCategory) {
    EXPECT_EQ(contentSizeCategoryForTextScale(1), Category::L);
    EXPECT_EQ(contentSizeCategoryForTextScale(1.02), Category::L);
    EXPECT_EQ(contentSizeCategoryForTextScale(0.95), Category::M);
    EXPECT_EQ(contentSizeCategoryForTextScale(0.5), Category::XS);
    EXPECT_EQ(contentSizeCategoryForTextScale(1.1), Category::XL);
    EXPECT_EQ(contentSizeCategoryForTextScale(1.25), Category::XXL);
    EXPECT_EQ(contentSizeCategoryForTextScale(1.4), Category::XXXL);
    EXPECT_EQ(contentSizeCategoryForTextScale(1.6), Category::AX1);
    EXPECT_EQ(contentSizeCategoryForTextScale(2), Category::AX2);
    EXPECT_EQ(contentSizeCategoryForTextScale(3), Category::AX5);
    EXPECT_EQ(contentSizeCategoryForTextScale(100), Category::AX5);
}

TEST(DesktopAppearance, ScalesThatAreNoneAreTheUsualOne) {
    EXPECT_EQ(contentSizeCategoryForTextScale(0), Category::L);
    EXPECT_EQ(contentSizeCategoryForTextScale(-2), Category::L);
    EXPECT_EQ(contentSizeCategoryForTextScale(std::numeric_limits<double>::quiet_NaN()),
              Category::L);
}

TEST(DesktopAppearance, TraitsKeepWhatItDoesNotSay) {
    const UITraitCollection before{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft,
                                   .displayScale = 2};
    const auto after =
        DesktopAppearance{
            .isDark = true, .hasHighContrast = true, .reducesMotion = true, .textScale = 1.25}
            .appliedTo(before);
    EXPECT_EQ(after,
              (UITraitCollection{.userInterfaceStyle = UIUserInterfaceStyle::Dark,
                                 .accessibilityContrast = UIAccessibilityContrast::High,
                                 .layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft,
                                 .preferredContentSizeCategory = Category::XXL,
                                 .displayScale = 2,
                                 .reducesMotion = true}));
    EXPECT_EQ(DesktopAppearance().appliedTo(after),
              (UITraitCollection{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft,
                                 .displayScale = 2}));
}

TEST(DesktopAppearance, TextTellsItAll) {
    for (const auto& appearance : {DesktopAppearance{},
                                   DesktopAppearance{.isDark = true},
                                   DesktopAppearance{.hasHighContrast = true, .textScale = 1.25},
                                   DesktopAppearance{.reducesMotion = true, .textScale = 0.1}})
        EXPECT_EQ(DesktopAppearance::fromText(appearance.text()), appearance) << appearance.text();
}

TEST(DesktopAppearance, DamagedTextIsTheUsualLooks) {
    EXPECT_EQ(DesktopAppearance::fromText(""), DesktopAppearance());
    EXPECT_EQ(DesktopAppearance::fromText("inf nan -3 0 darkness"), DesktopAppearance());
    EXPECT_EQ(DesktopAppearance::fromText("  dark ").isDark, true);
}

TEST(DesktopAppearance, IsRememberedInTheProfile) {
    testing::TemporaryProfile profile;
    EXPECT_EQ(DesktopAppearance::remembered(), DesktopAppearance());
    const DesktopAppearance seen{.isDark = true, .textScale = 1.5};
    seen.remember();
    EXPECT_EQ(DesktopAppearance::remembered(), seen);
}

} // namespace
} // namespace orvo
