#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include "handoff/Doubles.h"
#include "handoff/NSDataOrvoExtra.h"
#include "handoff/NSURLOWOpenable.h"
#include "handoff/OrvoActivity.h"
#include "platform/favorites/TransitStorageIncident.h"
#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/NSKeyedUnarchiver.h"
#include "platform/geoservices/Bzip2.h"
#include "platform/mapuikit/SizedTransitArtwork.h"
#include "platform/mapuikit/TransitIncidentStringProvider.h"
#include "viewmodel/BuilderWorld.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <limits>

namespace orvo {
namespace {

using testing::artwork;
using testing::BuilderWorld;
using testing::incident;
using testing::line;
using testing::rows;

struct Reported {
    std::shared_ptr<NSArray> lines;
    std::vector<std::shared_ptr<TransitIncident>> incidents;
    std::shared_ptr<NSMapTable> mapping;
};

class RecordingAnalytics final : public OWTransitIncidentsAnalyticsDelegate {
public:
    void recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
        const std::shared_ptr<NSArray>& lines,
        const std::shared_ptr<NSArray>& incidents,
        const std::shared_ptr<NSMapTable>& mapping) override {
        reports.push_back({lines, typed<TransitIncident>(incidents), mapping});
    }
    std::vector<Reported> reports;
};

class BuilderTest : public ::testing::Test {
protected:
    using Lines = std::vector<std::shared_ptr<TransitLineItem>>;

    /// One line for each incident, and as many lines without any.
    static Lines lines(std::uint64_t advisories, std::uint64_t clear) {
        Lines all;
        for (std::uint64_t i = 1; i <= advisories; ++i)
            all.push_back(line(i, {incident(100 + i)}));
        for (std::uint64_t i = 0; i < clear; ++i)
            all.push_back(line(1000 + i, {}));
        return all;
    }
    static std::shared_ptr<SizedTransitArtwork> sized(const std::shared_ptr<OWTransitItem>& row) {
        return std::dynamic_pointer_cast<SizedTransitArtwork>(row->artwork()->artworkSource());
    }
    static std::string imageName(const std::shared_ptr<OWTransitItem>& row) {
        const auto image = std::dynamic_pointer_cast<UIImage>(row->artwork()->artworkSource());
        return image ? image->name().value_or("") : "(not a fixed image)";
    }
    static std::vector<std::uint64_t> muidsOfList(const std::shared_ptr<OWOpenable>& openable) {
        const auto classes = CodingClassTable::current().overrideWith(
            std::make_shared<const CodingClassTable>(CodingClassTable{
                CodingClass::of<TransitStorageIncident>("TransitStorageIncident")}));
        const auto activity = std::dynamic_pointer_cast<OWUserActivityData>(openable);
        if (!activity || activity->activityType() != "com.zentu.Orvo.Transit.IncidentList")
            return {};
        const auto archive = std::dynamic_pointer_cast<NSData>(
            activity->userInfo()->objectForKey("incidentListKey"));
        const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(archive, nullptr);
        const auto list =
            std::dynamic_pointer_cast<NSArray>(unarchiver->decodeObjectOfClasses_forKey(
                {"NSArray", "TransitStorageIncident"}, "root"));
        std::vector<std::uint64_t> muids;
        for (const auto& stored : typed<TransitStorageIncident>(list))
            muids.push_back(stored->muid());
        return muids;
    }
    static std::shared_ptr<OrvoActivity> payload(const std::shared_ptr<OWTransitItem>& row) {
        const auto activity = std::dynamic_pointer_cast<OWUserActivityData>(row->openable());
        if (!activity || activity->activityType() != "com.zentu.Orvo.Transit.Incident")
            return nullptr;
        const auto compressed =
            std::dynamic_pointer_cast<NSData>(activity->userInfo()->objectForKey("bs"));
        return protoMessageWithBytes<OrvoActivity>(
            NSDataOrvoExtra::bzip2UncompressedData(*compressed)->bytes());
    }
    std::shared_ptr<OWTransitItem> summaryRow(const std::shared_ptr<OWTransitListItem>& list) {
        return std::dynamic_pointer_cast<OWTransitItem>(list->summaryItem());
    }
    std::shared_ptr<OWTransitSummaryItem> summary(const std::shared_ptr<OWTransitListItem>& list) {
        return std::dynamic_pointer_cast<OWTransitSummaryItem>(list->summaryItem());
    }

