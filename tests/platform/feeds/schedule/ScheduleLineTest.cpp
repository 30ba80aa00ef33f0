#include "platform/feeds/schedule/ScheduleLine.h"

#include <gtest/gtest.h>

#include <set>

namespace orvo {
namespace {

TEST(ScheduleLine, MuidIsTheSameOnEveryMachine) {
    EXPECT_EQ(lineMuid("city", "R1"), lineMuid("city", "R1"));
    EXPECT_EQ(lineMuid("city", "R1"), 9992259703519228503U);
}

TEST(ScheduleLine, MuidTellsFeedsAndRoutesApart) {
    EXPECT_NE(lineMuid("city", "R1"), lineMuid("city", "R2"));
    EXPECT_NE(lineMuid("city", "R1"), lineMuid("town", "R1"));
    EXPECT_NE(lineMuid("a", "bc"), lineMuid("ab", "c"));
    std::set<std::uint64_t> muids;
    for (int number = 0; number < 10000; ++number)
        muids.insert(lineMuid("city", std::to_string(number)));
    EXPECT_EQ(muids.size(), 10000U);
    EXPECT_FALSE(muids.contains(0));
}

TEST(ScheduleLine, NameIsTheShortNameElseTheLongOneElseTheRoute) {
    ScheduleLine line;
    line.routeId = "R1";
    EXPECT_EQ(line.name(), "R1");
    line.longName = "Gare - Mairie";
    EXPECT_EQ(line.name(), "Gare - Mairie");
    line.shortName = "1";
    EXPECT_EQ(line.name(), "1");
}

TEST(ScheduleLine, BasicTypesStandForThemselves) {
    for (const int type : {0, 1, 2, 3, 4, 5, 6, 7, 11, 12})
        EXPECT_EQ(basicRouteType(type), type);
    for (const int unknown : {8, 50, 99, 600000, -3, 1100, 1500, 1700})
        EXPECT_EQ(basicRouteType(unknown), unknown);
}

TEST(ScheduleLine, ExtendedTypesStandForTheirBasicOne) {
    const std::pair<int, int> pairs[] = {
        {100, 2}, {109, 2},  {117, 2},  {200, 3},  {209, 3},  {300, 2},  {400, 1}, {402, 1},
        {404, 1}, {405, 12}, {500, 1},  {600, 1},  {700, 3},  {715, 3},  {799, 3}, {800, 11},
        {900, 0}, {906, 0},  {1000, 4}, {1200, 4}, {1300, 6}, {1307, 6}, {1400, 7}};
    for (const auto& [extended, basic] : pairs)
        EXPECT_EQ(basicRouteType(extended), basic) << extended;
}

TEST(ScheduleLine, BusesAndTrolleybusesAreBuses) {
    for (const int type : {3, 11, 700, 715, 799, 800})
        EXPECT_TRUE(isBusRouteType(type)) << type;
    for (const int type : {0, 1, 2, 4, 5, 6, 7, 12, 200, 699, 801, 900})
        EXPECT_FALSE(isBusRouteType(type)) << type;
}

} // namespace
} // namespace orvo
