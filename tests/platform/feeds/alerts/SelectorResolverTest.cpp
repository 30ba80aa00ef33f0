#include "platform/feeds/alerts/SelectorResolver.h"

#include "TestLines.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

using Muids = std::vector<std::uint64_t>;

/// The short routes that a selector names, and why it names none.
struct Resolved {
    std::string routes;
    AlertStatistics statistics;
};

Resolved resolve(const AlertSelector& selector) {
    Resolved resolved;
    const auto index = smallIndex();
    const LineTable table(index);
    SelectorResolver resolver(table, resolved.statistics);
    SelectorResolver::Places places;
    resolver.resolve(selector, places);
    for (const LineTable::Place place : places)
        resolved.routes += (resolved.routes.empty() ? "" : " ") + table.at(place).line->routeId;
    return resolved;
}

AlertSelector selector(const std::function<void(AlertSelector&)>& change) {
    AlertSelector selector;
    change(selector);
    return selector;
}

std::string routes(const std::function<void(AlertSelector&)>& change) {
    return resolve(selector(change)).routes;
}

std::uint64_t count(const std::function<void(AlertSelector&)>& change, AlertCount reason) {
    return resolve(selector(change)).statistics.count(reason);
}

} // namespace

TEST(SelectorResolver, ARouteNamesItsLineWhetherItsOwnOrItsTrips) {
    EXPECT_EQ(routes([](auto& s) { s.routeId = "R1"; }), "R1");
    EXPECT_EQ(routes([](auto& s) { s.tripRouteId = "R1"; }), "R1");
    EXPECT_EQ(routes([](auto& s) { s.routeId = s.tripRouteId = "R1"; }), "R1");
}

TEST(SelectorResolver, RoutesAreComparedExactlyButForBlanksAroundThem) {
    EXPECT_EQ(routes([](auto& s) { s.routeId = "r1"; }), "");
    EXPECT_EQ(routes([](auto& s) { s.routeId = " R1 "; }), "R1");
    EXPECT_EQ(routes([](auto& s) { s.routeId = "R"; }), "");
    EXPECT_EQ(count([](auto& s) { s.routeId = "r1"; }, AlertCount::UnknownRoutes), 1U);
}

TEST(SelectorResolver, AnAgencyNamesItsLinesAndOnlyByItsIdentifier) {
    EXPECT_EQ(routes([](auto& s) { s.agencyId = "A1"; }), "R1 R2 R3 M1");
    EXPECT_EQ(routes([](auto& s) { s.agencyId = "A2"; }), "T1");
    EXPECT_EQ(routes([](auto& s) { s.agencyId = "Agency A1"; }), "");
    EXPECT_EQ(count([](auto& s) { s.agencyId = "Agency A1"; }, AlertCount::UnknownAgencies), 1U);
}

TEST(SelectorResolver, ATypeNamesLinesOfThatTypeExtendedOnesIncluded) {
    EXPECT_EQ(routes([](auto& s) { s.routeType = 3; }), "R1 R2 R3");
    EXPECT_EQ(routes([](auto& s) { s.routeType = 700; }), "R1 R2 R3");
    EXPECT_EQ(routes([](auto& s) { s.routeType = 0; }), "T1");
    EXPECT_EQ(routes([](auto& s) { s.routeType = -5; }), "");
    EXPECT_EQ(count([](auto& s) { s.routeType = 4; }, AlertCount::UnknownRouteTypes), 1U);
}

TEST(SelectorResolver, AStopNamesTheLinesThatServeIt) {
    EXPECT_EQ(routes([](auto& s) { s.stopId = "S1"; }), "R1 M1");
    EXPECT_EQ(routes([](auto& s) { s.stopId = "S9"; }), "");
    EXPECT_EQ(count([](auto& s) { s.stopId = "S9"; }, AlertCount::UnservedStops), 1U);
}

TEST(SelectorResolver, AStopThatTheScheduleCannotBeAskedAboutIsLostAndNotUnserved) {
    auto contents = smallSchedule();
    int asked = 0;
    contents.stops.linesServingStop = [&](std::string_view) -> std::optional<Muids> {
        ++asked;
        return std::nullopt;
    };
    const auto index = std::make_shared<const LineIndex>(std::move(contents));
    const LineTable table(index);
    AlertStatistics statistics;
    SelectorResolver resolver(table, statistics);
    SelectorResolver::Places places;
    resolver.resolve(selector([](auto& s) { s.routeId = "R1", s.stopId = "S1"; }), places);
    EXPECT_EQ(places.size(), 1U);
    EXPECT_FALSE(resolver.hasLostStops());
    for (const char* const stop : {"S1", "S2", "S1"})
        resolver.resolve(selector([&](auto& s) { s.stopId = stop; }), places);
    EXPECT_EQ(places.size(), 1U);
    EXPECT_TRUE(resolver.hasLostStops());
    EXPECT_EQ(asked, 1); // each question may wait for seconds
    EXPECT_EQ(statistics.count(AlertCount::UnaskedStops), 3U);
    EXPECT_EQ(statistics.count(AlertCount::UnservedStops), 0U);
}