    BuilderWorld world;
};

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

TEST_F(BuilderTest, RowShowsTheAlternateArtworkElseTheSystemsNeverTheLinesOwn) {
    const auto own = summaryRow(world.list({line(
        1, {incident(1)}, {.system = testing::system("S", "S"), .alternate = artwork("U1")})}));
    EXPECT_TRUE(equal(sized(own)->artwork(), artwork("U1")));
    const auto systems =
        summaryRow(world.list({line(1, {incident(1)}, {.system = testing::system("S", "S")})}));
    EXPECT_TRUE(equal(sized(systems)->artwork(), artwork("S")));
    const auto none = summaryRow(world.list({line(1, {incident(1)})}));
    ASSERT_TRUE(sized(none)); // still an artwork, of nothing
    EXPECT_FALSE(sized(none)->artwork());
    EXPECT_EQ(sized(own)->shieldSize(), 7);
    EXPECT_EQ(sized(own)->artworkCache(), world.cache);
    EXPECT_EQ(own->artwork()->alpha(), 1.0);
    EXPECT_FALSE(own->isArtworkHidden());
}

TEST_F(BuilderTest, LineActivityHoldsTheLineAndMapTypeThreeOnly) {
    const auto activity = payload(summaryRow(world.list({line(7, {incident(70)})})));
    ASSERT_TRUE(activity);
    EXPECT_EQ(activity->lineItem()->muid(), 7U);
    EXPECT_EQ(activity->lineItem()->incidents()->count(), 1U);
    EXPECT_EQ(activity->displayOptions()->mapType(), 3);
    EXPECT_EQ(activity->dictionaryRepresentation()->count(), 2U);
}

TEST_F(BuilderTest, RestoredLineItemIsTheSourceOfThePayload) {
    const auto stored = TransitStorageLineItem::initWithLineItem(
        line(7,
             {incident(70), incident(71)},
             {.name = "U7", .system = testing::system("S", "S"), .alternate = artwork("U7")}));
    const auto restored = protoMessageWithBytes<TransitStorageLineItem>(stored->data()->bytes());
    ASSERT_TRUE(restored);
    const auto list = world.list({restored});
    ASSERT_EQ(rows(list).size(), 2U);
    for (const auto& row : rows(list)) {
        EXPECT_TRUE(equal(sized(row)->artwork(), artwork("U7")));
        EXPECT_TRUE(equal(payload(row)->lineItem(), stored));
    }
    EXPECT_EQ(muidsOfList(summary(list)->userActivityData()), (std::vector<std::uint64_t>{70, 71}));
}

TEST_F(BuilderTest, WhatTheRowsOfALineHandOverIsPackedOnce) {
    int packed = 0;
    const auto scope = Bzip2Compressor().overrideWith(
        [&](const std::uint8_t*, std::size_t, std::uint8_t**, std::size_t*) {
            ++packed;
            return false;
        });
    const auto list = world.list({line(1, {incident(11), incident(12), incident(13)}),
                                  line(2, {incident(21), incident(22)})});
    EXPECT_EQ(rows(list).size(), 5U);
    EXPECT_EQ(packed, 2);
}

TEST_F(BuilderTest, FailedCompressionLeavesTheRowWithoutAnOpenable) {
    const auto scope = Bzip2Compressor().overrideWith(
        [](const std::uint8_t*, std::size_t, std::uint8_t**, std::size_t*) { return false; });
    const auto row = summaryRow(world.list(lines(1, 0)));
    ASSERT_TRUE(row);
    EXPECT_FALSE(row->openable());
}

TEST_F(BuilderTest, FailedArchivingLeavesTheSummaryWithoutAnActivity) {
    const auto scope = NSKeyedArchiver::archiving().overrideWith(
        [](const auto&, bool requiresSecureCoding, auto*) -> std::shared_ptr<NSData> {
            EXPECT_TRUE(requiresSecureCoding);
            return nullptr;
        });
    EXPECT_FALSE(summary(world.list(lines(2, 0)))->userActivityData());
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

class SharedRowTest : public BuilderTest {
protected:
    /// The row of one incident that lines of these systems share, each line with a shield of its
    /// own.
    std::shared_ptr<OWTransitItem> sharedRow(const std::vector<const char*>& marks) {
        Lines all;
        for (std::size_t i = 0; i < marks.size(); ++i)
            all.push_back(line(i + 1,
                               {incident(10)},
                               {.name = i == 0 ? "first" : "other",
                                .system = testing::system("S", marks[i]),
                                .alternate = artwork("own")}));
        return rows(world.list(all))[0];
    }
};

TEST_F(SharedRowTest, ShowsTheSystemsArtworkWhenAllAgree) {
    const auto row = sharedRow({"A", "A", "A"});
    EXPECT_TRUE(equal(sized(row)->artwork(), artwork("A")));
    EXPECT_EQ(sized(row)->shieldSize(), 7);
    EXPECT_EQ(row->artwork()->alpha(), 1.0);
    EXPECT_EQ(row->primaryText(), "Title");
    EXPECT_EQ(payload(row)->lineItem()->muid(), 1U); // what a tap opens stays the first line's
}

TEST_F(SharedRowTest, PassesOverLinesBeforeTheFirstThatHasOne) {
    EXPECT_TRUE(equal(sized(sharedRow({nullptr, "A", "A"}))->artwork(), artwork("A")));
}

TEST_F(SharedRowTest, IsGenericWhenALaterOneIsMissingOrDiffersOrNoneHasOne) {
    for (const auto& marks : {std::vector<const char*>{"A", nullptr},
                              std::vector<const char*>{"A", "B"},
                              std::vector<const char*>{nullptr, nullptr},
                              std::vector<const char*>{nullptr, "A", nullptr}}) {
        const auto row = sharedRow(marks);
        EXPECT_EQ(imageName(row), "WidgetGenericTransit");
        EXPECT_EQ(row->artwork()->alpha(), 0.30000001192092896);
        EXPECT_NE(row->artwork()->alpha(), 0.3);
    }
}

TEST_F(SharedRowTest, OnlyRowsOfSeveralLinesAreRewrittenAndKeepWhatIsNotTheirs) {
    const auto openable = NSURLOWOpenable::openableWithURL(NSURL::URLWithString("orvo://?t=r"));
    const auto row = [&] {
        return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
            "Title", "Summary", nullptr, true, openable);
    };
    std::vector<_OWDisplayedRow> displayed{{row(), {line(1, {})}},
                                           {row(), {line(2, {}), line(3, {})}}};
    const auto alone = displayed[0].item;
    const auto shared = displayed[1].item;
    world.builder({})->_updateItemsAffectingSeveralLines_itemToLinesMap(displayed);
    EXPECT_EQ(displayed[0].item, alone);
    ASSERT_NE(displayed[1].item, shared);
    EXPECT_EQ(displayed[1].item->primaryText(), "Title");
    EXPECT_TRUE(displayed[1].item->isArtworkHidden());
    EXPECT_EQ(displayed[1].item->openable(), openable);
    EXPECT_EQ(displayed[1].lines.size(), 2U);
}

TEST_F(BuilderTest, SummaryShowsDistinctShieldsInRowOrderSharedRowsTheLinesOwn) {
    const auto system = testing::system("S", "S");
    const auto list = world.list(
        {line(1, {incident(10)}, {.system = system, .alternate = artwork("U1")}),
         line(2, {incident(20)}, {.system = system}),
         line(3, {incident(10), incident(30)}, {.system = system, .alternate = artwork("U3")}),
         line(4, {incident(40)}),
         line(5, {incident(50)}, {.alternate = artwork("U1")})});
    const auto artworks = typed<TransitArtworkDataSource>(summary(list)->artworks());
    ASSERT_EQ(artworks.size(), 3U);
    EXPECT_TRUE(equal(artworks[0], artwork("U1")));
    EXPECT_TRUE(equal(artworks[1], artwork("U3"))); // row 1 is shown by lines 1 and 3
    EXPECT_TRUE(equal(artworks[2], artwork("S")));
    EXPECT_EQ(summary(list)->primaryText(), "TransitWidget_Summary_advisory_count[5][][]");
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

TEST_F(BuilderTest, ThreeAdvisoriesOfOneSystemWithoutOwnShieldsGiveOneArtwork) {
    const auto system = testing::system("S", "S");
    const auto list = world.list({line(1, {incident(10)}, {.system = system}),
                                  line(2, {incident(20)}, {.system = testing::system("S", "S")}),
                                  line(3, {incident(30)}, {.system = system})});
    EXPECT_EQ(summary(list)->artworks()->count(), 1U);
}

TEST_F(BuilderTest, FavouritesURLNamesTypeTwoAndTheTransitMap) {
    const auto url = OWTransitIncidentsDataSourceBuilder::_urlForFavorites();
    ASSERT_TRUE(url);
    EXPECT_EQ(url->absoluteString().substr(0, 24), "orvo://?favorites=2&t=r&");
}

TEST_F(BuilderTest, BothGoodServiceRowsOpenTheFavourites) {
    for (const auto& row :
         {summaryRow(world.list(lines(0, 1))), rows(world.list(lines(1, 1))).back()}) {
        ASSERT_TRUE(std::dynamic_pointer_cast<NSURLOWOpenable>(row->openable()));
        EXPECT_EQ(descriptionOf(row->openable()).substr(0, 23), "orvo://?favorites=2&t=r");
    }
}

TEST_F(BuilderTest, FavouritesURLSharesTheSessionAndThenConvertsTheBuiltURL) {
    const testing::OpeningDoubles doubles;
    const auto url = OWTransitIncidentsDataSourceBuilder::_urlForFavorites();
    EXPECT_EQ(*doubles.journal,
              (std::vector<std::string>{"session callback=0 share=1 reset=0", "conversion"}));
    EXPECT_EQ(url->absoluteString(), "orvo://?favorites=2&t=r&session=S1");
}

TEST_F(BuilderTest, SessionIsSharedForEachRowAsItIsMade) {
    const testing::OpeningDoubles doubles;
    const auto shared = [&](const std::shared_ptr<OWTransitListItem>&) {
        const auto count = std::ranges::count_if(
            *doubles.journal, [](const auto& entry) { return entry.starts_with("session"); });
        doubles.journal->clear();
        return count;
    };
    EXPECT_EQ(shared(world.list({})), 0); // its URL goes as it stands
    EXPECT_EQ(shared(world.list(lines(0, 2))), 1);
    EXPECT_EQ(shared(world.list(lines(1, 0))), 1);
    EXPECT_EQ(shared(world.list(lines(1, 1))), 2);
    EXPECT_EQ(shared(world.list(lines(3, 1))), 5); // three rows, the summary, the clear row
    EXPECT_EQ(shared(world.list(lines(3, 1), 2)),
              6); // and the overflow row; hidden ones are made too
}

TEST_F(BuilderTest, FavouritesURLIsConvertedWhenBuiltAndAgainWhenOpened) {
    const testing::OpeningDoubles doubles;
    const auto row = summaryRow(world.list(lines(0, 1)));
    EXPECT_EQ(std::ranges::count(*doubles.journal, "conversion"), 1);
    row->openable()->openInContext_completionHandler(doubles.controller, {});
    EXPECT_EQ(std::ranges::count(*doubles.journal, "conversion"), 2);
    EXPECT_EQ(doubles.journal->back(), "open orvo://?favorites=2&t=r&session=S1");
}

} // namespace
} // namespace orvo
