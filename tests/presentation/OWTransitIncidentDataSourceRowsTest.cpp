#include "DataSourceTest.h"
#include "presentation/OWTransitItemFixedHeightCell.h"
#include "presentation/OWTransitSummaryCell.h"

// What the table asks and is told.

namespace orvo {
namespace {

using namespace testing;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

TEST_F(DataSourceTest, AListThatHasNeverHadExpandedItemsHasNoExpandedRows) {
    const auto source = make(success(twoAdvisories()), {.expanded = true});
    source->setListItem(OWTransitListItem::initWithSummaryItem_expandedItems(
        source->listItem()->summaryItem(), nullptr));
    EXPECT_EQ(rowsOf(*source), 0);
    EXPECT_EQ(source->_itemAtIndexPath(row(0)), nullptr);
    EXPECT_EQ(source->tableView_shouldHighlightRowAtIndexPath(nullptr, row(0)), false);
    source->setAvailableWidth(300);
    EXPECT_EQ(rowsOf(*source), 0);
}

TEST_F(DataSourceTest, ConfiguresATableForBothCellsThenServesIt) {
    const auto source = make(success(twoAdvisories()));
    const auto made = table(source);
    EXPECT_THAT(made->calls,
                ElementsAre("register OWTransitItemFixedHeightCell",
                            "register OWTransitSummaryCell",
                            "footer",
                            "delegate",
                            "data source"));
    EXPECT_EQ(made->dataSource(), source);
    EXPECT_EQ(made->delegate(), source);
    ASSERT_TRUE(made->tableFooterView());
    EXPECT_EQ(made->tableFooterView()->frame().size, CGSize{});
    EXPECT_THAT(made->tableFooterView()->subviews(), IsEmpty());
}

TEST_F(DataSourceTest, HasOneSectionAndTheRowsOfTheModeInAny) {
    const auto source = make(success(twoAdvisories()));
    EXPECT_EQ(source->numberOfSectionsInTableView(nullptr), 1);
    EXPECT_EQ(source->tableView_numberOfRowsInSection(nullptr, 3), 1);
    source->setExpanded(true);
    EXPECT_EQ(source->tableView_numberOfRowsInSection(nullptr, 3), 2);
    EXPECT_EQ(source->tableView_estimatedHeightForRowAtIndexPath(nullptr, row(1)), 5);
}

TEST_F(DataSourceTest, ItemsAreThoseOfTheFirstSectionOnly) {
    const auto source = make(success(twoAdvisories()));
    EXPECT_EQ(source->_itemAtIndexPath(row(5)), source->shieldAjustedSummaryItem());
    EXPECT_EQ(source->_itemAtIndexPath(row(0, 1)), nullptr);
    source->setExpanded(true);
    EXPECT_EQ(source->_itemAtIndexPath(row(1)),
              source->shieldAdjustedExpandedItems()->objectAtIndex(1));
    EXPECT_EQ(source->_itemAtIndexPath(row(2)), nullptr);
}

TEST_F(DataSourceTest, ARowsCellHasItsItemTheColumnAndTheHeight) {
    cache->widths[{"a", 7}] = 100;
    const auto source = make(success(advisoriesWithShields({"a", "b"})), {.expanded = true});
    source->setRowHeight_maxNumberOfRows(130, NoLimit);
    const auto cell = std::dynamic_pointer_cast<OWTransitItemFixedHeightCell>(
        source->tableView_cellForRowAtIndexPath(table(source), row(1)));
    ASSERT_TRUE(cell);
    EXPECT_EQ(cell->transitItem(), source->shieldAdjustedExpandedItems()->objectAtIndex(1));
    EXPECT_EQ(cell->trailingArtworkColumnWidth(), 100);
    EXPECT_EQ(cell->rowHeight(), 130);
    EXPECT_EQ(cell->reuseIdentifier(), "OWTransitItemFixedHeightCell");
}

TEST_F(DataSourceTest, TheSummaryOfSeveralHasItsOwnCell) {
    const auto source = make(success(twoAdvisories()));
    source->setRowHeight_maxNumberOfRows(130, NoLimit);
    const auto cell = std::dynamic_pointer_cast<OWTransitSummaryCell>(
        source->tableView_cellForRowAtIndexPath(table(source), row(0)));
    ASSERT_TRUE(cell);
    EXPECT_EQ(cell->artworkCache(), cache);
    EXPECT_EQ(cell->item(), source->shieldAjustedSummaryItem());
    EXPECT_EQ(cell->rowHeight(), 130);
    EXPECT_EQ(cell->reuseIdentifier(), "OWTransitSummaryCell");
}

TEST_F(DataSourceTest, ErrorsNoFavoritesAndOneAdvisoryAreRowsLikeAnyOther) {
    for (const auto& result : {failure(), success({}), success(oneAdvisory())}) {
        const auto source = make(result);
        EXPECT_TRUE(std::dynamic_pointer_cast<OWTransitItemFixedHeightCell>(
            source->tableView_cellForRowAtIndexPath(table(source), row(0))));
    }
}

TEST_F(DataSourceTest, WhatIsNoRowHasAPlainCell) {
    const auto source = make(success(twoAdvisories()), {.expanded = true});
    const auto cell = source->tableView_cellForRowAtIndexPath(table(source), row(7));
    ASSERT_TRUE(cell);
    EXPECT_EQ(typeid(*cell), typeid(UITableViewCell));
    EXPECT_EQ(cell->style(), UITableViewCellStyle::Default);
    EXPECT_EQ(cell->reuseIdentifier(), "UITableViewCell");
    EXPECT_EQ(cell->separatorStyleOverride(), UITableViewCellSeparatorStyle::SingleLine);
}

TEST_F(DataSourceTest, EveryRowButTheLastHasASeparator) {
    const auto source = make(success(advisoriesWithShields({"a", "b", "c"})), {.expanded = true});
    const auto made = table(source);
    const auto style = [&](std::int64_t number) {
        return source->tableView_cellForRowAtIndexPath(made, row(number))->separatorStyleOverride();
    };
    EXPECT_EQ(style(0), UITableViewCellSeparatorStyle::SingleLine);
    EXPECT_EQ(style(1), UITableViewCellSeparatorStyle::SingleLine);
    EXPECT_EQ(style(2), UITableViewCellSeparatorStyle::None);
    source->setExpanded(false);
    EXPECT_EQ(style(0), UITableViewCellSeparatorStyle::None);
}

// Taps

TEST_F(DataSourceTest, ATapIsDeselectedThenTold) {
    const auto source = make(success(twoAdvisories()), {.expanded = true});
    const auto made = table(source);
    made->calls.clear();
    source->tableView_didSelectRowAtIndexPath(made, row(1));
    EXPECT_THAT(made->calls, ElementsAre("deselect 1 animated"));
    EXPECT_THAT(delegate->calls, ElementsAre("select 1"));
    EXPECT_EQ(delegate->selected, testing::rows(source->listItem())[1]->openable());
    EXPECT_EQ(source->tableView_shouldHighlightRowAtIndexPath(made, row(1)), true);
}

TEST_F(DataSourceTest, TheSummaryOpensItsActivity) {
    const auto source = make(success(twoAdvisories()));
    source->tableView_didSelectRowAtIndexPath(table(source), row(0));
    const auto summary =
        std::dynamic_pointer_cast<OWTransitSummaryItem>(source->listItem()->summaryItem());
    EXPECT_EQ(delegate->selected, summary->userActivityData());
    EXPECT_TRUE(delegate->selected);
}

TEST_F(DataSourceTest, ARowThatOpensNothingNeitherHighlightsNorIsTold) {
    const auto source = make(failure());
    const auto made = table(source);
    made->calls.clear();
    source->tableView_didSelectRowAtIndexPath(made, row(0));
    EXPECT_THAT(made->calls, ElementsAre("deselect 0 animated"));
    EXPECT_THAT(delegate->calls, IsEmpty());
    EXPECT_EQ(source->tableView_shouldHighlightRowAtIndexPath(made, row(0)), false);
    EXPECT_EQ(source->tableView_shouldHighlightRowAtIndexPath(made, row(0, 1)), false);
}

} // namespace
} // namespace orvo
