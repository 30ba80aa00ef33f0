#include "presentation/OWTransitIncidentDataSource.h"

#include "presentation/ArtworkColumn.h"
#include "presentation/OWTransitItemFixedHeightCell.h"
#include "presentation/OWTransitSummaryCell.h"
#include "support/LogCapture.h"
#include "viewmodel/BuilderWorld.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <utility>
#include <vector>

namespace orvo {
namespace {

using testing::artwork;
using testing::BuilderWorld;
using ::testing::ElementsAre;
using testing::incident;
using ::testing::IsEmpty;
using testing::line;
using testing::LogCapture;
using testing::WidthsCache;

constexpr std::uint64_t NoLimit = std::numeric_limits<std::uint64_t>::max();
using Lines = std::vector<std::shared_ptr<TransitLineItem>>;

std::shared_ptr<Result> success(const Lines& lines) {
    return Result::resultWithValue(NSArray::arrayOf(lines));
}

std::shared_ptr<Result> failure() {
    return Result::resultWithError(NSError::errorWithMessage("LookupDomain", 5, "no lookup"));
}

/// One line with one advisory.
Lines oneAdvisory() {
    return {line(1, {incident(11)})};
}
Lines oneAdvisoryAndAClearLine() {
    return {line(1, {incident(11)}), line(2, {})};
}
Lines twoAdvisories() {
    return {line(1, {incident(11)}), line(2, {incident(12)})};
}
/// As many lines as shields, each with an advisory.
Lines advisoriesWithShields(const std::vector<const char*>& shields) {
    Lines lines;
    std::uint64_t number = 0;
    for (const char* shield : shields) {
        ++number;
        lines.push_back(line(number, {incident(100 + number)}, {.alternate = artwork(shield)}));
    }
    return lines;
}

class Delegate final : public OWTransitIncidentDataSourceDelegate {
public:
    void dataSource_didSelectOpenableItem_atIndexPath(
        const std::shared_ptr<OWTransitIncidentDataSource>&,
        const std::shared_ptr<OWOpenable>& item,
        const std::shared_ptr<NSIndexPath>& indexPath) override {
        calls.push_back("select " + std::to_string(indexPath->row()));
        selected = item;
    }
    void dataSourceDidUpdateContent(
        const std::shared_ptr<OWTransitIncidentDataSource>& dataSource) override {
        calls.push_back("content " +
                        std::to_string(dataSource->tableView_numberOfRowsInSection(nullptr, 0)));
    }
    std::vector<std::string> calls;
    std::shared_ptr<OWOpenable> selected;
};

class Analytics final : public OWTransitIncidentsAnalyticsDelegate {
public:
    void recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
        const std::shared_ptr<NSArray>&,
        const std::shared_ptr<NSArray>& incidents,
        const std::shared_ptr<NSMapTable>&) override {
        displayed.push_back(incidents->count());
    }
    std::vector<std::size_t> displayed;
};

/// Notes what it is told, and is otherwise a table.
class RecordingTable final : public UITableView {
public:
    static std::shared_ptr<RecordingTable> make() {
        auto table = std::make_shared<RecordingTable>();
        table->_initWithFrame_style({{0, 0}, {359, 1000}}, UITableViewStyle::Plain);
        return table;
    }
    void registerClass_forCellReuseIdentifier(CellClass cellClass,
                                              const std::string& identifier) override {
        calls.push_back("register " + identifier);
        UITableView::registerClass_forCellReuseIdentifier(std::move(cellClass), identifier);
    }
    void deselectRowAtIndexPath_animated(const std::shared_ptr<NSIndexPath>& indexPath,
                                         bool animated) override {
        calls.push_back("deselect " + std::to_string(indexPath->row()) +
                        (animated ? " animated" : ""));
        UITableView::deselectRowAtIndexPath_animated(indexPath, animated);
    }
    std::vector<std::string> calls;
};

std::shared_ptr<NSIndexPath> row(std::int64_t number, std::int64_t section = 0) {
    return NSIndexPath::indexPathForRow_inSection(number, section);
}

class OWTransitIncidentDataSourceTest : public ::testing::Test {
protected:
    struct Options {
        bool expanded = false;
        std::uint64_t maxRows = NoLimit;
        double width = 359;
    };
    /// With the delegate of this test.
    std::shared_ptr<OWTransitIncidentDataSource> make(std::shared_ptr<Result> result,
                                                      Options options) {
        auto made = OWTransitIncidentDataSource::
            initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
                std::move(result), options.expanded, cache, options.maxRows, options.width);
        made->setDelegate(delegate);
        return made;
    }
    std::shared_ptr<OWTransitIncidentDataSource> make(std::shared_ptr<Result> result) {
        return make(std::move(result), Options());
    }
    static std::int64_t rowsOf(OWTransitIncidentDataSource& source) {
        return source.tableView_numberOfRowsInSection(nullptr, 0);
    }
    static std::vector<std::string> texts(const std::shared_ptr<NSArray>& items) {
        std::vector<std::string> texts;
        for (const auto& one : typed<OWTransitItem>(items))
            texts.push_back(one->primaryText().value_or("(nil)"));
        return texts;
    }
    /// The size of a row's shield; -1 where it has none.
    static std::int64_t shieldSizeOf(const std::shared_ptr<NSObject>& item) {
        const auto row = std::dynamic_pointer_cast<OWTransitItem>(item);
        const auto sized =
            row && row->artwork()
                ? std::dynamic_pointer_cast<SizedTransitArtwork>(row->artwork()->artworkSource())
                : nullptr;
        return sized ? sized->shieldSize() : -1;
    }
    std::shared_ptr<RecordingTable> table(const std::shared_ptr<OWTransitIncidentDataSource>& of) {
        auto made = RecordingTable::make();
        of->configureTableView(made);
        return made;
    }

