#include "platform/feeds/schedule/RouteReader.h"

#include "TestSchedules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

testing::ReadSchedule withRoutes(const std::string& text) {
    return testing::readSchedule(testing::withFile(testing::smallSchedule(), "routes.txt", text));
}

testing::ReadSchedule withAgenciesAndRoutes(const std::string& agencies,
                                            const std::string& routes) {
    return testing::readSchedule({{"agency.txt", agencies}, {"routes.txt", routes}});
}

std::vector<std::string> routesOf(const testing::ReadSchedule& read) {
    std::vector<std::string> routes;
    for (const auto& line : read.contents.lines)
        routes.push_back(line.routeId);
    return routes;
}

TEST(RouteReader, ReadsALineWhole) {
    const auto read = withRoutes(
        "route_type,route_url,route_text_color,route_color,route_long_name,route_short_name,"
        "agency_id,route_id\n"
        "715,https://a.example/1,#ffffff,005ca9,\"Gare\nMairie\",1,A1,R1\n");
    ASSERT_EQ(read.contents.lines.size(), 1U);
    ScheduleLine expected;
    expected.muid = lineMuid("city", "R1");
    expected.feed = "city";
    expected.routeId = "R1";
    expected.agencyId = "A1";
    expected.shortName = "1";
    expected.longName = "Gare Mairie";
    expected.color = "005CA9";
    expected.textColor = "FFFFFF";
    expected.url = "https://a.example/1";
    expected.routeType = 715;
    expected.agency = {"A1", "City Lines", "https://city.example/", "Europe/Paris", "fr"};
    EXPECT_EQ(read.contents.lines.front(), expected);
}

TEST(RouteReader, ABlankAgencyIsTheOnlyOne) {
    const auto read = withAgenciesAndRoutes("agency_id,agency_name\nA1,One\n",
                                            "route_id,agency_id,route_type\nR1,,3\nR2,A1,3\n");
    EXPECT_EQ(read.contents.lines[0].agencyId, "A1");
    EXPECT_EQ(read.contents.lines[0].agency.name, "One");
    EXPECT_EQ(read.contents.lines[1].agency.name, "One");
    EXPECT_THAT(read.contents.notes.notes(), IsEmpty());
}

TEST(RouteReader, TheOnlyAgencyMayLeaveItsIdOut) {
    const auto read =
        withAgenciesAndRoutes("agency_name\nOne\n", "route_id,agency_id\nR1,A7\nR2,\n");
    EXPECT_EQ(read.contents.lines[0].agencyId, "A7");
    EXPECT_EQ(read.contents.lines[0].agency.name, "One");
    EXPECT_EQ(read.contents.lines[1].agencyId, "");
    EXPECT_EQ(read.contents.lines[1].agency.name, "One");
}

TEST(RouteReader, AnUnknownAgencyIsNobodyAndCounted) {
    const auto read = withAgenciesAndRoutes("agency_id,agency_name\nA1,One\n",
                                            "route_id,agency_id,route_type\nR1,A9,3\n");
    EXPECT_EQ(read.contents.lines[0].agencyId, "A9");
    EXPECT_EQ(read.contents.lines[0].agency.name, "");
    EXPECT_THAT(
        read.contents.notes.notes(),
        ElementsAre(ImportNote{"routes.txt", "an agency_id that agency.txt does not have", 1, 2}));
    const auto several =
        withAgenciesAndRoutes("agency_id,agency_name\nA1,One\nA2,Two\n", "route_id\nR1\n");
    EXPECT_EQ(several.contents.lines[0].agency.name, "");
}

TEST(RouteReader, LeavesOutRowsWithoutAnIdOrWithOneTwice) {
    const auto read = withRoutes("route_id,route_short_name,route_type\nR1,1,3\n,2,3\nR1,3,3\n");
    ASSERT_EQ(read.contents.lines.size(), 1U);
    EXPECT_EQ(read.contents.lines[0].shortName, "1");
    EXPECT_THAT(read.contents.notes.notes(),
                Contains(ImportNote{"routes.txt", "no route_id, left out", 1, 3}));
    EXPECT_THAT(
        read.contents.notes.notes(),
        Contains(ImportNote{"routes.txt", "a route_id that stands above already, left out", 1, 4}));
}

TEST(RouteReader, TakesALineWithoutATypeForABus) {
    const auto read = withRoutes("route_id,route_type\nR1,tram\nR2,\nR3,0\n");
    EXPECT_EQ(read.contents.lines[0].routeType, 3);
    EXPECT_EQ(read.contents.lines[2].routeType, 0);
    EXPECT_THAT(
        read.contents.notes.notes(),
        Contains(ImportNote{"routes.txt", "no number in route_type, taken for a bus", 2, 2}));
}

TEST(RouteReader, OrdersByTheSchedulesOwnOrderThenAsTheRowsStand) {
    const auto read =
        withRoutes("route_id,route_sort_order\nlast,\nb,20\na,10\nc,20\nworse,x\nzero,0\n");
    EXPECT_THAT(routesOf(read), ElementsAre("zero", "a", "b", "c", "last", "worse"));
    for (std::size_t index = 0; index < read.contents.lines.size(); ++index)
        EXPECT_EQ(read.contents.lines[index].order, static_cast<std::int64_t>(index));
}

TEST(RouteReader, AScheduleWithoutLinesIsRefused) {
    EXPECT_EQ(withRoutes("route_id,route_type\n").error, "city.zip: routes.txt: names no line");
    EXPECT_EQ(withRoutes("route_id\n,\n").error, "city.zip: routes.txt: names no line");
    EXPECT_EQ(withRoutes("\n").error, "city.zip: routes.txt: is empty");
    EXPECT_EQ(withRoutes("route;name\n1;2\n").error, "city.zip: routes.txt: no column route_id");
}

} // namespace
} // namespace orvo
