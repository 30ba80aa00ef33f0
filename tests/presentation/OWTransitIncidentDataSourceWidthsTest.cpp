#include "DataSourceTest.h"

// How the shields of the rows are fitted into the width that the widget has.

namespace orvo {
namespace {

using namespace testing;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

TEST_F(DataSourceTest, ShieldsHaveAtLeast73PointsAndWhatTextLeaves) {
    const auto parameters = [this](double width) {
        return make(nullptr, {.width = width})->_sizeParameters();
    };
    EXPECT_EQ(parameters(320), (ArtworkWidthCalculatorSizeParameter{73, 106, {}}));
    EXPECT_EQ(parameters(100), (ArtworkWidthCalculatorSizeParameter{73, 73, {}}));
}

TEST_F(DataSourceTest, ATooWideShieldIsReplacedByASmallerOneAndTheRestOfTheRowIsKept) {
    cache->widths[{"wide", 7}] = 200;
    cache->widths[{"wide", 6}] = 90;
    const auto source = make(success(advisoriesWithShields({"wide", "b"})), {.expanded = true});
    const auto before = testing::rows(source->listItem())[0];
    const auto after = typed<OWTransitItem>(source->shieldAdjustedExpandedItems())[0];
    EXPECT_EQ(source->artworkColumnWidth(), 90);
    EXPECT_EQ(shieldSizeOf(before), 7);
    EXPECT_EQ(shieldSizeOf(after), 6);
    EXPECT_EQ(after->primaryText(), before->primaryText());
    EXPECT_EQ(after->secondaryText(), before->secondaryText());
    EXPECT_EQ(after->isArtworkHidden(), before->isArtworkHidden());
    EXPECT_EQ(after->openable(), before->openable());
    EXPECT_EQ(after->artwork()->alpha(), before->artwork()->alpha());
}

TEST_F(DataSourceTest, ADimmedOrHiddenShieldStaysSoWhenItIsReplaced) {
    cache->widths[{"wide", 7}] = 200;
    cache->widths[{"wide", 6}] = 90;
    const auto source = make(success(advisoriesWithShields({"wide", "b"})), {.expanded = true});
    const auto shown = testing::rows(source->listItem())[0];
    const auto dimmed =
        OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
            "dimmed",
            std::nullopt,
            OWConfiguredArtwork::initWithArtworkSource_alpha(shown->artwork()->artworkSource(),
                                                             0.5),
            true,
            nullptr);
    source->setListItem(OWTransitListItem::initWithSummaryItem_expandedItems(
        dimmed, NSArray::arrayOf({dimmed, shown})));
    const auto after = std::dynamic_pointer_cast<OWTransitItem>(source->shieldAjustedSummaryItem());
    ASSERT_EQ(shieldSizeOf(after), 6);
    EXPECT_EQ(after->artwork()->alpha(), 0.5);
    EXPECT_TRUE(after->isArtworkHidden());
    EXPECT_EQ(after->secondaryText(), std::nullopt);
    EXPECT_EQ(after->openable(), nullptr);
}

TEST_F(DataSourceTest, WithACompactItemTheColumnIsTheCompactRows) {
    cache->widths[{"wide", 7}] = 120;
    Lines lines = advisoriesWithShields({"wide"});
    lines.push_back(line(9, {}));
    const auto source = make(success(lines), {.expanded = true, .width = 359});
    EXPECT_EQ(source->artworkColumnWidth(), 120);
    EXPECT_EQ(shieldSizeOf(source->shieldAjustedSummaryItem()), 7);
    source->setAvailableWidth(320);
    EXPECT_EQ(shieldSizeOf(source->shieldAjustedSummaryItem()), 6); // 60 points
    EXPECT_EQ(source->artworkColumnWidth(), 73);
}

TEST_F(DataSourceTest, TheColumnIsTheCompactRowsAlsoWhereExpandedOnesAreWider) {
    cache->widths[{"wide", 7}] = 120;
    for (const bool expanded : {false, true}) {
        const auto source =
            make(success(advisoriesWithShields({"wide", "narrow"})), {.expanded = expanded});
        EXPECT_EQ(source->artworkColumnWidth(), 120);
        const auto items = source->listItem()->expandedItems();
        source->setListItem(
            OWTransitListItem::initWithSummaryItem_expandedItems(items->objectAtIndex(1), items));
        EXPECT_EQ(source->artworkColumnWidth(), 73);
        source->setAvailableWidth(400);
        EXPECT_EQ(source->artworkColumnWidth(), 73);
        EXPECT_EQ(source->isExpanded(), expanded);
    }
}

TEST_F(DataSourceTest, ASummaryOfSeveralIsLeftAsItIsAndTheColumnIsTheExpandedRows) {
    cache->widths[{"a", 7}] = 100;
    const auto source = make(success(advisoriesWithShields({"a", "b"})));
    EXPECT_EQ(source->shieldAjustedSummaryItem(), source->listItem()->summaryItem());
    EXPECT_EQ(source->artworkColumnWidth(), 100);
}

TEST_F(DataSourceTest, AWidthThatChangesNothingVisibleIsNotTold) {
    const auto source = make(success(advisoriesWithShields({"a", "b"})), {.expanded = true});
    source->setAvailableWidth(359);
    source->setAvailableWidth(400);
    EXPECT_EQ(source->availableWidth(), 400);
    EXPECT_THAT(delegate->calls, IsEmpty());
}

TEST_F(DataSourceTest, AnotherColumnWidthIsTold) {
    cache->widths[{"a", 7}] = 140;
    cache->widths[{"a", 6}] = 100;
    const auto source = make(success(advisoriesWithShields({"a", "b"})), {.expanded = true});
    source->setAvailableWidth(320);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2"));
}

TEST_F(DataSourceTest, ANarrowerColumnIsToldInBothModes) {
    // At 320 points the widest column is 106: the wide shield shrinks to as wide as the other is.
    cache->widths[{"a", 7}] = 145;
    cache->widths[{"a", 6}] = 100;
    cache->widths[{"huge", 7}] = 500;
    cache->widths[{"huge", 6}] = 145;
    cache->widths[{"huge", 5}] = 100;
    cache->widths[{"b", 7}] = 100;
    const auto widthsTold = [&](bool expanded) {
        delegate->calls.clear();
        const auto source =
            make(success(advisoriesWithShields({"b", "c"})), {.expanded = expanded, .width = 359});
        // The same column, other rows: what a narrower widget would have made of other shields.
        source->setListItem(make(success(advisoriesWithShields({"huge", "b"})))->listItem());
        delegate->calls.clear();
        source->setAvailableWidth(358); // at most 144: huge shrinks from 145 to 100
        return delegate->calls;
    };
    EXPECT_THAT(widthsTold(true), ElementsAre("content 2"));
    EXPECT_THAT(widthsTold(false), ElementsAre("content 1")); // the column narrows too
}

TEST_F(DataSourceTest, ExpandedRowsAreNotComparedInTheCompactMode) {
    // The second row shrinks, but the column stays as wide as the first.
    cache->widths[{"first", 7}] = 100;
    cache->widths[{"second", 7}] = 145;
    cache->widths[{"second", 6}] = 100;
    const auto calls = [&](bool expanded) {
        const auto source = make(success(advisoriesWithShields({"first", "second"})),
                                 {.expanded = expanded, .width = 340});
        EXPECT_EQ(source->artworkColumnWidth(), 100); // at most 126
        delegate->calls.clear();
        cache->widths[{"second", 6}] = 120; // wider at the next look, so that it shrinks again
        cache->widths[{"second", 5}] = 100;
        source->setAvailableWidth(330); // at most 116
        cache->widths[{"second", 6}] = 100;
        return delegate->calls;
    };
    EXPECT_THAT(calls(true), ElementsAre("content 2"));
    EXPECT_THAT(calls(false), IsEmpty());
}

TEST_F(DataSourceTest, AnotherSummaryOfTheSameColumnIsToldInBothModes) {
    const auto calls = [&](bool expanded) {
        Lines lines = advisoriesWithShields({"only"});
        lines.push_back(line(9, {}));
        cache->widths[{"only", 7}] = 145;
        cache->widths[{"only", 6}] = 100;
        const auto source = make(success(lines), {.expanded = expanded, .width = 340});
        EXPECT_EQ(source->artworkColumnWidth(), 100); // at most 126
        cache->widths[{"only", 6}] = 120;             // wider at the next look
        cache->widths[{"only", 5}] = 100;
        source->setAvailableWidth(330); // at most 116
        EXPECT_EQ(source->artworkColumnWidth(), 100);
        EXPECT_EQ(shieldSizeOf(source->shieldAjustedSummaryItem()), 5);
        return std::exchange(delegate->calls, {});
    };
    EXPECT_THAT(calls(false), ElementsAre("content 1"));
    EXPECT_THAT(calls(true), ElementsAre("content 2"));
}

} // namespace
} // namespace orvo