    BuilderWorld world;
    LogCapture log;
    std::shared_ptr<WidthsCache> cache = std::make_shared<WidthsCache>();
    std::shared_ptr<Delegate> delegate = std::make_shared<Delegate>();
    std::shared_ptr<Analytics> analytics = std::make_shared<Analytics>();
};

// Made

TEST_F(OWTransitIncidentDataSourceTest, WithoutASavedStateItStartsWithoutFavoriteLines) {
    const auto source = make(nullptr);
    EXPECT_EQ(rowsOf(*source), 1);
    const auto item = std::dynamic_pointer_cast<OWTransitItem>(source->shieldAjustedSummaryItem());
    ASSERT_TRUE(item);
    EXPECT_EQ(*item->primaryText(), "TransitWidget_NoFavoriteTransitLines_Title[%1$@][%2$@][%3$@]");
    EXPECT_TRUE(source->transitLineItemResult()->isSuccess());
    EXPECT_EQ(source->shieldAdjustedExpandedItems()->count(), 0U);
    EXPECT_THAT(delegate->calls, IsEmpty());
}

TEST_F(OWTransitIncidentDataSourceTest, KeepsWhatItIsGiven) {
    const auto result = success(twoAdvisories());
    const auto source = make(result, {.expanded = true, .width = 320});
    EXPECT_EQ(source->transitLineItemResult(), result);
    EXPECT_EQ(source->artworkCache(), cache);
    EXPECT_EQ(source->availableWidth(), 320);
    EXPECT_TRUE(source->isExpanded());
    EXPECT_EQ(rowsOf(*source), 2);
}

TEST_F(OWTransitIncidentDataSourceTest, TheMaximumNumberOfRowsIsTheBuilders) {
    const auto source = make(success(advisoriesWithShields({"a", "b", "c", "d"})),
                             {.expanded = true, .maxRows = 2});
    EXPECT_EQ(rowsOf(*source), 2);
}

TEST_F(OWTransitIncidentDataSourceTest, ExpandingWithoutExpandedItemsIsRefusedAtTheStartToo) {
    EXPECT_FALSE(make(success(oneAdvisory()), {.expanded = true})->isExpanded());
    EXPECT_EQ(log.records().size(), 1U);
}

TEST_F(OWTransitIncidentDataSourceTest, ItsDelegateIsWeakAndItsCalculatorIsMadeOnce) {
    const auto source = make(nullptr);
    EXPECT_EQ(source->artworkColumnCalculator(), source->artworkColumnCalculator());
    delegate.reset();
    EXPECT_EQ(source->delegate(), nullptr);
}

// A new result

TEST_F(OWTransitIncidentDataSourceTest, TheSameResultAgainRebuildsNothing) {
    const auto result = success(twoAdvisories());
    const auto source = make(result);
    const auto listItem = source->listItem();
    source->updateTransitLineItemResult_captureAnalytics(result, analytics);
    EXPECT_EQ(source->listItem(), listItem);
    EXPECT_THAT(analytics->displayed, IsEmpty());
}

TEST_F(OWTransitIncidentDataSourceTest, AnEqualResultRebuildsAndIsNotToldWhereTheListIsEqual) {
    const auto lines = twoAdvisories();
    const auto source = make(success(lines));
    const auto listItem = source->listItem();
    const auto again = success(lines);
    source->updateTransitLineItemResult_captureAnalytics(again, analytics);
    EXPECT_EQ(source->transitLineItemResult(), again);
    EXPECT_THAT(analytics->displayed, ElementsAre(2U));
    EXPECT_EQ(source->listItem(), listItem);
    EXPECT_THAT(delegate->calls, IsEmpty());
}

