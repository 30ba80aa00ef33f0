#include "print/PrintedWidget.h"

#include "platform/mapuikit/NetworkFailureDiagnosis.h"
#include "print/PrintWorld.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using testing::incident;
using testing::line;
using testing::widgetOf;

class PrintedWidgetTest : public ::testing::Test {
protected:
    testing::PrintWorld world;
};

TEST_F(PrintedWidgetTest, NoFavoritesAreOneRowThatLeadsToTheMap) {
    const auto widget = widgetOf({});
    EXPECT_EQ(widget.state, ServiceState::NoFavorites);
    EXPECT_EQ(widget.clearPercentage, 0);
    EXPECT_EQ(widget.summary.primaryText, "No favorite lines");
    EXPECT_EQ(widget.summary.opens->url, "orvo://?t=r");
    EXPECT_TRUE(widget.expanded.empty());
}

TEST_F(PrintedWidgetTest, AFailedFetchIsARowLikeAnyOther) {
    const auto source = NetworkFailureDiagnosisSource().overrideWith(
        [] { return static_cast<std::uint64_t>(NetworkFailureDiagnosis::NoInternet); });
    const auto widget = testing::widgetOfResult(testing::failure(), 5);
    EXPECT_EQ(widget.state, ServiceState::Unavailable);
    EXPECT_EQ(widget.clearPercentage, 0);
    EXPECT_EQ(widget.summary.primaryText, "Service status unavailable");
    EXPECT_EQ(widget.summary.secondaryText, "No internet connection.");
    EXPECT_FALSE(widget.summary.artwork);
    EXPECT_FALSE(widget.summary.opens);
    EXPECT_TRUE(widget.expanded.empty());
}

TEST_F(PrintedWidgetTest, GoodServiceIsOneRow) {
    const auto widget = widgetOf({line(1, "U1", {}), line(2, "U2", {})});
    EXPECT_EQ(widget.state, ServiceState::Good);
    EXPECT_EQ(widget.clearPercentage, 100);
    EXPECT_EQ(widget.summary.artwork->image, "good-v2");
    EXPECT_EQ(widget.summary.secondaryText, "All 2 lines are running normally");
    EXPECT_TRUE(widget.expanded.empty());
}

TEST_F(PrintedWidgetTest, AdvisoriesAreASummaryAndARowEach) {
    const auto widget =
        widgetOf({line(1, "U1", {incident(11)}), line(2, "U2", {incident(12)}), line(3, "U3", {})});
    EXPECT_EQ(widget.state, ServiceState::Advisories);
    EXPECT_EQ(widget.clearPercentage, 33);
    EXPECT_EQ(widget.summary.kind, PrintedRow::Kind::Summary);
    EXPECT_EQ(widget.summary.primaryText, "2 advisories");
    EXPECT_EQ(widget.summary.opens->incidentMuids, (std::vector<std::uint64_t>{11, 12}));
    ASSERT_EQ(widget.expanded.size(), 3U);
    EXPECT_EQ(widget.expanded[0].opens->lineMuid, 1U);
    EXPECT_EQ(widget.expanded[1].opens->lineMuid, 2U);
    EXPECT_EQ(widget.expanded[2].artwork->image, "good-alt-v2");
}

TEST_F(PrintedWidgetTest, WhatIsTooManyIsARowThatOpensTheHiddenIncidents) {
    std::vector<std::shared_ptr<TransitLineItem>> lines;
    for (std::uint64_t muid = 1; muid <= 5; ++muid)
        lines.push_back(line(muid, "U" + std::to_string(muid), {incident(10 + muid)}));
    const auto widget = widgetOf(lines, 3);
    ASSERT_EQ(widget.expanded.size(), 3U);
    EXPECT_EQ(widget.expanded[2].primaryText, "3 more advisories");
    EXPECT_EQ(widget.expanded[2].artwork->image, "advisories-v2");
    EXPECT_EQ(widget.expanded[2].opens->incidentMuids, (std::vector<std::uint64_t>{13, 14, 15}));
    EXPECT_EQ(widgetOf(lines, 0).expanded.size(), 5U);
}

TEST_F(PrintedWidgetTest, AnIncidentThatHasNotBegunDisturbsNoLine) {
    const auto coming = TransitIncidentRecord::initWithFields(
        {.muid = 1, .startDate = NSDate::dateWithTimeIntervalSinceNow(60), .title = "Coming"});
    const auto lines = std::vector{line(1, "U1", {coming}), line(2, "U2", {})};
    EXPECT_EQ(widgetOf(lines).state, ServiceState::Good);
    world.clock->advance(60);
    EXPECT_EQ(widgetOf(lines).state, ServiceState::Advisories);
    EXPECT_EQ(widgetOf(lines).clearPercentage, 50);
}

} // namespace
} // namespace orvo
