#include "CellTest.h"
#include "SummaryCells.h"
#include "platform/mapuikit/KitLabel.h"
#include "presentation/OWTransitSummaryCell.h"

// At the default text size the title is 17 points, its capitals 12 and its characters 8.5 wide.
// Shields are 40 × 28, with 5 between them; their baseline is at 20.

namespace orvo {
namespace {

using namespace testing;

constexpr CGFloat RowHeight = 110;

class SummaryCellLayoutTest : public testing::CellTest {
protected:
    SummaryCellLayoutTest() { cell->setArtworkCache(cache); }
    void TearDown() override { EXPECT_EQ(log.messages(), Names{}); }

    /// A cell as the table makes one in the text size of the moment.
    std::shared_ptr<RecordingSummaryCell>
    show(const std::string& title, int shields, double height = RowHeight) {
        auto made = RecordingSummaryCell::make();
        made->setArtworkCache(cache);
        made->setItem(summaryItem(title, artworks(shields)));
        made->setRowHeight(height);
        return made;
    }

    std::shared_ptr<OneText> bundle = std::make_shared<OneText>();
    std::shared_ptr<FixedShields> cache = std::make_shared<FixedShields>();
    std::shared_ptr<RecordingSummaryCell> cell = RecordingSummaryCell::make();

private:
    EnvironmentSlot<std::shared_ptr<NSBundle>>::Override _bundle =
        NSBundle::main().overrideWith(bundle);
};

TEST_F(SummaryCellLayoutTest, ShieldsAreCutToTheTitlesWidthInTheSamePass) {
    cell->setItem(summaryItem("2 advisories", artworks(9)));
    layout(cell, 327, RowHeight);
    ASSERT_FALSE(cell->widths.empty());
    EXPECT_EQ(cell->widths.front(), 327);
    cell->widths.clear();
    layout(cell, 200, RowHeight);
    ASSERT_FALSE(cell->widths.empty());
    EXPECT_EQ(cell->widths.front(), 200);
    EXPECT_EQ(cell->primaryLabel()->frame().size.width, 200);
}

TEST_F(SummaryCellLayoutTest, ARestlessRowSettlesInTwoPasses) {
    cell->setItem(summaryItem("2 advisories", artworks(9)));
    layout(cell, 200, RowHeight);
    EXPECT_LE(cell->widths.size(), 2U);
    cell->widths.clear();
    layout(cell, 200, RowHeight);
    EXPECT_TRUE(cell->widths.empty());
}

TEST_F(SummaryCellLayoutTest, TheTextForTheRestIsSetAnewInEachPass) {
    cell->setItem(summaryItem("2 advisories", artworks(9)));
    layout(cell, 200, RowHeight);
    for (int pass = 0; pass < 2; ++pass) {
        cell->artworksLabel()->setMaxWidth_textForTruncationGenerator(
            50, [](std::uint64_t) { return "another"; });
        EXPECT_EQ(cell->artworksLabel()->_truncationText(), "another");
        cell->setNeedsLayout();
        layout(cell, 200, RowHeight);
        EXPECT_EQ(cell->artworksLabel()->maxWidth(), 200);
        EXPECT_EQ(cell->artworksLabel()->_truncationText(), "+5");
    }
}

TEST_F(SummaryCellLayoutTest, TheRestIsCountedInTheWordsOfTheBundle) {
    cell->setItem(summaryItem("2 advisories", artworks(7)));
    layout(cell, 200, RowHeight);
    EXPECT_EQ(cell->artworksLabel()->_shownShields(), 4U);
    EXPECT_EQ(cell->artworksLabel()->_truncationText(), "+3");
    ASSERT_FALSE(bundle->asked.empty());
    for (const auto& asked : bundle->asked)
        EXPECT_EQ(asked, "Transit_Incident_Not_Displayed_Incidents|localized string not found|nil");
}

TEST_F(SummaryCellLayoutTest, AsManyShieldsAreShownAsFitWithTheCount) {
    std::string shown;
    for (const CGFloat width : {40, 62, 100, 280, 359, 399, 400, 500}) {
        const auto made = show("12 advisories", 9);
        layout(made, width, RowHeight);
        shown += std::to_string(made->artworksLabel()->_shownShields()) +
                 made->artworksLabel()->_truncationText().value_or("") + " ";
    }
    EXPECT_EQ(shown, "0+9 1+8 1+8 5+4 7+2 8+1 9 9 ");
}

TEST_F(SummaryCellLayoutTest, ShieldsThatFitNeedNoWords) {
    cell->setItem(summaryItem("2 advisories", artworks(3)));
    layout(cell, 200, RowHeight);
    EXPECT_EQ(cell->artworksLabel()->_truncationText(), std::nullopt);
    EXPECT_TRUE(bundle->asked.empty());
}

TEST_F(SummaryCellLayoutTest, SizingLaysTheRowOutFirst) {
    cell->setItem(summaryItem("2 advisories", artworks(9)));
    cell->setFrame({{0, 0}, {200, RowHeight}});
    const auto size =
        cell->systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
            {200, 0}, UILayoutPriorityRequired, UILayoutPriorityFittingSizeLevel);
    EXPECT_EQ(size, (CGSize{200, RowHeight}));
    EXPECT_FALSE(cell->widths.empty());
    EXPECT_FALSE(cell->needsLayout());
    EXPECT_EQ(cell->artworksLabel()->_truncationText(), "+5");
    // As wide as what is left of the shields, not as all nine.
    EXPECT_LE(cell->systemLayoutSizeFittingSize(UILayoutFittingCompressedSize).width, 200);
}

TEST_F(SummaryCellLayoutTest, SizingSeesTheShieldsThatAreLeft) {
    cell->setItem(summaryItem("2 advisories", artworks(9)));
    cell->setFrame({{0, 0}, {200, RowHeight}});
    EXPECT_LE(cell->systemLayoutSizeFittingSize(UILayoutFittingCompressedSize).width, 200);
}

TEST_F(SummaryCellLayoutTest, ShieldsAreCutOnceTheRowIsPlaced) {
    bundle->whenAsked = [this] {
        EXPECT_EQ(cell->contentView()->frame().size.width, cell->frame().size.width);
        EXPECT_EQ(cell->primaryLabel()->frame().size.width, cell->frame().size.width);
    };
    cell->setItem(summaryItem("2 advisories", artworks(9)));
    for (const CGFloat width : {300, 200}) {
        layout(cell, width, RowHeight);
        EXPECT_EQ(cell->artworksLabel()->maxWidth(), width);
    }
    EXPECT_FALSE(bundle->asked.empty());
    bundle->whenAsked = nullptr;
}

TEST_F(SummaryCellLayoutTest, ShieldsStandBelowTheTitleInRowsOfAnyWidth) {
    EXPECT_EQ(layout(show("12 advisories", 9), 280, RowHeight), R"(
cell 0 0 280 110
  (contentGuide 0 27 280 56)
  contentView 0 0 280 110
    stackView 0 26 280 57
      vibrancyViewForPrimaryLabel 0 26 280 17
        UIView2 0 26 280 17
          primaryLabel 0 26 280 17 "12 advisories"
      artworksLabel 0 55 280 28 [U0] [U1] [U2] [U3] [U4] "+4"
)");
    EXPECT_EQ(layout(show("12 advisories", 9), 359, RowHeight), R"(
cell 0 0 359 110
  (contentGuide 0 27 359 56)
  contentView 0 0 359 110
    stackView 0 26 359 57
      vibrancyViewForPrimaryLabel 0 26 359 17
        UIView2 0 26 359 17
          primaryLabel 0 26 359 17 "12 advisories"
      artworksLabel 0 55 359 28 [U0] [U1] [U2] [U3] [U4] [U5] [U6] "+2"
)");
    EXPECT_EQ(layout(show("12 advisories", 9), 500, RowHeight), R"(
cell 0 0 500 110
  (contentGuide 0 27 500 56)
  contentView 0 0 500 110
    stackView 0 26 500 57
      vibrancyViewForPrimaryLabel 0 26 500 17
        UIView2 0 26 500 17
          primaryLabel 0 26 500 17 "12 advisories"
      artworksLabel 0 55 500 28 [U0] [U1] [U2] [U3] [U4] [U5] [U6] [U7] [U8]
)");
}

TEST_F(SummaryCellLayoutTest, RowsAreSetInSmallAndInTheLargestType) {
    useSize(UIContentSizeCategory::XS);
    EXPECT_EQ(layout(show("12 advisories", 9, 91), 327, 91), R"(
cell 0 0 327 91
  (contentGuide 0 18 327 55)
  contentView 0 0 327 91
    stackView 0 17 327 56
      vibrancyViewForPrimaryLabel 0 17 327 14
        UIView2 0 17 327 14
          primaryLabel 0 17 327 14 "12 advisories"
      artworksLabel 0 45 327 28 [U0] [U1] [U2] [U3] [U4] [U5] "+3"
)");
    useSize(UIContentSizeCategory::AX5);
    EXPECT_EQ(layout(show("12 advisories", 9, 343), 327, 343), R"(
cell 0 0 327 343
  (contentGuide 0 133 327 77)
  contentView 0 0 327 343
    stackView 0 128 327 82
      vibrancyViewForPrimaryLabel 0 128 327 53
        UIView2 0 128 327 53
          primaryLabel 0 128 327 53 "12 advisori…"
      artworksLabel 0 182 327 28 [U0] [U1] [U2] [U3] [U4] [U5] "+3"
)");
}

TEST_F(SummaryCellLayoutTest, ReadingFromTheRightMovesNothingSinceBothFillTheRow) {
    const auto fromTheLeft = layout(show("12 advisories", 2), 327, RowHeight);
    useTraits({.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    EXPECT_EQ(layout(show("12 advisories", 2), 327, RowHeight), fromTheLeft);
}

TEST_F(SummaryCellLayoutTest, ATitleAloneStandsInTheMiddleDownToItsDescenders) {
    const auto made = show("12 advisories", 0);
    EXPECT_EQ(layout(made, 327, RowHeight), R"(
cell 0 0 327 110
  (contentGuide 0 47 327 16)
  contentView 0 0 327 110
    stackView 0 46 327 17
      vibrancyViewForPrimaryLabel 0 46 327 17
        UIView2 0 46 327 17
          primaryLabel 0 46 327 17 "12 advisories"
      artworksLabel 0 46 327 0 hidden
)");
    made->setItem(summaryItem("12 advisories", artworks(2)));
    EXPECT_EQ(layout(made, 327, RowHeight), layout(show("12 advisories", 2), 327, RowHeight));
}

TEST_F(SummaryCellLayoutTest, ATitleTooLongForItsLineEndsInAnEllipsis) {
    const auto made = show("Several advisories for the lines that you have chosen", 2);
    layout(made, 200, RowHeight);
    EXPECT_EQ(linesOf(made->primaryLabel()), (Names{"Several advisories for…"}));
    EXPECT_EQ(made->artworksLabel()->maxWidth(), 200);
}

} // namespace
} // namespace orvo
