#include "presentation/OWTransitSummaryCell.h"

#include "CellTest.h"
#include "SummaryCells.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/mapuikit/KitLabel.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIStackView.h"
#include "presentation/DynamicTypeWizard.h"
#include "presentation/VisualEffectWrappingView.h"

namespace orvo {
namespace {

using Cell = OWTransitSummaryCell;
using namespace testing;

class SummaryCellTest : public testing::CellTest {
protected:
    SummaryCellTest() { cell->setArtworkCache(cache); }
    void TearDown() override { EXPECT_EQ(log.messages(), Names{}); }

    std::shared_ptr<NSLayoutConstraint> named(const std::string& name) {
        for (const auto& constraint : cell->initial)
            if (constraint->identifier() == name)
                return constraint;
        return nullptr;
    }
    std::shared_ptr<NSString> registeredIn(std::uint64_t phase) {
        const auto map = std::dynamic_pointer_cast<NSMapTable>(
            DynamicTypeWizard::_singletonInstance()->objectToSelectorStringMaps()->objectForKey(
                *NSNumber::numberWithUnsignedInteger(phase)));
        return std::dynamic_pointer_cast<NSString>(map->objectForKey(cell));
    }

    std::shared_ptr<FixedShields> cache = std::make_shared<FixedShields>();
    std::shared_ptr<RecordingSummaryCell> cell = RecordingSummaryCell::make();
};

// Creation

TEST_F(SummaryCellTest, IsMadeAsOneOfTheKitsCells) {
    const auto made = Cell::initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, "reuse");
    EXPECT_NE(dynamic_cast<KitTableViewCell*>(made.get()), nullptr);
    EXPECT_EQ(made->reuseIdentifier(), "reuse");
    EXPECT_EQ(made->className(), "OWTransitSummaryCell");
    EXPECT_EQ(made->item(), nullptr);
    EXPECT_EQ(made->artworkCache(), nullptr);
    EXPECT_EQ(made->primaryLabel()->className(), "KitLabel");
}

TEST_F(SummaryCellTest, ActivatesItsConstraintsWhileItMakesItsViews) {
    EXPECT_EQ(cell->steps, (Names{"create after super", "constraints", "created"}));
}

TEST_F(SummaryCellTest, ViewsLieInThisOrderWithoutFrames) {
    EXPECT_EQ("\n" + dumpViews(*cell), R"(
cell 0 0 0 0
  (contentGuide 0 0 0 0)
  contentView 0 0 0 0
    stackView 0 0 0 0
      vibrancyViewForPrimaryLabel 0 0 0 0
        UIView2 0 0 0 0
          primaryLabel 0 0 0 0
      artworksLabel 0 0 0 0
)");
}

TEST_F(SummaryCellTest, ViewsAndGuidesAreMadeInThisOrder) {
    std::uint64_t last = 0;
    for (const auto* name : {"contentGuide",
                             "stackView",
                             "vibrancyViewForPrimaryLabel",
                             "primaryLabel",
                             "artworksLabel"}) {
        const auto number = find(cell, name)->_creationNumber();
        EXPECT_GT(number, last) << name;
        last = number;
        const auto view = find<UIView>(cell, name);
        EXPECT_FALSE(view && view->translatesAutoresizingMaskIntoConstraints()) << name;
    }
    EXPECT_EQ(find<UILayoutGuide>(cell, "contentGuide")->owningView(), cell);
}

TEST_F(SummaryCellTest, TitleAndShieldsStandInAColumnByTheirBaselines) {
    const auto stack = find<UIStackView>(cell, "stackView");
    EXPECT_EQ(stack->axis(), UILayoutConstraintAxis::Vertical);
    EXPECT_TRUE(stack->isBaselineRelativeArrangement());
    EXPECT_EQ(stack->distribution(), UIStackViewDistribution::Fill);
    EXPECT_EQ(stack->alignment(), UIStackViewAlignment::Fill);
    EXPECT_EQ(stack->superview(), cell->contentView());
    EXPECT_EQ(stack->arrangedSubviews(),
              (std::vector<std::shared_ptr<UIView>>{
                  find<UIView>(cell, "vibrancyViewForPrimaryLabel"), cell->artworksLabel()}));
}

TEST_F(SummaryCellTest, TitleIsAPlainHeadlineOfOneLineInVibrancy) {
    const auto font = cell->_primaryFont()->fontDescriptor();
    EXPECT_EQ(font->textStyle(), UIFontTextStyleHeadline);
    EXPECT_EQ(font->symbolicTraits(), 0U);
    EXPECT_TRUE(equal(cell->primaryLabel()->font(), cell->_primaryFont()));
    EXPECT_EQ(cell->primaryLabel()->numberOfLines(), 1);
    const auto around = find<VisualEffectWrappingView>(cell, "vibrancyViewForPrimaryLabel");
    EXPECT_EQ(around->effect()->style(), 101);
    EXPECT_EQ(around->wrappedView(), cell->primaryLabel());
}

TEST_F(SummaryCellTest, SecondaryFontIsThatOfTheBody) {
    const auto font = cell->_secondaryFont()->fontDescriptor();
    EXPECT_EQ(font->textStyle(), UIFontTextStyleBody);
    EXPECT_EQ(font->symbolicTraits(), 0U);
}

TEST_F(SummaryCellTest, ShieldsAreTheLargestOnesInARowWithAGrayCount) {
    const auto& shields = cell->artworksLabel();
    EXPECT_EQ(shields->labelItems(), nullptr);
    EXPECT_EQ(shields->iconSize(), 7);
    EXPECT_EQ(shields->shieldSize(), 7);
    EXPECT_EQ(shields->spaceBetweenShields(), 5);
    EXPECT_EQ(shields->maxWidth(), TransitInfoLabelViewNoMaximumWidth);
    EXPECT_EQ(shields->numberOfLines(), 1);
    EXPECT_TRUE(equal(shields->font(), UIFont::preferredFontForTextStyle(UIFontTextStyleBody)));
    EXPECT_TRUE(equal(shields->textColor(), UIColor::systemGrayColor()));
    EXPECT_EQ(shields->_vibrantColor(), nullptr);
}

TEST_F(SummaryCellTest, InitialConstraintsAreTheseInThisOrder) {
    EXPECT_EQ(textOf(cell->initial), R"(
rowHeight: contentView.height == 110
contentGuide.centerY == contentView.centerY
contentGuide.leading == contentView.leading
contentGuide.trailing == contentView.trailing
contentGuide.top >= contentView.top
contentGuide.bottom <= contentView.bottom
primaryLabelToContentGuide: stackView.firstBaseline == contentGuide.top + 12
contentGuide.bottom == stackView.bottom
stackView.leading == contentGuide.leading
stackView.trailing == contentGuide.trailing
)");
    EXPECT_EQ(cell->initial.size(), 10U);
    EXPECT_EQ(cell->primaryToSecondaryLabelConstraint(), nullptr);
}

TEST_F(SummaryCellTest, ConstraintsThatHoldAreTheseInThisOrder) {
    cell->setItem(summaryItem("2 advisories", artworks(2)));
    EXPECT_EQ("\n" + dumpConstraints(*cell), R"(
contentGuide.centerY == contentView.centerY
contentGuide.leading == contentView.leading
contentGuide.trailing == contentView.trailing
contentGuide.top >= contentView.top
contentGuide.bottom <= contentView.bottom
primaryLabelToContentGuide: stackView.firstBaseline == contentGuide.top + 12
contentGuide.bottom == stackView.bottom
stackView.leading == contentGuide.leading
stackView.trailing == contentGuide.trailing
rowHeight: contentView.height == 110
vibrancyViewForPrimaryLabel.top == stackView.top
vibrancyViewForPrimaryLabel.leading == stackView.leading
vibrancyViewForPrimaryLabel.trailing == stackView.trailing
artworksLabel.firstBaseline == vibrancyViewForPrimaryLabel.lastBaseline + 35
artworksLabel.leading == stackView.leading
artworksLabel.trailing == stackView.trailing
artworksLabel.bottom == stackView.bottom
primaryLabel.leading == vibrancyViewForPrimaryLabel.leading
primaryLabel.trailing == vibrancyViewForPrimaryLabel.trailing
primaryLabel.top == vibrancyViewForPrimaryLabel.top
primaryLabel.bottom == vibrancyViewForPrimaryLabel.bottom
)");
    EXPECT_EQ(cell->primaryToSecondaryLabelConstraint(), nullptr);
}

// Dynamic type

TEST_F(SummaryCellTest, OnlyTheTitleFollowsTheTextSize) {
    const auto stack = find<UIStackView>(cell, "stackView");
    const auto& wizard = DynamicTypeWizard::_singletonInstance();
    EXPECT_EQ(wizard->stackToValueMap()->objectForKey(stack), nullptr);
    EXPECT_EQ(wizard->labelToFontMap()->objectForKey(cell->artworksLabel()), nullptr);
    const auto check = [&](UIContentSizeCategory size, double title, double offset) {
        changeSize(size);
        EXPECT_EQ(cell->primaryLabel()->font()->pointSize(), title);
        EXPECT_EQ(named("primaryLabelToContentGuide")->constant(), offset);
        EXPECT_EQ(stack->spacing(), 35);
        EXPECT_EQ(cell->artworksLabel()->font()->pointSize(), 17);
    };
    check(UIContentSizeCategory::XS, 14, 10);
    check(UIContentSizeCategory::AX5, 53, 37);
    check(UIContentSizeCategory::L, 17, 12);
}

TEST_F(SummaryCellTest, OffsetIsUpdatedAfterFontsByItsMisspeltName) {
    EXPECT_EQ(registeredIn(0), nullptr);
    EXPECT_EQ(registeredIn(2), nullptr);
    EXPECT_EQ(stringValue(registeredIn(1).get()), "_updatePrimaryLabelToContentGuideConstaint");
    named("primaryLabelToContentGuide")->setConstant(99);
    (void)cell->performSelector(Selector("_updatePrimaryLabelToContentGuideConstaint"));
    EXPECT_EQ(named("primaryLabelToContentGuide")->constant(), 12);
}

TEST_F(SummaryCellTest, OffsetIsInWholePixelsOfTheCell) {
    cell->primaryLabel()->setFont(UIFont::systemFontOfSize_weight(21.8, 400)); // capitals 15.26
    cell->setTraitCollection(UITraitCollection{.displayScale = 2});
    cell->_updatePrimaryLabelToContentGuideConstaint();
    EXPECT_EQ(named("primaryLabelToContentGuide")->constant(), 15.5);
    cell->setTraitCollection(UITraitCollection{.displayScale = 1});
    cell->_updatePrimaryLabelToContentGuideConstaint();
    EXPECT_EQ(named("primaryLabelToContentGuide")->constant(), 15);
}

TEST_F(SummaryCellTest, WithoutAFontThereIsNoOffset) {
    cell->primaryLabel()->setFont(nullptr);
    cell->_updatePrimaryLabelToContentGuideConstaint();
    EXPECT_EQ(named("primaryLabelToContentGuide")->constant(), 0);
}

TEST_F(SummaryCellTest, RegistrationsDoNotKeepTheCell) {
    const auto label = cell->primaryLabel();
    const std::weak_ptr<Cell> weak = cell;
    cell.reset();
    EXPECT_TRUE(weak.expired());
    changeSize(UIContentSizeCategory::AX5);
    EXPECT_EQ(label->font(), nullptr); // nobody is left to say which
}

// Content

TEST_F(SummaryCellTest, HeightIsTheConstantOfItsConstraint) {
    EXPECT_EQ(cell->rowHeight(), 110);
    cell->setRowHeight(80);
    EXPECT_EQ(named("rowHeight")->constant(), 80);
    named("rowHeight")->setConstant(81);
    EXPECT_EQ(cell->rowHeight(), 81);
}

TEST_F(SummaryCellTest, ArtworkCacheIsThatOfTheShields) {
    EXPECT_EQ(cell->artworksLabel()->artworkCache(), cache);
    const auto other = std::make_shared<FixedShields>();
    cell->artworksLabel()->setArtworkCache(other);
    EXPECT_EQ(cell->artworkCache(), other);
}

TEST_F(SummaryCellTest, OnlyAnotherItemIsShownAnew) {
    const auto shields = artworks(2);
    cell->setItem(nullptr);
    EXPECT_EQ(cell->updates, 0);
    const auto first = summaryItem("2 advisories", shields);
    cell->setItem(first);
    EXPECT_EQ(cell->updates, 1);
    cell->primaryLabel()->setText("by hand");
    cell->setItem(first);
    cell->setItem(summaryItem("2 advisories", shields));
    EXPECT_EQ(cell->updates, 1);
    EXPECT_EQ(cell->item(), first);
    EXPECT_EQ(cell->primaryLabel()->text(), "by hand");
    cell->setItem(summaryItem("3 advisories", shields));
    EXPECT_EQ(cell->updates, 2);
    EXPECT_EQ(cell->primaryLabel()->text(), "3 advisories");
    cell->setItem(nullptr);
    EXPECT_EQ(cell->updates, 3);
}

TEST_F(SummaryCellTest, ShieldsAreHiddenExactlyWhenThereAreNone) {
    cell->setItem(summaryItem("2 advisories", artworks(2)));
    EXPECT_EQ(cell->artworksLabel()->labelItems()->count(), 2U);
    EXPECT_FALSE(cell->artworksLabel()->isHidden());
    cell->setItem(summaryItem("2 advisories", nullptr));
    EXPECT_EQ(cell->artworksLabel()->labelItems(), nullptr);
    EXPECT_TRUE(cell->artworksLabel()->isHidden());
    cell->setItem(summaryItem("2 advisories", artworks(1)));
    EXPECT_FALSE(cell->artworksLabel()->isHidden());
    cell->setItem(summaryItem("2 advisories", artworks(0)));
    EXPECT_TRUE(cell->artworksLabel()->isHidden());
}

TEST_F(SummaryCellTest, NoItemEmptiesTheRow) {
    cell->setItem(summaryItem("2 advisories", artworks(2)));
    cell->setItem(nullptr);
    EXPECT_EQ(cell->item(), nullptr);
    EXPECT_EQ(cell->primaryLabel()->text(), std::nullopt);
    EXPECT_EQ(cell->artworksLabel()->labelItems(), nullptr);
    EXPECT_TRUE(cell->artworksLabel()->isHidden());
}

} // namespace
} // namespace orvo
