#include "platform/feeds/alerts/ConcernedLines.h"

#include "AlertMaker.h"
#include "TestLines.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

AlertSelector at(std::string_view route, std::string_view stop = {}) {
    AlertSelector selector;
    selector.routeId = route;
    selector.stopId = stop;
    return selector;
}

AlertSelector agency(std::string_view id) {
    AlertSelector selector;
    selector.agencyId = id;
    return selector;
}

/// The lines that alerts with these selectors concern: `R1(S1,S2)#0,1` is a part, `R1#0` the whole;
/// behind `#` the alerts that name the line.
std::string concerned(const std::vector<AlertSelectors>& alerts) {
    const auto index = smallIndex();
    const LineTable table(index);
    AlertStatistics statistics;
    SelectorResolver resolver(table, statistics);
    std::vector<Alert> made(alerts.size());
    Incident incident;
    for (std::size_t i = 0; i < alerts.size(); ++i) {
        made[i].selectors = alerts[i];
        incident.members.push_back({&made[i], 0});
    }
    ConcernedLines lines(resolver);
    lines.find(incident);
    std::string text;
    for (const ConcernedLines::Line& line : lines.lines()) {
        text += (text.empty() ? "" : " ") + line.line->routeId;
        std::string stops;
        for (const std::string_view stop : lines.stopsOf(line))
            stops += (stops.empty() ? "" : ",") + std::string(stop);
        text += line.isPart ? "(" + stops + ")" : "";
        for (const std::size_t member : lines.membersOf(line))
            text += "#" + std::to_string(member);
    }
    return text;
}

} // namespace

TEST(ConcernedLines, AreInTheSchedulesOrderEachOnce) {
    EXPECT_EQ(concerned({{at("T1"), at("R2"), at("R1"), at("R2")}}), "R1#0 R2#0 T1#0");
}

TEST(ConcernedLines, SelectorsThatNameMillionsOfLinesTogetherAreLostAndCounted) {
    constexpr std::size_t Lines = 2000;
    LineIndex::Contents contents;
    for (std::size_t i = 0; i < Lines; ++i) {
        ScheduleLine& line = contents.lines.emplace_back();
        line.routeId = "R" + std::to_string(i);
        line.muid = lineMuid("town", line.routeId);
        line.agencyId = "A";
    }
    const auto index = std::make_shared<const LineIndex>(std::move(contents));
    const LineTable table(index);
    AlertStatistics statistics;
    SelectorResolver resolver(table, statistics);
    ConcernedLines lines(resolver);
    Alert alert;
    alert.selectors = {agency("A")};
    Incident incident;
    incident.members.assign(1, {&alert, 0});
    for (int i = 0; i < 2000; ++i)
        lines.find(incident);
    EXPECT_EQ(lines.lostSelectors(), 0U);
    EXPECT_EQ(lines.lines().size(), Lines);
    alert.selectors = {agency("A"), at("R7")};
    lines.find(incident);
    EXPECT_EQ(lines.lostSelectors(), 1U);
    ASSERT_EQ(lines.lines().size(), 1U);
    EXPECT_EQ(lines.lines().front().line->routeId, "R7");
}

TEST(ConcernedLines, StopsAreCollectedSortedAndEachOnce) {
    EXPECT_EQ(concerned({{at("R1", "S9"), at("R1", "S1"), at("R1", "S9")}}), "R1(S1,S9)#0");
}

TEST(ConcernedLines, OneNamedWholeIsWholeWhateverStopsOthersName) {
    EXPECT_EQ(concerned({{at("R1", "S9"), at("R1")}}), "R1#0");
    EXPECT_EQ(concerned({{at("R1", "S9")}, {at("R1")}}), "R1#0#1");
    EXPECT_EQ(concerned({{at("R1", "S9"), at("R1"), at("R2", "S2")}}), "R1#0 R2(S2)#0");
}

TEST(ConcernedLines, TellWhichAlertsNameThem) {
    EXPECT_EQ(concerned({{at("R1"), at("R2")}, {at("R2")}, {at("R3"), at("R2")}}),
              "R1#0 R2#0#1#2 R3#2");
    EXPECT_EQ(concerned({{at("R1", "S2")}, {at("R1", "S1")}}), "R1(S1,S2)#0#1");
}

TEST(ConcernedLines, WhatNamesAllLinesOfAnAgencyIsTakenOnce) {
    EXPECT_EQ(concerned({AlertSelectors(3, agency("A1"))}), "R1#0 R2#0 R3#0 M1#0");
}

TEST(ConcernedLines, ATripWithoutARouteCostsNoOtherSelectorOfItsStop) {
    AlertSelector trip = at("", "S1");
    trip.tripId = "T";
    AlertSelector departure = at("", "S1");
    departure.namesDeparture = true;
    EXPECT_EQ(concerned({{trip, departure, at("", "S1")}}), "R1(S1)#0 M1(S1)#0");
    EXPECT_EQ(concerned({{at("", "S1"), trip}}), "R1(S1)#0 M1(S1)#0");
}

TEST(ConcernedLines, ARouteTypeThatIsNoneIsNotNoRouteType) {
    AlertSelector none = at("", "S1");
    none.routeType = -1;
    EXPECT_EQ(concerned({{none, at("", "S1")}}), "R1(S1)#0 M1(S1)#0");
}

TEST(ConcernedLines, WithoutSelectorsThereAreNone) {
    EXPECT_EQ(concerned({{}}), "");
    EXPECT_EQ(concerned({}), "");
}

TEST(ConcernedLines, OfSelectorsThatWerePassedOverAreFoundOnDemand) {
    const std::string fields =
        Wire().bytes(5, route("R3")).bytes(5, route("R1")).bytes(5, route("R2")).str();
    const LineTable table(smallIndex());
    AlertStatistics statistics;
    SelectorResolver resolver(table, statistics);
    ConcernedLines lines(resolver);
    Alert alert;
    alert.selectors = {at("R1")};
    alert.hasUnreadSelectors = true;
    alert.selectorFields = fields;
    Incident incident;
    incident.members = {{&alert, 0}};
    lines.find(incident);
    EXPECT_FALSE(lines.areAll());
    EXPECT_EQ(lines.lines().size(), 1U);
    lines.findAll(incident);
    EXPECT_TRUE(lines.areAll());
    EXPECT_EQ(lines.lines().size(), 3U);
    alert.selectors.push_back(agency("A2")); // its lines are the schedule's to say, now
    lines.find(incident);
    EXPECT_TRUE(lines.areAll());
    EXPECT_EQ(lines.lines().size(), 3U);
}

TEST(ConcernedLines, OneObjectServesManyIncidents) {
    const auto index = smallIndex();
    const LineTable table(index);
    AlertStatistics statistics;
    SelectorResolver resolver(table, statistics);
    ConcernedLines lines(resolver);
    for (const char* const route : {"R1", "R2"}) {
        Alert alert;
        alert.selectors = {at(route)};
        Incident incident;
        incident.members = {{&alert, 0}};
        lines.find(incident);
        ASSERT_EQ(lines.lines().size(), 1U);
        EXPECT_EQ(lines.lines()[0].line->routeId, route);
    }
}

} // namespace orvo::testing
