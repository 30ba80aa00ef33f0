#include "CellTest.h"
#include "platform/mapuikit/ArtworkImageView.h"
#include "platform/mapuikit/KitLabel.h"
#include "platform/uikit/UIImage.h"
#include "presentation/OWTransitItemFixedHeightCell.h"

// At the default text size the title is 17 points, its capitals 12 and its characters 8.5 wide; the
// text below 15 and 7.5. Shields are 28 × 20.

namespace orvo {
namespace {

using Cell = OWTransitItemFixedHeightCell;

constexpr CGFloat RowHeight = 110;
constexpr CGFloat ColumnWidth = 73;
constexpr const char* LongTitle =
    "Between Harbour Square and Central Station the tramway is closed until further notice";
constexpr const char* LongText =
    "Replacement buses run every ten minutes and stop at all stations along the way; please "
    "allow for half an hour more and mind the timetable at your stop before you set out";

struct Row {
    std::optional<std::string> primary = "U6";
    std::optional<std::string> secondary = "Delays of ten minutes";
    bool hidden = false;
    double alpha = 1;
};

std::shared_ptr<OWTransitItem> item(const Row& row = {}) {
    static const auto shield =
        UIImage::imageWithPixels_size_scale(std::vector<std::uint32_t>(28 * 20), {28, 20}, 1);
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        row.primary,
        row.secondary,
        OWConfiguredArtwork::initWithArtworkSource_alpha(shield, row.alpha),
        row.hidden,
        nullptr);
}

class ItemCellLayoutTest : public testing::CellTest {
protected:
    /// As the table makes one in the text size of the moment.
    std::shared_ptr<Cell> show(const Row& row, double height = RowHeight) {
        auto cell = Cell::initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, "row");
        cell->setIdentifier("cell");
        cell->setTransitItem(item(row));
        cell->setTrailingArtworkColumnWidth(ColumnWidth);
        cell->setRowHeight(height);
        return cell;
    }
    void TearDown() override { EXPECT_EQ(log.messages(), Names{}); }
};

TEST_F(ItemCellLayoutTest, TextIsCentredFromItsCapitalsToItsLastBaseline) {
    const auto cell = show({});
    EXPECT_EQ(layout(cell, 327, RowHeight), R"(
cell 0 0 327 110
  (contentGuide 0 39 327 33)
  contentView 0 0 327 110
    (trailingGutterGuide 254 39 73 33)
    stackView 0 37 254 38
      vibrancyViewForPrimaryLabel 0 37 254 17
        UIView2 0 37 254 17
          primaryLabel 0 37 254 17 "U6"
      vibrancyViewForSecondaryLabel 0 60 254 15
        UIView3 0 60 254 15
          secondaryLabel 0 60 254 15 "Delays of ten minutes"
    nonVibrantImageView 299 45 28 20
    vibrantImageView 299 45 28 20
      UIView4 299 45 28 20
        vibrantArtwork 299 45 28 20 hidden
)");
    const auto frame = find<UILayoutGuide>(cell, "contentGuide")->layoutFrame();
    const auto capitals = firstBaselineOf(cell->primaryLabel(), cell) - 12;
    const auto baseline = firstBaselineOf(cell->secondaryLabel(), cell);
    constexpr double HalfPixel = 0.5;
    EXPECT_NEAR(frame.origin.y, capitals, HalfPixel);
    EXPECT_NEAR(frame.origin.y + frame.size.height, baseline, HalfPixel);
    EXPECT_NEAR(capitals, RowHeight - baseline, 2 * HalfPixel);
}