TEST_F(OWTransitIncidentDataSourceTest, AnotherListIsTold) {
    const auto source = make(success(twoAdvisories()), {.expanded = true});
    source->updateTransitLineItemResult_captureAnalytics(success(oneAdvisoryAndAClearLine()),
                                                         analytics);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2"));
    EXPECT_EQ(
        texts(source->shieldAdjustedExpandedItems()),
        (std::vector<std::string>{"Title", "TransitWidget_GoodService_Title[%1$@][%2$@][%3$@]"}));
}

TEST_F(OWTransitIncidentDataSourceTest, RecalculatingShowsWhatHasBegunOrEnded) {
    const auto source = make(success({line(1, {incident(11, "Over soon", {.endsIn = 5})})}));
    world.clock->advance(10);
    source->recalculateDataSourceItemsWithAnalytics(analytics);
    EXPECT_THAT(analytics->displayed, ElementsAre(0U));
    EXPECT_THAT(delegate->calls, ElementsAre("content 1"));
}

TEST_F(OWTransitIncidentDataSourceTest, RecalculatingWithoutAnalyticsRecordsNothing) {
    const auto source = make(success(twoAdvisories()));
    source->recalculateDataSourceItemsWithAnalytics(nullptr);
    EXPECT_THAT(analytics->displayed, IsEmpty());
}

TEST_F(OWTransitIncidentDataSourceTest, SettingAnEqualListItemKeepsTheFittedItems) {
    const auto source = make(success(twoAdvisories()));
    const auto items = source->shieldAdjustedExpandedItems();
    source->setListItem(OWTransitListItem::initWithSummaryItem_expandedItems(
        source->listItem()->summaryItem(), source->listItem()->expandedItems()));
    EXPECT_EQ(source->shieldAdjustedExpandedItems(), items);
    EXPECT_THAT(delegate->calls, IsEmpty());
}

TEST_F(OWTransitIncidentDataSourceTest, TheExpandedModeStaysWithoutRowsToShow) {
    const auto source = make(success(twoAdvisories()), {.expanded = true});
    source->updateTransitLineItemResult_captureAnalytics(failure(), nullptr);
    EXPECT_TRUE(source->isExpanded());
    EXPECT_EQ(rowsOf(*source), 0);
    EXPECT_THAT(delegate->calls, ElementsAre("content 0"));
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(false, {300, 500}), (CGSize{300, 0}));
}

// Row height and limit

TEST_F(OWTransitIncidentDataSourceTest, TheSameHeightAndLimitDoNothing) {
    const auto source = make(success(twoAdvisories()));
    source->setRowHeight_maxNumberOfRows(110, NoLimit);
    EXPECT_THAT(delegate->calls, IsEmpty());
}

TEST_F(OWTransitIncidentDataSourceTest, AnotherHeightAloneIsToldWithoutARebuild) {
    const auto source = make(success(twoAdvisories()));
    const auto listItem = source->listItem();
    source->setRowHeight_maxNumberOfRows(140, NoLimit);
    EXPECT_EQ(source->listItem(), listItem);
    EXPECT_THAT(delegate->calls, ElementsAre("content 1"));
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(false, {300, 50}).height, 140);
}

TEST_F(OWTransitIncidentDataSourceTest, AnotherLimitIsToldOnlyWhereTheListChanges) {
    const auto source =
        make(success(advisoriesWithShields({"a", "b", "c"})), {.expanded = true, .maxRows = 5});
    source->setRowHeight_maxNumberOfRows(110, 4);
    EXPECT_THAT(delegate->calls, IsEmpty());
    source->setRowHeight_maxNumberOfRows(110, 2);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2"));
}

TEST_F(OWTransitIncidentDataSourceTest,
       AHeightThatChangesWithTheLimitIsNotToldWhereTheListIsEqual) {
    const auto source = make(success(twoAdvisories()), {.expanded = true, .maxRows = 5});
    source->setRowHeight_maxNumberOfRows(140, 4);
    EXPECT_THAT(delegate->calls, IsEmpty());
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(true, {300, 50}).height, 280);
}

// Modes

TEST_F(OWTransitIncidentDataSourceTest, ExpandingShowsTheRowsAndIsTold) {
    const auto source = make(success(twoAdvisories()));
    source->setExpanded(true);
    EXPECT_EQ(rowsOf(*source), 2);
    source->setExpanded(true);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2"));
    source->setExpanded(false);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2", "content 1"));
}