TEST(SelectorResolver, AnAgencyThatTheScheduleLeavesBlankContradictsNothing) {
    auto contents = smallSchedule();
    contents.lines[0].agencyId.clear();
    const auto index = std::make_shared<const LineIndex>(std::move(contents));
    const LineTable table(index);
    AlertStatistics statistics;
    SelectorResolver resolver(table, statistics);
    SelectorResolver::Places places;
    resolver.resolve(selector([](auto& s) { s.routeId = "R1", s.agencyId = "A2"; }), places);
    ASSERT_EQ(places.size(), 1U);
    EXPECT_EQ(table.at(places[0]).line->routeId, "R1");
    EXPECT_EQ(statistics.count(AlertCount::ContradictorySelectors), 0U);
}

TEST(SelectorResolver, AStopOfARouteNamesTheRouteWhateverServesTheStop) {
    EXPECT_EQ(routes([](auto& s) { s.routeId = "R2", s.stopId = "S1"; }), "R2");
    EXPECT_EQ(routes([](auto& s) { s.routeId = "R2", s.stopId = "S9"; }), "R2");
}

TEST(SelectorResolver, AllFieldsMustHoldTogether) {
    EXPECT_EQ(routes([](auto& s) { s.routeId = "R1", s.agencyId = "A1", s.routeType = 3; }), "R1");
    EXPECT_EQ(routes([](auto& s) { s.routeId = "R1", s.agencyId = "A2"; }), "");
    EXPECT_EQ(routes([](auto& s) { s.routeId = "R1", s.routeType = 1; }), "");
    EXPECT_EQ(routes([](auto& s) { s.routeId = "R1", s.tripRouteId = "R2"; }), "");
    EXPECT_EQ(routes([](auto& s) { s.agencyId = "A1", s.routeType = 1; }), "M1");
    EXPECT_EQ(routes([](auto& s) { s.stopId = "S1", s.routeType = 1; }), "M1");
    EXPECT_EQ(routes([](auto& s) { s.stopId = "S1", s.agencyId = "A2"; }), "");
    EXPECT_EQ(count([](auto& s) { s.routeId = "R1", s.agencyId = "A2"; },
                    AlertCount::ContradictorySelectors),
              1U);
}

TEST(SelectorResolver, ATripWithoutARouteNamesNothingNotEvenItsAgency) {
    EXPECT_EQ(routes([](auto& s) { s.tripId = "X"; }), "");
    EXPECT_EQ(routes([](auto& s) { s.tripId = "X", s.agencyId = "A1"; }), "");
    EXPECT_EQ(routes([](auto& s) { s.namesDeparture = true, s.stopId = "S1"; }), "");
    EXPECT_EQ(count([](auto& s) { s.tripId = "X"; }, AlertCount::TripsWithoutRoute), 1U);
}

TEST(SelectorResolver, StopsAndTripsArePartOfALine) {
    const auto namesPart = [](const std::function<void(AlertSelector&)>& change) {
        return SelectorResolver::namesPart(selector(change));
    };
    EXPECT_TRUE(namesPart([](auto& s) { s.stopId = "S"; }));
    EXPECT_TRUE(namesPart([](auto& s) { s.tripId = "T"; }));
    EXPECT_TRUE(namesPart([](auto& s) { s.namesDeparture = true; }));
    EXPECT_FALSE(namesPart([](auto& s) { s.routeId = "R1", s.tripRouteId = "R1"; }));
}

TEST(SelectorResolver, TellsWhatItCouldNotResolve) {
    const auto unresolved = resolve(selector([](auto& s) { s.routeId = "X9"; })).statistics;
    EXPECT_EQ(unresolved.unresolved(), (std::map<std::string, std::uint64_t>{{"route_id X9", 1}}));
    EXPECT_EQ(unresolved.unresolvedSelectors(), 1U);
}

} // namespace orvo::testing