TEST_F(ItemCellLayoutTest, TextsAreAsWideAsTheColumnLeaves) {
    EXPECT_EQ(layout(show({}), 280, RowHeight), R"(
cell 0 0 280 110
  (contentGuide 0 39 280 33)
  contentView 0 0 280 110
    (trailingGutterGuide 207 39 73 33)
    stackView 0 37 207 38
      vibrancyViewForPrimaryLabel 0 37 207 17
        UIView2 0 37 207 17
          primaryLabel 0 37 207 17 "U6"
      vibrancyViewForSecondaryLabel 0 60 207 15
        UIView3 0 60 207 15
          secondaryLabel 0 60 207 15 "Delays of ten minutes"
    nonVibrantImageView 252 45 28 20
    vibrantImageView 252 45 28 20
      UIView4 252 45 28 20
        vibrantArtwork 252 45 28 20 hidden
)");
    EXPECT_EQ(layout(show({}), 359, RowHeight), R"(
cell 0 0 359 110
  (contentGuide 0 39 359 33)
  contentView 0 0 359 110
    (trailingGutterGuide 286 39 73 33)
    stackView 0 37 286 38
      vibrancyViewForPrimaryLabel 0 37 286 17
        UIView2 0 37 286 17
          primaryLabel 0 37 286 17 "U6"
      vibrancyViewForSecondaryLabel 0 60 286 15
        UIView3 0 60 286 15
          secondaryLabel 0 60 286 15 "Delays of ten minutes"
    nonVibrantImageView 331 45 28 20
    vibrantImageView 331 45 28 20
      UIView4 331 45 28 20
        vibrantArtwork 331 45 28 20 hidden
)");
    EXPECT_EQ(layout(show({}), 500, RowHeight), R"(
cell 0 0 500 110
  (contentGuide 0 39 500 33)
  contentView 0 0 500 110
    (trailingGutterGuide 427 39 73 33)
    stackView 0 37 427 38
      vibrancyViewForPrimaryLabel 0 37 427 17
        UIView2 0 37 427 17
          primaryLabel 0 37 427 17 "U6"
      vibrancyViewForSecondaryLabel 0 60 427 15
        UIView3 0 60 427 15
          secondaryLabel 0 60 427 15 "Delays of ten minutes"
    nonVibrantImageView 472 45 28 20
    vibrantImageView 472 45 28 20
      UIView4 472 45 28 20
        vibrantArtwork 472 45 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, RowsAreSetInSmallType) {
    useSize(UIContentSizeCategory::XS);
    EXPECT_EQ(layout(show({}, 91), 327, 91), R"(
cell 0 0 327 91
  (contentGuide 0 32 327 27)
  contentView 0 0 327 91
    (trailingGutterGuide 254 32 73 27)
    stackView 0 31 254 30
      vibrancyViewForPrimaryLabel 0 31 254 14
        UIView2 0 31 254 14
          primaryLabel 0 31 254 14 "U6"
      vibrancyViewForSecondaryLabel 0 49 254 12
        UIView3 0 49 254 12
          secondaryLabel 0 49 254 12 "Delays of ten minutes"
    nonVibrantImageView 299 36 28 20
    vibrantImageView 299 36 28 20
      UIView4 299 36 28 20
        vibrantArtwork 299 36 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, RowsAreSetInTheLargestType) {
    useSize(UIContentSizeCategory::AX5);
    EXPECT_EQ(layout(show({}, 343), 327, 343), R"(
cell 0 0 327 343
  (contentGuide 0 72 327 200)
  contentView 0 0 327 343
    (trailingGutterGuide 254 72 73 200)
    stackView 0 66 254 215
      vibrancyViewForPrimaryLabel 0 66 254 53
        UIView2 0 66 254 53
          primaryLabel 0 66 254 53 "U6"
      vibrancyViewForSecondaryLabel 0 134 254 147
        UIView3 0 134 254 147
          secondaryLabel 0 134 254 147 "Delays of" "ten" "minutes"
    nonVibrantImageView 299 162 28 20
    vibrantImageView 299 162 28 20
      UIView4 299 162 28 20
        vibrantArtwork 299 162 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, ARowOnScreenIsSetAnewWhenTheTextSizeChanges) {
    const auto cell = show({});
    layout(cell, 327, RowHeight);
    changeSize(UIContentSizeCategory::AX5);
    cell->setRowHeight(343);
    const auto changed = layout(cell, 327, 343);
    EXPECT_EQ(changed, layout(show({}, 343), 327, 343));
}

TEST_F(ItemCellLayoutTest, ReadingFromTheRightMirrorsTheRow) {
    useTraits({.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    EXPECT_EQ(layout(show({}), 327, RowHeight), R"(
cell 0 0 327 110
  (contentGuide 0 39 327 33)
  contentView 0 0 327 110
    (trailingGutterGuide 0 39 73 33)
    stackView 73 37 254 38
      vibrancyViewForPrimaryLabel 73 37 254 17
        UIView2 73 37 254 17
          primaryLabel 73 37 254 17 "U6"
      vibrancyViewForSecondaryLabel 73 60 254 15
        UIView3 73 60 254 15
          secondaryLabel 73 60 254 15 "Delays of ten minutes"
    nonVibrantImageView 0 45 28 20
    vibrantImageView 0 45 28 20
      UIView4 0 45 28 20
        vibrantArtwork 0 45 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, ATitleAloneIsCentredByItself) {
    EXPECT_EQ(layout(show({.secondary = std::nullopt}), 327, RowHeight), R"(
cell 0 0 327 110
  (contentGuide 0 49 327 12)
  contentView 0 0 327 110
    (trailingGutterGuide 254 49 73 12)
    stackView 0 47 254 17
      vibrancyViewForPrimaryLabel 0 47 254 17
        UIView2 0 47 254 17
          primaryLabel 0 47 254 17 "U6"
      vibrancyViewForSecondaryLabel 0 47 254 0
        UIView3 0 47 254 0
          secondaryLabel 0 47 254 0 hidden
    nonVibrantImageView 299 45 28 20
    vibrantImageView 299 45 28 20
      UIView4 299 45 28 20
        vibrantArtwork 299 45 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, AnEmptyTextKeepsItsLine) {
    const auto empty = show({.secondary = ""});
    const auto full = show({});
    layout(empty, 327, RowHeight);
    layout(full, 327, RowHeight);
    EXPECT_EQ(empty->primaryLabel()->convertPoint_toView({}, *empty).y,
              full->primaryLabel()->convertPoint_toView({}, *full).y);
    EXPECT_EQ(empty->secondaryLabel()->frame().size.height, 15);
}

TEST_F(ItemCellLayoutTest, HiddenArtworkLeavesItsColumnToTheTextsAndComesBack) {
    const auto cell = show({});
    const auto before = layout(cell, 327, RowHeight);
    cell->setTransitItem(item({.hidden = true}));
    EXPECT_EQ(layout(cell, 327, RowHeight), R"(
cell 0 0 327 110
  (contentGuide 0 39 327 33)
  contentView 0 0 327 110
    (trailingGutterGuide 254 39 73 33)
    stackView 0 37 327 38
      vibrancyViewForPrimaryLabel 0 37 327 17
        UIView2 0 37 327 17
          primaryLabel 0 37 327 17 "U6"
      vibrancyViewForSecondaryLabel 0 60 327 15
        UIView3 0 60 327 15
          secondaryLabel 0 60 327 15 "Delays of ten minutes"
    nonVibrantImageView 299 45 28 20 hidden
    vibrantImageView 299 45 28 20
      UIView4 299 45 28 20
        vibrantArtwork 299 45 28 20 hidden
)");
    cell->setTransitItem(item());
    EXPECT_EQ(layout(cell, 327, RowHeight), before);
}

TEST_F(ItemCellLayoutTest, DimmedArtworkStandsWhereAnOpaqueOneDoes) {
    const auto cell = show({.alpha = 0.5});
    layout(cell, 327, RowHeight);
    const auto frame = find<UIView>(cell, "vibrantImageView")->frame();
    EXPECT_EQ(frame, find<UIView>(cell, "nonVibrantImageView")->frame());
    EXPECT_EQ(frame, (CGRect{{299, 45}, {28, 20}}));
    const auto opaque = show({});
    layout(opaque, 327, RowHeight);
    EXPECT_EQ(find<UIView>(opaque, "nonVibrantImageView")->frame(), frame);
}

TEST_F(ItemCellLayoutTest, ArtworkIsNoHigherThanTheRowLessItsMargins) {
    const auto cell = show({.secondary = std::nullopt}, 30);
    layout(cell, 327, 30);
    EXPECT_EQ(find<UIView>(cell, "vibrantImageView")->frame(), (CGRect{{299, 8}, {28, 14}}));
}

TEST_F(ItemCellLayoutTest, WithoutArtworkTheColumnIsKept) {
    const auto with = show({});
    layout(with, 327, RowHeight);
    const auto without = show({});
    without->setTransitItem(
        OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
            "U6", "Delays of ten minutes", nullptr, false, nullptr));
    layout(without, 327, RowHeight);
    EXPECT_EQ(find<UIView>(without, "stackView")->frame(),
              find<UIView>(with, "stackView")->frame());
}

TEST_F(ItemCellLayoutTest, ItsHeightIsTheRowsWhateverTheTexts) {
    for (const double height : {70.0, 110.0, 343.0}) {
        const auto cell = show({.primary = LongTitle, .secondary = LongText}, height);
        const auto size =
            cell->systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
                {327, 0}, UILayoutPriorityRequired, UILayoutPriorityFittingSizeLevel);
        EXPECT_EQ(size, (CGSize{327, height}));
    }
}

// Texts that do not fit

TEST_F(ItemCellLayoutTest, LongTextsTakeTheLinesThatTheyNeedWhileThereIsRoom) {
    const auto cell = show({.secondary = "Replacement buses run every ten minutes from all stops"});
    EXPECT_EQ(layout(cell, 327, RowHeight), R"(
cell 0 0 327 110
  (contentGuide 0 31 327 48)
  contentView 0 0 327 110
    (trailingGutterGuide 254 31 73 48)
    stackView 0 29 254 53
      vibrancyViewForPrimaryLabel 0 29 254 17
        UIView2 0 29 254 17
          primaryLabel 0 29 254 17 "U6"
      vibrancyViewForSecondaryLabel 0 52 254 30
        UIView3 0 52 254 30
          secondaryLabel 0 52 254 30 "Replacement buses run every ten" "minutes from all stops"
    nonVibrantImageView 299 45 28 20
    vibrantImageView 299 45 28 20
      UIView4 299 45 28 20
        vibrantArtwork 299 45 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, TheTextBelowGivesWayFirst) {
    const auto cell =
        show({.primary = "Between Harbour Square and Central Station", .secondary = LongText});
    EXPECT_EQ(layout(cell, 327, RowHeight), R"(
cell 0 0 327 110
  (contentGuide 0 8 327 95)
  contentView 0 0 327 110
    (trailingGutterGuide 254 8 73 95)
    stackView 0 6 254 100
      vibrancyViewForPrimaryLabel 0 6 254 34
        UIView2 0 6 254 34
          primaryLabel 0 6 254 34 "Between Harbour Square and" "Central Station"
      vibrancyViewForSecondaryLabel 0 46 254 60
        UIView3 0 46 254 60
          secondaryLabel 0 46 254 60 "Replacement buses run every ten" "minutes and stop at all stations" "along the way; please allow for" "half an hour more and mind the t…"
    nonVibrantImageView 299 45 28 20
    vibrantImageView 299 45 28 20
      UIView4 299 45 28 20
        vibrantArtwork 299 45 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, TheTitleGivesWayOnceTheTextBelowHasOneLine) {
    const auto cell =
        show({.primary = std::string(LongTitle) + " " + LongTitle, .secondary = LongText});
    EXPECT_EQ(layout(cell, 327, RowHeight), R"(
cell 0 0 327 110
  (contentGuide 0 5 327 101)
  contentView 0 0 327 110
    (trailingGutterGuide 254 5 73 101)
    stackView 0 3 254 106
      vibrancyViewForPrimaryLabel 0 3 254 85
        UIView2 0 3 254 85
          primaryLabel 0 3 254 85 "Between Harbour Square and" "Central Station the tramway" "is closed until further" "notice Between Harbour Square" "and Central Station the tram…"
      vibrancyViewForSecondaryLabel 0 94 254 15
        UIView3 0 94 254 15
          secondaryLabel 0 94 254 15 "Replacement buses run every ten…"
    nonVibrantImageView 299 45 28 20
    vibrantImageView 299 45 28 20
      UIView4 299 45 28 20
        vibrantArtwork 299 45 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, ATextThatIsCutEndsAtAWholeLine) {
    for (const double height : {160, 140, 120, 110, 100, 90, 80, 70}) {
        const auto cell = show({.primary = LongTitle, .secondary = LongText}, height);
        layout(cell, 327, height);
        for (const auto& [label, line] :
             {std::pair{cell->primaryLabel(), 17.0}, {cell->secondaryLabel(), 15.0}}) {
            const auto lines = linesOf(label);
            EXPECT_EQ(label->frame().size.height, line * static_cast<double>(lines.size()))
                << height;
            const auto bottom =
                label->convertPoint_toView({0, label->frame().size.height - 0.2 * line}, *cell).y;
            EXPECT_LE(bottom, height) << height;
        }
        EXPECT_TRUE(linesOf(cell->secondaryLabel()).back().ends_with("…")) << height;
    }
}

TEST_F(ItemCellLayoutTest, LinesGoOneByOneAsTheRowGetsLower) {
    std::string counts;
    for (double height = 180; height >= 40; height -= 10) {
        const auto cell = show({.primary = LongTitle, .secondary = LongText}, height);
        layout(cell, 327, height);
        counts += std::to_string(linesOf(cell->primaryLabel()).size()) + "+" +
                  std::to_string(linesOf(cell->secondaryLabel()).size()) + " ";
    }
    EXPECT_EQ(counts, "4+6 4+6 4+5 4+5 4+4 4+3 4+3 4+2 4+1 4+1 3+1 2+1 2+1 1+1 1+1 ");
}

TEST_F(ItemCellLayoutTest, LongTextsInTheLargestTypeAreCutToo) {
    useSize(UIContentSizeCategory::AX5);
    const auto cell = show({.primary = LongTitle, .secondary = LongText}, 343);
    EXPECT_EQ(layout(cell, 327, 343), R"(
cell 0 0 327 343
  (contentGuide 0 15 327 314)
  contentView 0 0 327 343
    (trailingGutterGuide 254 15 73 314)
    stackView 0 9 254 329
      vibrancyViewForPrimaryLabel 0 9 254 265
        UIView2 0 9 254 265
          primaryLabel 0 9 254 265 "Between" "Harbour" "Square" "and" "Central…"
      vibrancyViewForSecondaryLabel 0 289 254 49
        UIView3 0 289 254 49
          secondaryLabel 0 289 254 49 "Replaceme…"
    nonVibrantImageView 299 162 28 20
    vibrantImageView 299 162 28 20
      UIView4 299 162 28 20
        vibrantArtwork 299 162 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, ARowThatGetsHigherShowsItsTextsAgain) {
    const auto cell = show({.primary = LongTitle, .secondary = LongText}, 70);
    layout(cell, 327, 70);
    cell->setRowHeight(400);
    const auto grown = layout(cell, 327, 400);
    EXPECT_EQ(grown, layout(show({.primary = LongTitle, .secondary = LongText}, 400), 327, 400));
    EXPECT_FALSE(linesOf(cell->secondaryLabel()).back().ends_with("…"));
}

TEST_F(ItemCellLayoutTest, LengthsAreWholePixelsAtEachScale) {
    useTraits({.displayScale = 2});
    EXPECT_EQ(layout(show({}), 327, RowHeight), R"(
cell 0 0 327 110
  (contentGuide 0 38.5 327 33)
  contentView 0 0 327 110
    (trailingGutterGuide 254 38.5 73 33)
    stackView 0 37 254 37.5
      vibrancyViewForPrimaryLabel 0 37 254 17
        UIView2 0 37 254 17
          primaryLabel 0 37 254 17 "U6"
      vibrancyViewForSecondaryLabel 0 59.5 254 15
        UIView3 0 59.5 254 15
          secondaryLabel 0 59.5 254 15 "Delays of ten minutes"
    nonVibrantImageView 299 45 28 20
    vibrantImageView 299 45 28 20
      UIView4 299 45 28 20
        vibrantArtwork 299 45 28 20 hidden
)");
}

TEST_F(ItemCellLayoutTest, AnUnchangedRowMeasuresNothingAgain) {
    const auto cell = show({.primary = LongTitle, .secondary = LongText});
    layout(cell, 327, RowHeight);
    const auto measured = UILabel::_measurements();
    const auto rendered = find<ArtworkImageView>(cell, "nonVibrantImageView")->_renders();
    cell->setTransitItem(item({.primary = LongTitle, .secondary = LongText}));
    cell->setNeedsLayout();
    layout(cell, 327, RowHeight);
    EXPECT_EQ(UILabel::_measurements(), measured);
    EXPECT_EQ(find<ArtworkImageView>(cell, "nonVibrantImageView")->_renders(), rendered);
}

} // namespace
} // namespace orvo