TEST_F(OWTransitIncidentDataSourceTest, ExpandingWithoutExpandedItemsIsLoggedAndStillTold) {
    const auto source = make(success(oneAdvisory()));
    source->setExpanded(true);
    EXPECT_FALSE(source->isExpanded());
    EXPECT_THAT(delegate->calls, ElementsAre("content 1"));
    const auto records = log.records();
    ASSERT_EQ(records.size(), 1U);
    EXPECT_EQ(records[0].level, LogLevel::Error);
    EXPECT_EQ(records[0].category, "TransitWidget");
    EXPECT_EQ(records[0].format,
              "Trying to set expanded state on widget datasource without expanded items to show, "
              "ignoring request to expand datasource state.\nListItem: %@");
    EXPECT_NE(records[0].message.find(descriptionOf(source->listItem())), std::string::npos);
}

TEST_F(OWTransitIncidentDataSourceTest, OnlyExpandingIsEverRefused) {
    const auto with = make(success(twoAdvisories()))->listItem();
    const auto without = make(success(oneAdvisory()))->listItem();
    const auto nil = OWTransitListItem::initWithSummaryItem_expandedItems(nullptr, nullptr);
    using Source = OWTransitIncidentDataSource;
    EXPECT_TRUE(Source::_sanatizedExpandedValue_forListItem(true, with));
    EXPECT_FALSE(Source::_sanatizedExpandedValue_forListItem(false, with));
    EXPECT_FALSE(Source::_sanatizedExpandedValue_forListItem(false, without));
    EXPECT_THAT(log.records(), IsEmpty());
    EXPECT_FALSE(Source::_sanatizedExpandedValue_forListItem(true, without));
    EXPECT_FALSE(Source::_sanatizedExpandedValue_forListItem(true, nil));
    EXPECT_EQ(log.records().size(), 2U);
}

TEST_F(OWTransitIncidentDataSourceTest, ThePreferredSizeIgnoresTheModeGivenAndTheMaximumHeight) {
    const auto source = make(success(twoAdvisories()));
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(true, {300, 50}), (CGSize{300, 110}));
    source->setExpanded(true);
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(false, {300, 50}),
              (CGSize{300, 220}));
}

// Widths

TEST_F(OWTransitIncidentDataSourceTest, ShieldsHaveAtLeast73PointsAndWhatTextLeaves) {
    const auto parameters = [this](double width) {
        return make(nullptr, {.width = width})->_sizeParameters();
    };
    EXPECT_EQ(parameters(320), (ArtworkWidthCalculatorSizeParameter{73, 106, {}}));
    EXPECT_EQ(parameters(100), (ArtworkWidthCalculatorSizeParameter{73, 73, {}}));
}

