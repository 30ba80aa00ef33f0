#include "platform/mapuikit/KitTableViewCell.h"

#include "platform/mapuikit/KitLabel.h"
#include "platform/mapuikit/KitTableCellFont.h"
#include "platform/uikit/ViewTest.h"

namespace orvo {
namespace {

using KitTableViewCellTest = testing::ViewTest;

TEST_F(KitTableViewCellTest, IsATableCellOfItsOwnClass) {
    const auto cell =
        KitTableViewCell::initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, "kit");
    EXPECT_EQ(cell->className(), "KitTableViewCell");
    EXPECT_EQ(cell->reuseIdentifier(), "kit");
    EXPECT_NE(cell->contentView(), nullptr);
    cell->setSeparatorStyleOverride(UITableViewCellSeparatorStyle::None);
    EXPECT_EQ(cell->separatorStyleOverride(), UITableViewCellSeparatorStyle::None);
}

TEST_F(KitTableViewCellTest, FontsAreThoseOfTheTextStylesWithTheTraitsAdded) {
    using namespace KitTableCellFont;
    const auto headline = preferredTableCellFontForTextStyle_traits(UIFontTextStyleHeadline, 0);
    EXPECT_TRUE(equal(headline, UIFont::preferredFontForTextStyle(UIFontTextStyleHeadline)));
    const auto bold = preferredTableCellFontForTextStyle_traits(UIFontTextStyleHeadline,
                                                                UIFontDescriptorTraitBold);
    EXPECT_EQ(bold->fontDescriptor()->symbolicTraits(), UIFontDescriptorTraitBold);
    EXPECT_EQ(bold->face().weight, 700);
    EXPECT_EQ(bold->pointSize(), 17);
}

TEST_F(KitTableViewCellTest, FontsFollowTheTextSizeOfTheSystem) {
    const auto traits = UITraitCollection::system().overrideWith(
        UITraitCollection{.preferredContentSizeCategory = UIContentSizeCategory::AX5});
    EXPECT_EQ(
        KitTableCellFont::preferredTableCellFontForTextStyle_traits(UIFontTextStyleSubheadline, 0)
            ->pointSize(),
        49);
}

TEST_F(KitTableViewCellTest, LabelsOfTheKitAreLabels) {
    EXPECT_EQ(KitLabel::init()->className(), "KitLabel");
    EXPECT_EQ(KitLabel::initWithFrame({{1, 2}, {3, 4}})->frame(), (CGRect{{1, 2}, {3, 4}}));
}

} // namespace
} // namespace orvo
