#include "platform/feeds/alerts/LineTable.h"

#include "TestLines.h"
#include "platform/feeds/alerts/ByteScan.h"

#include <gtest/gtest.h>

#include <cstring>

namespace orvo::testing {

namespace {

/// Sixteen bytes, each time others, whose quick hash is the same.
std::string preparedRoute(std::uint64_t number) {
    constexpr std::uint64_t Multiplier = 0x9E3779B97F4A7C15ULL;
    const std::uint64_t begin = number * 0x0101010101010101ULL + 1;
    const std::uint64_t product = ((2 * ByteScan::Word * Multiplier) ^ begin) * Multiplier;
    const std::uint64_t end = product ^ (product >> 32U);
    std::string route(2 * ByteScan::Word, '\0');
    std::memcpy(route.data(), &begin, sizeof begin);
    std::memcpy(route.data() + sizeof begin, &end, sizeof end);
    return route;
}

} // namespace

TEST(LineTable, NamesLinesByTheirPlaceInTheSchedule) {
    const auto index = smallIndex();
    const LineTable table(index);
    EXPECT_EQ(table.count(), 5U);
    EXPECT_EQ(table.placeOfRoute("R2"), 1U);
    EXPECT_EQ(table.placeOfRoute(" R2 "), 1U);
    EXPECT_EQ(table.placeOfRoute("R9"), LineTable::None);
    EXPECT_EQ(table.placeOfRoute(""), LineTable::None);
    EXPECT_EQ(table.placeOf(lineMuid("town", "T1")), 4U);
    EXPECT_EQ(table.placeOf(7), LineTable::None);
    EXPECT_EQ(table.at(4).routeId, "T1");
    EXPECT_EQ(table.at(4).agencyId, "A2");
    EXPECT_EQ(table.at(2).basicType, 3);
}

TEST(LineTable, RoutesThatWerePreparedToHaveOneHashCostNoMoreThanOthers) {
    constexpr std::size_t Lines = 20'000;
    LineIndex::Contents contents;
    for (std::size_t i = 0; i < Lines; ++i) {
        ScheduleLine& line = contents.lines.emplace_back();
        line.routeId = preparedRoute(i);
        line.muid = i + 1;
    }
    ASSERT_EQ(ByteScan::quickHash(contents.lines.front().routeId),
              ByteScan::quickHash(contents.lines.back().routeId));
    const auto index = std::make_shared<const LineIndex>(std::move(contents));
    const LineTable table(index);
    EXPECT_EQ(table.placeOfRoute(index->lines().back().routeId), Lines - 1);
    // With one slot for all of them it would be as many as there are lines.
    EXPECT_LT(table.longestProbe(), Lines / 100);
}

} // namespace orvo::testing
