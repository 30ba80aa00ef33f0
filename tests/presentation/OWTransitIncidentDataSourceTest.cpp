#include "presentation/OWTransitIncidentDataSource.h"

#include "DataSourceTest.h"

namespace orvo {
namespace {

using namespace testing;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

TEST_F(DataSourceTest, WithoutASavedStateItStartsWithoutFavoriteLines) {
    const auto source = make(nullptr);
    EXPECT_EQ(rowsOf(*source), 1);
    const auto item = std::dynamic_pointer_cast<OWTransitItem>(source->shieldAjustedSummaryItem());
    ASSERT_TRUE(item);
    EXPECT_EQ(*item->primaryText(), "TransitWidget_NoFavoriteTransitLines_Title[%1$@][%2$@][%3$@]");
    EXPECT_TRUE(source->transitLineItemResult()->isSuccess());
    EXPECT_EQ(source->shieldAdjustedExpandedItems()->count(), 0U);
    EXPECT_THAT(delegate->calls, IsEmpty());
}

TEST_F(DataSourceTest, KeepsWhatItIsGiven) {
    const auto result = success(twoAdvisories());
    const auto source = make(result, {.expanded = true, .width = 320});
    EXPECT_EQ(source->transitLineItemResult(), result);
    EXPECT_EQ(source->artworkCache(), cache);
    EXPECT_EQ(source->availableWidth(), 320);
    EXPECT_TRUE(source->isExpanded());
    EXPECT_EQ(rowsOf(*source), 2);
}

TEST_F(DataSourceTest, TheMaximumNumberOfRowsIsTheBuilders) {
    const auto source = make(success(advisoriesWithShields({"a", "b", "c", "d"})),
                             {.expanded = true, .maxRows = 2});
    EXPECT_EQ(rowsOf(*source), 2);
}

TEST_F(DataSourceTest, ExpandingWithoutExpandedItemsIsRefusedAtTheStartToo) {
    EXPECT_FALSE(make(success(oneAdvisory()), {.expanded = true})->isExpanded());
    EXPECT_EQ(log.records().size(), 1U);
}

TEST_F(DataSourceTest, ItsDelegateIsWeakAndItsCalculatorIsMadeOnce) {
    const auto source = make(nullptr);
    EXPECT_EQ(source->artworkColumnCalculator(), source->artworkColumnCalculator());
    delegate.reset();
    EXPECT_EQ(source->delegate(), nullptr);
}

// A new result

TEST_F(DataSourceTest, TheSameResultAgainRebuildsNothing) {
    const auto result = success(twoAdvisories());
    const auto source = make(result);
    const auto listItem = source->listItem();
    source->updateTransitLineItemResult_captureAnalytics(result, analytics);
    EXPECT_EQ(source->listItem(), listItem);
    EXPECT_THAT(analytics->displayed, IsEmpty());
}

TEST_F(DataSourceTest, AnEqualResultRebuildsAndIsNotToldWhereTheListIsEqual) {
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

TEST_F(DataSourceTest, AnotherListIsTold) {
    const auto source = make(success(twoAdvisories()), {.expanded = true});
    source->updateTransitLineItemResult_captureAnalytics(success(oneAdvisoryAndAClearLine()),
                                                         analytics);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2"));
    EXPECT_EQ(
        texts(source->shieldAdjustedExpandedItems()),
        (std::vector<std::string>{"Title", "TransitWidget_GoodService_Title[%1$@][%2$@][%3$@]"}));
}

TEST_F(DataSourceTest, RecalculatingShowsWhatHasBegunOrEnded) {
    const auto source = make(success({line(1, {incident(11, "Over soon", {.endsIn = 5})})}));
    world.clock->advance(10);
    source->recalculateDataSourceItemsWithAnalytics(analytics);
    EXPECT_THAT(analytics->displayed, ElementsAre(0U));
    EXPECT_THAT(delegate->calls, ElementsAre("content 1"));
}

TEST_F(DataSourceTest, RecalculatingWithoutAnalyticsRecordsNothing) {
    const auto source = make(success(twoAdvisories()));
    source->recalculateDataSourceItemsWithAnalytics(nullptr);
    EXPECT_THAT(analytics->displayed, IsEmpty());
}

TEST_F(DataSourceTest, SettingAnEqualListItemKeepsTheFittedItems) {
    const auto source = make(success(twoAdvisories()));
    const auto items = source->shieldAdjustedExpandedItems();
    source->setListItem(OWTransitListItem::initWithSummaryItem_expandedItems(
        source->listItem()->summaryItem(), source->listItem()->expandedItems()));
    EXPECT_EQ(source->shieldAdjustedExpandedItems(), items);
    EXPECT_THAT(delegate->calls, IsEmpty());
}

TEST_F(DataSourceTest, TheExpandedModeStaysWithoutRowsToShow) {
    const auto source = make(success(twoAdvisories()), {.expanded = true});
    source->updateTransitLineItemResult_captureAnalytics(failure(), nullptr);
    EXPECT_TRUE(source->isExpanded());
    EXPECT_EQ(rowsOf(*source), 0);
    EXPECT_THAT(delegate->calls, ElementsAre("content 0"));
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(false, {300, 500}), (CGSize{300, 0}));
}

// Row height and limit

TEST_F(DataSourceTest, TheSameHeightAndLimitDoNothing) {
    const auto source = make(success(twoAdvisories()));
    source->setRowHeight_maxNumberOfRows(110, NoLimit);
    EXPECT_THAT(delegate->calls, IsEmpty());
}

TEST_F(DataSourceTest, AnotherHeightAloneIsToldWithoutARebuild) {
    const auto source = make(success(twoAdvisories()));
    const auto listItem = source->listItem();
    source->setRowHeight_maxNumberOfRows(140, NoLimit);
    EXPECT_EQ(source->listItem(), listItem);
    EXPECT_THAT(delegate->calls, ElementsAre("content 1"));
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(false, {300, 50}).height, 140);
}

TEST_F(DataSourceTest, AnotherLimitIsToldOnlyWhereTheListChanges) {
    const auto source =
        make(success(advisoriesWithShields({"a", "b", "c"})), {.expanded = true, .maxRows = 5});
    source->setRowHeight_maxNumberOfRows(110, 4);
    EXPECT_THAT(delegate->calls, IsEmpty());
    source->setRowHeight_maxNumberOfRows(110, 2);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2"));
}

TEST_F(DataSourceTest, AHeightThatChangesWithTheLimitIsKeptWhenTheListIsTold) {
    const auto source =
        make(success(advisoriesWithShields({"a", "b", "c"})), {.expanded = true, .maxRows = 5});
    source->setRowHeight_maxNumberOfRows(140, 2);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2"));
    EXPECT_THAT(delegate->heights, ElementsAre(280));
}

TEST_F(DataSourceTest, AHeightThatChangesWithTheLimitIsNotToldWhereTheListIsEqual) {
    const auto source = make(success(twoAdvisories()), {.expanded = true, .maxRows = 5});
    source->setRowHeight_maxNumberOfRows(140, 4);
    EXPECT_THAT(delegate->calls, IsEmpty());
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(true, {300, 50}).height, 280);
}

// Modes

TEST_F(DataSourceTest, ExpandingShowsTheRowsAndIsTold) {
    const auto source = make(success(twoAdvisories()));
    source->setExpanded(true);
    EXPECT_EQ(rowsOf(*source), 2);
    source->setExpanded(true);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2"));
    source->setExpanded(false);
    EXPECT_THAT(delegate->calls, ElementsAre("content 2", "content 1"));
}

TEST_F(DataSourceTest, ExpandingWithoutExpandedItemsIsLoggedAndStillTold) {
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

TEST_F(DataSourceTest, OnlyExpandingIsEverRefused) {
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
    EXPECT_FALSE(Source::_sanatizedExpandedValue_forListItem(true, nullptr));
    EXPECT_EQ(log.records().size(), 3U);
}

TEST_F(DataSourceTest, ThePreferredSizeIgnoresTheModeGivenAndTheMaximumHeight) {
    const auto source = make(success(twoAdvisories()));
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(true, {300, 50}), (CGSize{300, 110}));
    source->setExpanded(true);
    EXPECT_EQ(source->preferredContentSizeForExpanded_maxSize(false, {300, 50}),
              (CGSize{300, 220}));
}

} // namespace
} // namespace orvo
