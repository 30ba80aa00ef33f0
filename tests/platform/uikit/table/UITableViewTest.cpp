#include "TableTest.h"

#include <algorithm>

namespace orvo {
namespace {

using TableTest = testing::TableTest;
using Strings = std::vector<std::string>;

bool has(const Strings& drawn, const std::string& line) {
    return std::ranges::find(drawn, line) != drawn.end();
}

Strings fills(const Strings& drawn) {
    Strings found;
    std::ranges::copy_if(drawn, std::back_inserter(found), [](const auto& line) {
        return line.starts_with("fill");
    });
    return found;
}

// Separators

TEST_F(TableTest, LinesAreOnePixelHighAtTheBottomOfEachRowButThoseThatSayNone) {
    source->sections = {rows(3)};
    source->bare = {2};
    EXPECT_EQ(fills(draw()),
              (Strings{"fill 5B5B6333 at 0 9 100 1", "fill 5B5B6333 at 0 19 100 1"}));
    EXPECT_EQ(fills(draw(2)),
              (Strings{"fill 5B5B6333 at 0 9.5 100 0.5", "fill 5B5B6333 at 0 19.5 100 0.5"}));
}

TEST_F(TableTest, CellThatSaysSingleLineHasOneInATableWithout) {
    source->sections = {rows(2)};
    source->bare = {1};
    table->setSeparatorStyle(UITableViewCellSeparatorStyle::None);
    EXPECT_EQ(fills(draw()).size(), 1U);
}

TEST_F(TableTest, CellMayChangeItsLineWithoutAReload) {
    source->sections = {rows(2)};
    EXPECT_EQ(fills(draw()).size(), 2U);
    table->visibleCells().at(1)->setSeparatorStyleOverride(UITableViewCellSeparatorStyle::None);
    EXPECT_EQ(fills(draw()).size(), 1U);
}

TEST_F(TableTest, LinesKeepTheirInsetsOnTheSideWhereReadingStarts) {
    source->sections = {rows(1)};
    table->setSeparatorInset({0, 16, 0, 4});
    EXPECT_EQ(fills(draw()), (Strings{"fill 5B5B6333 at 16 9 80 1"}));
    card->setTraitCollection(
        UITraitCollection{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    EXPECT_EQ(fills(draw()), (Strings{"fill 5B5B6333 at 4 9 80 1"}));
}

TEST_F(TableTest, InsetsOfACellComeBeforeThoseOfTheTable) {
    source->sections = {rows(1)};
    table->setSeparatorInset({0, 16, 0, 0});
    shown();
    table->visibleCells().at(0)->setSeparatorInset(NSDirectionalEdgeInsets{0, 30, 0, 0});
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 10
  0-0 TextCell 0 10 line 30…0
)");
}

TEST_F(TableTest, EffectComesBeforeTheColourOfTheLines) {
    source->sections = {rows(1)};
    table->setSeparatorColor(UIColor::colorWithRGBA(RGBA::fromHex(0x010203)));
    EXPECT_EQ(fills(draw()), (Strings{"fill 010203 at 0 9 100 1"}));
    table->setSeparatorEffect(UIVibrancyEffect::widgetTertiaryVibrancyEffect());
    EXPECT_EQ(fills(draw()), (Strings{"fill 5B5B6333 at 0 9 100 1"}));
}

TEST_F(TableTest, RowsSeemToGoOnWithoutAFooter) {
    source->sections = {rows(2)};
    source->bare = {0, 1};
    EXPECT_TRUE(fills(draw()).empty());
    table->setTableFooterView(nullptr);
    EXPECT_EQ(fills(draw()),
              (Strings{"fill 5B5B6333 at 0 29 100 1",
                       "fill 5B5B6333 at 0 39 100 1",
                       "fill 5B5B6333 at 0 49 100 1"}));
    table->setSeparatorStyle(UITableViewCellSeparatorStyle::None);
    EXPECT_TRUE(fills(draw()).empty());
}

TEST_F(TableTest, FooterStandsUnderTheLastRowAndScrollsAlong) {
    source->sections = {rows(2)};
    const auto footer = UIView::initWithFrame({{0, 0}, {5, 40}});
    table->setTableFooterView(footer);
    card->layoutIfNeeded();
    EXPECT_EQ(footer->frame(), (CGRect{{0, 20}, {100, 40}}));
    EXPECT_EQ(table->contentSize(), (CGSize{100, 60}));
    table->setTableFooterView(nullptr);
    card->layoutIfNeeded();
    EXPECT_EQ(footer->superview(), nullptr);
    EXPECT_EQ(table->contentSize().height, 20);
}

TEST_F(TableTest, RowsAreClippedOnlyWhereTheyDoNotAllFit) {
    source->sections = {rows(5)};
    EXPECT_FALSE(has(draw(), "clip at 0 0 100 50"));
    source->sections = {rows(6)};
    table->reloadData();
    EXPECT_TRUE(has(draw(), "clip at 0 0 100 50"));
}

// Pressing

TEST_F(TableTest, PressedRowIsHighlightedAndSelectedWhenItIsLetGo) {
    source->sections = {rows(3)};
    shown();
    source->asked.clear();
    table->touchBegan({50, 15});
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 30
  0-0 TextCell 0 10 line
  0-1 TextCell 10 10 line pressed
  0-2 TextCell 20 10 line
)");
    EXPECT_TRUE(source->asked.empty());
    table->touchEnded({60, 18});
    EXPECT_EQ(source->asked, (Strings{"select 0-1"}));
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 30
  0-0 TextCell 0 10 line
  0-1 TextCell 10 10 line selected
  0-2 TextCell 20 10 line
)");
    EXPECT_TRUE(equal(table->indexPathForSelectedRow(), path(1)));
}

TEST_F(TableTest, RowsThatDoNotHighlightCannotBePressed) {
    source->sections = {rows(2)};
    source->dead = {1};
    shown();
    source->asked.clear();
    table->touchBegan({50, 15});
    EXPECT_FALSE(table->visibleCells().at(1)->isHighlighted());
    table->touchEnded({50, 15});
    EXPECT_FALSE(table->_pressRowAtIndexPath(path(1)));
    EXPECT_TRUE(source->asked.empty());
    EXPECT_TRUE(table->_pressRowAtIndexPath(path(0)));
    EXPECT_EQ(source->asked, (Strings{"select 0-0"}));
}

TEST_F(TableTest, PressThatLeavesItsRowIsOver) {
    source->sections = {rows(2)};
    shown();
    source->asked.clear();
    table->touchBegan({50, 5});
    table->touchMoved({50, 15});
    EXPECT_FALSE(table->visibleCells().at(0)->isHighlighted());
    table->touchMoved({50, 5});
    table->touchEnded({50, 5});
    EXPECT_TRUE(source->asked.empty());
}

TEST_F(TableTest, PressIsOverWhenTheTableScrollsOrReloads) {
    source->sections = {rows(10)};
    shown();
    source->asked.clear();
    table->touchBegan({50, 5});
    table->scrollBy({0, 3});
    table->touchEnded({50, 5});
    table->touchBegan({50, 15});
    table->reloadData();
    table->touchEnded({50, 15});
    EXPECT_EQ(std::ranges::count(source->asked, "select 0-0"), 0);
    EXPECT_EQ(std::ranges::count(source->asked, "select 0-1"), 0);
}

TEST_F(TableTest, SelectionByProgramTellsTheDelegateNothing) {
    source->sections = {rows(2)};
    shown();
    source->asked.clear();
    table->selectRowAtIndexPath_animated(path(1), false);
    EXPECT_TRUE(table->visibleCells().at(1)->isSelected());
    table->selectRowAtIndexPath_animated(path(0), false);
    EXPECT_FALSE(table->visibleCells().at(1)->isSelected());
    table->deselectRowAtIndexPath_animated(path(1), false);
    EXPECT_TRUE(equal(table->indexPathForSelectedRow(), path(0)));
    table->selectRowAtIndexPath_animated(path(7), false);
    EXPECT_EQ(table->indexPathForSelectedRow(), nullptr);
    EXPECT_TRUE(source->asked.empty());
}

TEST_F(TableTest, ReloadDeselects) {
    source->sections = {rows(2)};
    shown();
    table->selectRowAtIndexPath_animated(path(1), false);
    table->reloadData();
    card->layoutIfNeeded();
    EXPECT_EQ(table->indexPathForSelectedRow(), nullptr);
    EXPECT_FALSE(table->visibleCells().at(1)->isSelected());
}

TEST_F(TableTest, SelectedRowIsHeldWhileItIsOutOfSight) {
    source->sections = {rows(30)};
    shown();
    table->selectRowAtIndexPath_animated(path(1), false);
    table->scrollBy({0, 100});
    for (const auto& cell : table->visibleCells())
        EXPECT_FALSE(cell->isSelected());
    table->scrollBy({0, -100});
    card->layoutIfNeeded();
    EXPECT_TRUE(table->cellForRowAtIndexPath(*path(1))->isSelected());
}

TEST_F(TableTest, DeselectionFadesTheRowsGround) {
    withFrames();
    source->sections = {rows(1)};
    source->bare = {0};
    source->deselects = true;
    draw();
    table->touchBegan({50, 5});
    EXPECT_EQ(fills(draw()), (Strings{"fill 17171A14 radius 8 at -8 0 116 10"}));
    table->touchEnded({50, 5});
    EXPECT_EQ(table->indexPathForSelectedRow(), nullptr);
    EXPECT_EQ(fills(draw()), (Strings{"fill 17171A14 radius 8 at -8 0 116 10"}));
    advance(0.125);
    EXPECT_EQ(fills(draw()), (Strings{"fill 17171A0A radius 8 at -8 0 116 10"}));
    advance(0.125);
    EXPECT_TRUE(fills(draw()).empty());
}

TEST_F(TableTest, FadeEndsWhereTheCellIsNeededForSomethingElse) {
    withFrames();
    source->sections = {rows(2)};
    shown();
    const auto cell = table->visibleCells().at(0);
    const auto fade = [&] {
        cell->setSelected(true);
        cell->setSelected_animated(false, true);
        advance(0.125);
        EXPECT_EQ(cell->_highlightLevel(), 0.5);
    };
    fade();
    cell->prepareForReuse();
    EXPECT_EQ(cell->_highlightLevel(), 0);
    fade();
    cell->setHighlighted(true);
    advance(1);
    EXPECT_EQ(cell->_highlightLevel(), 1);
}

TEST_F(TableTest, DeselectionIsInstantForWhoWantsLessMotion) {
    withFrames();
    card->setTraitCollection(UITraitCollection{.reducesMotion = true});
    source->sections = {rows(1)};
    source->bare = {0};
    source->deselects = true;
    draw();
    table->touchBegan({50, 5});
    table->touchEnded({50, 5});
    EXPECT_TRUE(fills(draw()).empty());
}

// Keys

TEST_F(TableTest, KeysMoveTheFocusFromRowToRowAndScroll) {
    source->sections = {rows(30)};
    source->estimate = 10;
    table->becomeFirstResponder();
    EXPECT_TRUE(equal(table->focusedIndexPath(), path(0)));
    EXPECT_FALSE(table->pressKey(UITableViewKey::Up));
    for (int i = 0; i < 6; ++i)
        EXPECT_TRUE(table->pressKey(UITableViewKey::Down));
    EXPECT_EQ(shown(), R"(
table 100 50 from 20 of 300
  0-2 TextCell 20 10 line
  0-3 TextCell 30 10 line
  0-4 TextCell 40 10 line
  0-5 TextCell 50 10 line
  0-6 TextCell 60 10 line focused
)");
    EXPECT_TRUE(table->pressKey(UITableViewKey::Up));
    EXPECT_TRUE(equal(table->focusedIndexPath(), path(5)));
    EXPECT_TRUE(table->pressKey(UITableViewKey::End));
    EXPECT_EQ(texts().back(), "row 29");
    EXPECT_FALSE(table->pressKey(UITableViewKey::Down));
    EXPECT_TRUE(table->pressKey(UITableViewKey::PageUp));
    EXPECT_TRUE(equal(table->focusedIndexPath(), path(24)));
    EXPECT_TRUE(table->pressKey(UITableViewKey::Home));
    EXPECT_EQ(texts().front(), "row 0");
    EXPECT_TRUE(table->pressKey(UITableViewKey::PageDown));
    EXPECT_TRUE(equal(table->focusedIndexPath(), path(5)));
}

TEST_F(TableTest, ReturnPressesTheFocusedRow) {
    source->sections = {rows(2)};
    source->dead = {1};
    table->becomeFirstResponder();
    source->asked.clear();
    EXPECT_TRUE(table->pressKey(UITableViewKey::Return));
    EXPECT_EQ(source->asked, (Strings{"select 0-0"}));
    table->pressKey(UITableViewKey::Down);
    EXPECT_FALSE(table->pressKey(UITableViewKey::Return));
    EXPECT_EQ(source->asked.size(), 1U);
}

TEST_F(TableTest, FocusRingShowsOnlyWhileKeysGoToTheTable) {
    const auto rings = [](const Strings& drawn) {
        return std::ranges::count_if(
            drawn, [](const auto& line) { return line.starts_with("stroke 2 "); });
    };
    source->sections = {rows(2)};
    EXPECT_EQ(rings(draw()), 0);
    table->becomeFirstResponder();
    EXPECT_EQ(rings(draw()), 1);
    table->resignFirstResponder();
    EXPECT_EQ(rings(draw()), 0);
    EXPECT_TRUE(equal(table->focusedIndexPath(), path(0)));
}

TEST_F(TableTest, FocusStaysOnARowThatIsThere) {
    source->sections = {rows(5)};
    table->becomeFirstResponder();
    table->focusRowAtIndexPath(*path(4));
    source->sections = {rows(2)};
    table->reloadData();
    card->layoutIfNeeded();
    EXPECT_TRUE(equal(table->focusedIndexPath(), path(1)));
    source->sections = {{}};
    table->reloadData();
    card->layoutIfNeeded();
    EXPECT_EQ(table->focusedIndexPath(), nullptr);
}

} // namespace
} // namespace orvo
