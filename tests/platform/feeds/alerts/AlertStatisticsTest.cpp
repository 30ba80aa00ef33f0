#include "platform/feeds/alerts/AlertStatistics.h"

#include <gtest/gtest.h>

#include <set>

namespace orvo::testing {

TEST(AlertStatistics, EveryReasonHasWordsOfItsOwn) {
    std::set<std::string_view> names;
    for (std::size_t i = 0; i < static_cast<std::size_t>(AlertCount::Count_); ++i)
        names.insert(AlertStatistics::nameOf(static_cast<AlertCount>(i)));
    EXPECT_EQ(names.size(), static_cast<std::size_t>(AlertCount::Count_));
    EXPECT_FALSE(names.contains(""));
    EXPECT_EQ(AlertStatistics::nameOf(AlertCount::Incidents), "incidents");
    EXPECT_EQ(AlertStatistics::nameOf(AlertCount::UnservedStops),
              "selectors with a stop of no line");
}

TEST(AlertStatistics, PrintsWhatWasCountedInAFixedOrder) {
    AlertStatistics statistics;
    statistics.add(AlertCount::Incidents, 2);
    statistics.add(AlertCount::Alerts, 3);
    statistics.addUnresolved(AlertCount::UnknownRoutes, "route_id X");
    statistics.addUnresolved(AlertCount::UnknownRoutes, "route_id X");
    EXPECT_EQ(statistics.description(),
              "alerts: 3\nselectors with an unknown route: 2\nincidents: 2\n"
              "unresolved: route_id X (2×)\n");
}

TEST(AlertStatistics, SumsByKind) {
    AlertStatistics statistics;
    statistics.add(AlertCount::UnreadableEntities);
    statistics.add(AlertCount::UnreadableIds, 2);
    statistics.add(AlertCount::EmptySelectors, 4);
    statistics.add(AlertCount::ContradictorySelectors, 8);
    statistics.add(AlertCount::AlertsWithoutEffect, 16);
    EXPECT_EQ(statistics.unreadable(), 3U);
    EXPECT_EQ(statistics.unresolvedSelectors(), 12U);
}

TEST(AlertStatistics, AddsUp) {
    AlertStatistics one;
    one.addUnresolved(AlertCount::UnknownAgencies, "agency_id A");
    AlertStatistics other = one;
    other.add(AlertCount::Alerts, 5);
    one.add(other);
    EXPECT_EQ(one.count(AlertCount::Alerts), 5U);
    EXPECT_EQ(one.count(AlertCount::UnknownAgencies), 2U);
    EXPECT_EQ(one.unresolved().at("agency_id A"), 2U);
}

TEST(AlertStatistics, KeepsTheFirstHundredDifferentUnresolvedSelectors) {
    AlertStatistics statistics;
    for (int i = 0; i < 1000; ++i)
        statistics.addUnresolved(AlertCount::UnknownRoutes, "route_id " + std::to_string(i));
    EXPECT_EQ(statistics.unresolved().size(), 100U);
    EXPECT_TRUE(statistics.unresolved().contains("route_id 99"));
    EXPECT_EQ(statistics.count(AlertCount::UnknownRoutes), 1000U);
}

} // namespace orvo::testing
