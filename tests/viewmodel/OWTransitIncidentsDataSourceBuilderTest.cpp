#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include "viewmodel/BuilderTest.h"

#include <algorithm>
#include <limits>

namespace orvo {
namespace {

using testing::artwork;
using testing::BuilderTest;
using testing::incident;
using testing::line;
using testing::RecordingAnalytics;
using testing::rows;

TEST_F(BuilderTest, MaximumZeroIsStoredAsTheLargestNumberAndNeverCuts) {
    EXPECT_EQ(world.builder({}, 0)->maxNumberOfItems(), std::numeric_limits<std::uint64_t>::max());
    EXPECT_EQ(world.builder({}, 3)->maxNumberOfItems(), 3U);
    EXPECT_EQ(rows(world.list(lines(40, 1), 0)).size(), 41U);
}

TEST_F(BuilderTest, ResultPicksTheBuilder) {
    const auto error = NSError::errorWithMessage("d", 1, "m");
    const auto forValue = OWTransitDataSourceBuilderForResult(
        Result::resultWithValue(NSArray::arrayOf(lines(1, 0))), 2, world.cache, nullptr);
    const auto forError = OWTransitDataSourceBuilderForResult(
        Result::resultWithError(error), 2, world.cache, nullptr);
    ASSERT_TRUE(std::dynamic_pointer_cast<OWTransitIncidentsDataSourceBuilder>(forValue));
    EXPECT_FALSE(std::dynamic_pointer_cast<OWTransitIncidentsDataSourceBuilder>(forError));
    EXPECT_FALSE(forValue->analyticsResultType());
    EXPECT_FALSE(forValue->analyticsTransitIncidentItems());
    EXPECT_EQ(forError->analyticsResultType(), 0);
}

TEST_F(BuilderTest, ErrorOffersTheCompactModeAndReportsNothing) {
    const auto analytics = std::make_shared<RecordingAnalytics>();
    const auto list = OWTransitDataSourceBuilderForResult(
                          Result::resultWithError(NSError::errorWithMessage("d", 1, "m")),
                          2,
                          world.cache,
                          analytics)
                          ->listItem();
    EXPECT_EQ(OWTransitListItemNCWidget::widgetLargestAvailableDisplayMode(*list),
              NCWidgetDisplayMode::Compact);
    EXPECT_TRUE(analytics->reports.empty());
}

TEST_F(BuilderTest, ListItemIsBuiltOnceAndRecordedOnce) {
    const auto analytics = std::make_shared<RecordingAnalytics>();
    const auto builder = world.builder(lines(2, 1), 0, analytics);
    EXPECT_EQ(builder->listItem(), builder->listItem());
    EXPECT_EQ(analytics->reports.size(), 1U);
}

TEST_F(BuilderTest, FilterIsMadeOnFirstReadAndCanBeReplaced) {
    class NothingFilter final : public OWTransitIncidentFilter {
    public:
        bool shouldDisplayIncident(const TransitIncident&) const override { return false; }
    };
    const auto builder = world.builder(lines(2, 0));
    ASSERT_TRUE(builder->incidentFilter());
    EXPECT_EQ(builder->incidentFilter(), builder->incidentFilter());
    builder->setIncidentFilter(std::make_shared<NothingFilter>());
    EXPECT_TRUE(rows(builder->listItem()).empty());
    EXPECT_EQ(imageName(summaryRow(builder->listItem())), "good-v2");
}

TEST_F(BuilderTest, IncidentOneSecondAheadOrPastIsNotShownOneWithoutDatesIs) {
    const OWTransitIncidentFilter filter;
    const auto shown = [&](testing::IncidentPeriod period) {
        return filter.shouldDisplayIncident(*incident(1, "t", period));
    };
    EXPECT_FALSE(shown({.startsIn = 1}));
    EXPECT_FALSE(shown({.endsIn = -1}));
    EXPECT_TRUE(shown({}));
    EXPECT_TRUE(shown({.startsIn = -1, .endsIn = 1}));
}

TEST_F(BuilderTest, IncidentThatBeginsOrEndsExactlyNowIsShown) {
    const OWTransitIncidentFilter filter;
    EXPECT_TRUE(filter.shouldDisplayIncident(*incident(1, "t", {.startsIn = 0})));
    EXPECT_TRUE(filter.shouldDisplayIncident(*incident(1, "t", {.endsIn = 0})));
}

TEST_F(BuilderTest, NoLinesIsTheNoFavouritesRowReportedToAnalytics) {
    const auto analytics = std::make_shared<RecordingAnalytics>();
    const auto list = world.builder({}, 0, analytics)->listItem();
    const auto row = summaryRow(list);
    ASSERT_TRUE(row);
    EXPECT_EQ(row->primaryText(), "TransitWidget_NoFavoriteTransitLines_Title[%1$@][%2$@][%3$@]");
    EXPECT_EQ(row->secondaryText(),
              "TransitWidget_NoFavoriteTransitLines_SecondaryText[%1$@][%2$@][%3$@]");
    EXPECT_FALSE(row->artwork());
    EXPECT_TRUE(row->isArtworkHidden());
    EXPECT_EQ(descriptionOf(row->openable()), "orvo://?t=r");
    EXPECT_EQ(list->expandedItems()->count(), 0U);
    ASSERT_EQ(analytics->reports.size(), 1U);
    EXPECT_EQ(analytics->reports[0].lines->count(), 0U);
    EXPECT_TRUE(analytics->reports[0].incidents.empty());
    EXPECT_EQ(analytics->reports[0].mapping->count(), 0U);
}

TEST_F(BuilderTest, LinesWithoutAdvisoriesAreAllClear) {
    const auto list = world.list(lines(0, 3));
    const auto row = summaryRow(list);
    ASSERT_TRUE(row);
    EXPECT_EQ(row->primaryText(), "TransitWidget_GoodService_Title[%1$@][%2$@][%3$@]");
    EXPECT_EQ(row->secondaryText(), "TransitWidget_GoodService_SecondaryText[3][][]");
    EXPECT_EQ(imageName(row), "good-v2");
    EXPECT_EQ(row->artwork()->alpha(), 1.0);
    EXPECT_FALSE(row->isArtworkHidden());
    EXPECT_EQ(list->expandedItems()->count(), 0U);
}

TEST_F(BuilderTest, OneAdvisoryAndNoClearLineIsTheCompactRowAlone) {
    const auto list = world.list(lines(1, 0));
    ASSERT_TRUE(summaryRow(list));
    EXPECT_EQ(summaryRow(list)->primaryText(), "Title");
    EXPECT_EQ(list->expandedItems()->count(), 0U);
}

TEST_F(BuilderTest, OneAdvisoryWithClearLinesIsNeverCut) {
    const auto list = world.list(lines(1, 2), 1);
    ASSERT_EQ(rows(list).size(), 2U);
    EXPECT_EQ(rows(list)[0], list->summaryItem()); // the same object
    EXPECT_EQ(rows(list)[1]->primaryText(), "TransitWidget_GoodService_Title[%1$@][%2$@][%3$@]");
    EXPECT_EQ(imageName(rows(list)[1]), "good-alt-v2");
    EXPECT_EQ(rows(list)[1]->artwork()->alpha(), 0.3);
    EXPECT_EQ(rows(list)[1]->secondaryText(),
              "TransitWidget_GoodService_Overflow_SecondaryText[2][][]");
    EXPECT_FALSE(rows(list)[1]->isArtworkHidden());
}

TEST_F(BuilderTest, TwoAdvisoriesHaveASummaryAndTheirRowsInOrder) {
    const auto list = world.list(
        {line(1, {incident(10, "first")}), line(2, {incident(20, "second")}), line(3, {})});
    ASSERT_TRUE(summary(list));
    EXPECT_EQ(summary(list)->primaryText(), "TransitWidget_Summary_advisory_count[2][][]");
    ASSERT_EQ(rows(list).size(), 3U);
    EXPECT_EQ(rows(list)[0]->primaryText(), "first");
    EXPECT_EQ(rows(list)[1]->primaryText(), "second");
    EXPECT_EQ(imageName(rows(list)[2]), "good-alt-v2");
}

TEST_F(BuilderTest, LineWhoseOnlyAdvisoryIsSharedIsAlsoGoodService) {
    const auto list = world.list(
        {line(1, {incident(10)}, {.name = "U1"}), line(2, {incident(10)}, {.name = "U2"})});
    ASSERT_EQ(rows(list).size(), 2U);
    EXPECT_EQ(rows(list)[0]->secondaryText(),
              "TransitWidget_2_Lines_Prepended_Incident_Text[U1][U2][Summary]");
    EXPECT_EQ(rows(list)[1]->secondaryText(),
              "TransitWidget_GoodService_Overflow_SecondaryText[1][][]");
}

TEST_F(BuilderTest, SameIncidentTwiceInOneLineMakesASharedRow) {
    const auto list = world.list(
        {line(1,
              {incident(10), incident(10)},
              {.name = "U1", .system = testing::system("S", "S"), .alternate = artwork("U1")})});
    const auto row = summaryRow(list);
    ASSERT_TRUE(row);
    EXPECT_EQ(row->secondaryText(),
              "TransitWidget_Single_Line_Prepended_Incident_Text[U1][Summary][]");
    EXPECT_TRUE(equal(sized(row)->artwork(), artwork("S")));
}

TEST_F(BuilderTest, ClearLinesAreAllThatEndWithoutARow) {
    const auto list = world.list({line(1, {incident(10)}),
                                  line(2, {}),
                                  line(3, {incident(30, "t", {.startsIn = 60})}),
                                  line(4, {incident(10)}),
                                  line(5, {incident(50)})});
    EXPECT_EQ(rows(list).back()->secondaryText(),
              "TransitWidget_GoodService_Overflow_SecondaryText[3][][]");
}

class SilentFor final : public TransitIncidentStringProvider {
public:
    explicit SilentFor(std::shared_ptr<TransitIncident> silent)
        : _silent(std::move(silent)) {}
    std::optional<std::string>
    cellTitleForIncident(const std::shared_ptr<TransitIncident>& shown) const override {
        return shown == _silent ? std::optional<std::string>("") : "title";
    }
    std::optional<std::string>
    cellSecondaryTextForIncident(const std::shared_ptr<TransitIncident>& shown) const override {
        return shown == _silent ? std::nullopt : std::optional<std::string>("text");
    }

private:
    std::shared_ptr<TransitIncident> _silent;
};

TEST_F(BuilderTest, IncidentWithoutTextsMakesNoRowAndTheNextLineTriesAgain) {
    const auto silent = incident(10);
    const auto scope =
        TransitIncidentStringProvider::provider().overrideWith(std::make_shared<SilentFor>(silent));
    const auto analytics = std::make_shared<RecordingAnalytics>();
    const auto second = line(2, {incident(10)});
    const auto list = world.builder({line(1, {silent}), second}, 0, analytics)->listItem();
    ASSERT_EQ(rows(list).size(), 2U);
    EXPECT_EQ(rows(list)[0]->primaryText(), "title");
    ASSERT_EQ(analytics->reports[0].incidents.size(), 1U);
    EXPECT_EQ(analytics->reports[0].mapping->objectForKey(analytics->reports[0].incidents[0]),
              second);
}

TEST_F(BuilderTest, OneTextIsEnoughForARow) {
    const auto onlyTitle = TransitIncidentRecord::initWithFields({.muid = 1, .title = "t"});
    const auto onlyText = TransitIncidentRecord::initWithFields({.muid = 2, .summary = "s"});
    EXPECT_EQ(rows(world.list({line(1, {onlyTitle, onlyText}), line(2, {})})).size(), 3U);
}

TEST_F(BuilderTest, PositionPastTheEndGivesNoRow) {
    EXPECT_FALSE(world.builder({})->_itemForIncidentAtIndex_inLine(5, line(1, {incident(1)})));
}

TEST_F(BuilderTest, AnalyticsGetsEveryDisplayedIncidentWhateverIsCut) {
    const auto analytics = std::make_shared<RecordingAnalytics>();
    const auto all = lines(5, 0);
    (void)world.builder(all, 2, analytics)->listItem();
    ASSERT_EQ(analytics->reports.size(), 1U);
    EXPECT_EQ(analytics->reports[0].incidents.size(), 5U);
    EXPECT_EQ(analytics->reports[0].lines->count(), 5U);
    for (std::size_t i = 0; i < 5; ++i)
        EXPECT_EQ(analytics->reports[0].mapping->objectForKey(analytics->reports[0].incidents[i]),
                  all[i]);
}

TEST_F(BuilderTest, SharedIncidentMapsToTheLineInWhichItWasFirstMet) {
    const auto analytics = std::make_shared<RecordingAnalytics>();
    const auto first = line(1, {incident(10)});
    (void)world.builder({first, line(2, {incident(10)})}, 0, analytics)->listItem();
    ASSERT_EQ(analytics->reports[0].incidents.size(), 1U);
    EXPECT_EQ(analytics->reports[0].mapping->objectForKey(analytics->reports[0].incidents[0]),
              first);
}

TEST_F(BuilderTest, SixAdvisoriesAndAClearRowInFourKeepTwoRowsOverflowAndClear) {
    const auto list = world.list(lines(6, 1), 4);
    const auto shown = rows(list);
    ASSERT_EQ(shown.size(), 4U);
    EXPECT_EQ(payload(shown[0])->lineItem()->muid(), 1U);
    EXPECT_EQ(payload(shown[1])->lineItem()->muid(), 2U);
    EXPECT_EQ(imageName(shown[2]), "advisories-v2");
    EXPECT_EQ(shown[2]->artwork()->alpha(), 0.3);
    EXPECT_EQ(shown[2]->primaryText(), "TransitWidget_advisory_overflow_title[4][][]");
    EXPECT_EQ(shown[2]->secondaryText(), "TransitWidget_AdvisoriesOverflow_SecondaryText[4][][]");
    EXPECT_EQ(muidsOfList(shown[2]->openable()), (std::vector<std::uint64_t>{103, 104, 105, 106}));
    EXPECT_EQ(imageName(shown[3]), "good-alt-v2");
    EXPECT_EQ(muidsOfList(summary(list)->userActivityData()).size(), 6U); // hidden ones too
}

TEST_F(BuilderTest, ThreeAdvisoriesInTwoKeepOneRowAndTheOverflow) {
    const auto shown = rows(world.list(lines(3, 0), 2));
    ASSERT_EQ(shown.size(), 2U);
    EXPECT_EQ(payload(shown[0])->lineItem()->muid(), 1U);
    EXPECT_EQ(muidsOfList(shown[1]->openable()), (std::vector<std::uint64_t>{102, 103}));
}

TEST_F(BuilderTest, MaximumOneWithAClearRowLeavesOnlyTheOverflowRow) {
    const auto shown = rows(world.list(lines(2, 1), 1));
    ASSERT_EQ(shown.size(), 1U);
    EXPECT_EQ(imageName(shown[0]), "advisories-v2");
    EXPECT_EQ(shown[0]->primaryText(), "TransitWidget_advisory_overflow_title[2][][]");
}

TEST_F(BuilderTest, OverflowAlwaysLeavesExactlyTheMaximum) {
    for (std::uint64_t advisories = 2; advisories <= 7; ++advisories)
        for (const std::uint64_t clear : {0U, 1U})
            for (std::uint64_t maximum = 1; maximum <= 9; ++maximum) {
                const auto shown = rows(world.list(lines(advisories, clear), maximum));
                const auto count = advisories + clear;
                EXPECT_EQ(shown.size(), std::min(count, maximum))
                    << advisories << " " << clear << " " << maximum;
                if (count <= maximum)
                    continue;
                // Every advisory is either shown or counted as hidden, and two at least are hidden.
                const auto overflow = std::ranges::find_if(shown, [](const auto& row) {
                    return !payload(row) && imageName(row) == "advisories-v2";
                });
                ASSERT_NE(overflow, shown.end());
                const auto hidden = muidsOfList((*overflow)->openable()).size();
                EXPECT_GE(hidden, 2U);
                const auto advisoryRows = std::ranges::count_if(
                    shown, [](const auto& row) { return payload(row) != nullptr; });
                EXPECT_EQ(hidden + static_cast<std::size_t>(advisoryRows), advisories);
            }
}

TEST_F(BuilderTest, OverflowCountsEachHiddenIncidentsFirstLineOnly) {
    const auto list = world.list({line(1, {incident(10)}),
                                  line(2, {incident(20), incident(21)}),
                                  line(3, {incident(21), incident(30)})},
                                 2);
    const auto shown = rows(list);
    // Hidden are 20, 21 (first met in line 2) and 30 (line 3).
    EXPECT_EQ(shown[1]->primaryText(), "TransitWidget_advisory_overflow_title[3][][]");
    EXPECT_EQ(shown[1]->secondaryText(), "TransitWidget_AdvisoriesOverflow_SecondaryText[2][][]");
}

TEST_F(BuilderTest, RowsAreRewrittenBeforeTheReportAndShapedAfterIt) {
    class Watching final : public OWTransitIncidentsAnalyticsDelegate {
    public:
        explicit Watching(const testing::KeyBundle& bundle)
            : _bundle(bundle) {}
        void recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
            const std::shared_ptr<NSArray>&,
            const std::shared_ptr<NSArray>&,
            const std::shared_ptr<NSMapTable>&) override {
            keysBefore = _bundle.keys;
        }
        std::vector<std::string> keysBefore;

    private:
        const testing::KeyBundle& _bundle;
    };
    const auto analytics = std::make_shared<Watching>(*world.bundle);
    const auto shared = line(1, {incident(10)}, {.name = "U1"});
    const auto other = line(2, {incident(10), incident(20)}, {.name = "U2"});
    (void)world.builder({shared, other, line(3, {incident(30)})}, 2, analytics)->listItem();
    EXPECT_EQ(analytics->keysBefore,
              (std::vector<std::string>{"TransitWidget_2_Lines_Prepended_Incident_Text"}));
    EXPECT_EQ(world.bundle->keys,
              (std::vector<std::string>{"TransitWidget_2_Lines_Prepended_Incident_Text",
                                        "TransitWidget_Summary_advisory_count",
                                        "TransitWidget_advisory_overflow_title",
                                        "TransitWidget_AdvisoriesOverflow_SecondaryText"}));
}

TEST_F(BuilderTest, MappingKnowsIncidentsByIdentity) {
    const auto analytics = std::make_shared<RecordingAnalytics>();
    const auto met = TransitStorageIncident::initWithIncident(incident(10));
    const auto twin = TransitStorageIncident::initWithIncident(incident(10));
    ASSERT_TRUE(equal(met, twin));
    (void)world.builder({line(1, {met}), line(2, {twin})}, 0, analytics)->listItem();
    ASSERT_EQ(analytics->reports[0].mapping->count(), 1U);
    EXPECT_TRUE(analytics->reports[0].mapping->objectForKey(met));
    EXPECT_FALSE(analytics->reports[0].mapping->objectForKey(twin));
}

TEST_F(BuilderTest, RowsThatLookTheSameStayApart) {
    const auto list = world.list({line(1, {incident(10), incident(11)}, {.name = "U1"}),
                                  line(2, {incident(11)}, {.name = "U2"})});
    ASSERT_EQ(rows(list).size(), 3U);
    EXPECT_EQ(rows(list)[0]->secondaryText(), "Summary"); // only the other one is shared
    EXPECT_EQ(rows(list)[1]->secondaryText(),
              "TransitWidget_2_Lines_Prepended_Incident_Text[U1][U2][Summary]");
}

TEST_F(BuilderTest, TextsAreLookedUpInTheOrderInWhichRowsShowThem) {
    const auto keys = [&](const Lines& all) {
        world.bundle->keys.clear();
        (void)world.list(all);
        return world.bundle->keys;
    };
    EXPECT_EQ(keys({}),
              (std::vector<std::string>{"TransitWidget_NoFavoriteTransitLines_Title",
                                        "TransitWidget_NoFavoriteTransitLines_SecondaryText"}));
    EXPECT_EQ(keys(lines(0, 1)),
              (std::vector<std::string>{"TransitWidget_GoodService_Title",
                                        "TransitWidget_GoodService_SecondaryText"}));
    EXPECT_EQ(keys(lines(2, 1)),
              (std::vector<std::string>{"TransitWidget_Summary_advisory_count",
                                        "TransitWidget_GoodService_Title",
                                        "TransitWidget_GoodService_Overflow_SecondaryText"}));
}

} // namespace
} // namespace orvo