TEST_F(OWTransitIncidentDataSourceTest,
       ATooWideShieldIsReplacedByASmallerOneAndTheRestOfTheRowIsKept) {
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

TEST_F(OWTransitIncidentDataSourceTest, WithACompactItemTheColumnIsTheCompactRows) {
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

TEST_F(OWTransitIncidentDataSourceTest,
       ASummaryOfSeveralIsLeftAsItIsAndTheColumnIsTheExpandedRows) {
    cache->widths[{"a", 7}] = 100;
    const auto source = make(success(advisoriesWithShields({"a", "b"})));
    EXPECT_EQ(source->shieldAjustedSummaryItem(), source->listItem()->summaryItem());
    EXPECT_EQ(source->artworkColumnWidth(), 100);
}

TEST_F(OWTransitIncidentDataSourceTest, AWidthThatChangesNothingVisibleIsNotTold) {
    const auto source = make(success(advisoriesWithShields({"a", "b"})), {.expanded = true});
    source->setAvailableWidth(359);
    source->setAvailableWidth(400);
    EXPECT_EQ(source->availableWidth(), 400);
    EXPECT_THAT(delegate->calls, IsEmpty());
}

TEST_F(OWTransitIncidentDataSourceTest, AnotherColumnWidthIsTold) {
    cache->widths[{"a", 7}] = 140;
    cache->widths[{"a", 6}] = 100;
    const auto source = make(success(advisoriesWithShields({"a", "b"})), {.expanded = true});
    source->setAvailableWidth(320);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2"));
}

TEST_F(OWTransitIncidentDataSourceTest, OtherExpandedRowsOfTheSameColumnAreToldOnlyWhileExpanded) {
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

TEST_F(OWTransitIncidentDataSourceTest, ExpandedRowsAreNotComparedInTheCompactMode) {
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

// Rows

TEST_F(OWTransitIncidentDataSourceTest, ConfiguresATableForBothCells) {
    const auto source = make(success(twoAdvisories()));
    const auto made = table(source);
    EXPECT_THAT(
        made->calls,
        ElementsAre("register OWTransitItemFixedHeightCell", "register OWTransitSummaryCell"));
    EXPECT_EQ(made->dataSource(), source);
    EXPECT_EQ(made->delegate(), source);
    ASSERT_TRUE(made->tableFooterView());
    EXPECT_EQ(made->tableFooterView()->frame().size, CGSize{});
    EXPECT_THAT(made->tableFooterView()->subviews(), IsEmpty());
}

TEST_F(OWTransitIncidentDataSourceTest, HasOneSectionAndTheRowsOfTheModeInAny) {
    const auto source = make(success(twoAdvisories()));
    EXPECT_EQ(source->numberOfSectionsInTableView(nullptr), 1);
    EXPECT_EQ(source->tableView_numberOfRowsInSection(nullptr, 3), 1);
    source->setExpanded(true);
    EXPECT_EQ(source->tableView_numberOfRowsInSection(nullptr, 3), 2);
    EXPECT_EQ(source->tableView_estimatedHeightForRowAtIndexPath(nullptr, row(1)), 5);
}

TEST_F(OWTransitIncidentDataSourceTest, ItemsAreThoseOfTheFirstSectionOnly) {
    const auto source = make(success(twoAdvisories()));
    EXPECT_EQ(source->_itemAtIndexPath(row(5)), source->shieldAjustedSummaryItem());
    EXPECT_EQ(source->_itemAtIndexPath(row(0, 1)), nullptr);
    source->setExpanded(true);
    EXPECT_EQ(source->_itemAtIndexPath(row(1)),
              source->shieldAdjustedExpandedItems()->objectAtIndex(1));
    EXPECT_EQ(source->_itemAtIndexPath(row(2)), nullptr);
}

TEST_F(OWTransitIncidentDataSourceTest, ARowsCellHasItsItemTheColumnAndTheHeight) {
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

TEST_F(OWTransitIncidentDataSourceTest, TheSummaryOfSeveralHasItsOwnCell) {
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

TEST_F(OWTransitIncidentDataSourceTest, ErrorsNoFavoritesAndOneAdvisoryAreRowsLikeAnyOther) {
    for (const auto& result : {failure(), success({}), success(oneAdvisory())}) {
        const auto source = make(result);
        EXPECT_TRUE(std::dynamic_pointer_cast<OWTransitItemFixedHeightCell>(
            source->tableView_cellForRowAtIndexPath(table(source), row(0))));
    }
}

TEST_F(OWTransitIncidentDataSourceTest, WhatIsNoRowHasAPlainCell) {
    const auto source = make(success(twoAdvisories()), {.expanded = true});
    const auto cell = source->tableView_cellForRowAtIndexPath(table(source), row(7));
    ASSERT_TRUE(cell);
    EXPECT_EQ(typeid(*cell), typeid(UITableViewCell));
    EXPECT_EQ(cell->style(), UITableViewCellStyle::Default);
    EXPECT_EQ(cell->reuseIdentifier(), "UITableViewCell");
    EXPECT_EQ(cell->separatorStyleOverride(), UITableViewCellSeparatorStyle::SingleLine);
}

TEST_F(OWTransitIncidentDataSourceTest, EveryRowButTheLastHasASeparator) {
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

TEST_F(OWTransitIncidentDataSourceTest, ATapIsDeselectedThenTold) {
    const auto source = make(success(twoAdvisories()), {.expanded = true});
    const auto made = table(source);
    made->calls.clear();
    source->tableView_didSelectRowAtIndexPath(made, row(1));
    EXPECT_THAT(made->calls, ElementsAre("deselect 1 animated"));
    EXPECT_THAT(delegate->calls, ElementsAre("select 1"));
    EXPECT_EQ(delegate->selected, testing::rows(source->listItem())[1]->openable());
    EXPECT_EQ(source->tableView_shouldHighlightRowAtIndexPath(made, row(1)), true);
}

TEST_F(OWTransitIncidentDataSourceTest, TheSummaryOpensItsActivity) {
    const auto source = make(success(twoAdvisories()));
    source->tableView_didSelectRowAtIndexPath(table(source), row(0));
    const auto summary =
        std::dynamic_pointer_cast<OWTransitSummaryItem>(source->listItem()->summaryItem());
    EXPECT_EQ(delegate->selected, summary->userActivityData());
    EXPECT_TRUE(delegate->selected);
}

TEST_F(OWTransitIncidentDataSourceTest, ARowThatOpensNothingNeitherHighlightsNorIsTold) {
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
