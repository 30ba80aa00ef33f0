#include "platform/demo/DemoSchedule.h"

#include "platform/demo/DemoCity.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

namespace orvo {
namespace {

constexpr double Written = 1750000000; // 2025-06-15

TEST(DemoCity, HasADozenLinesOfSeveralModesAndTwoAgencies) {
    std::set<int> modes;
    std::set<std::string> agencies;
    std::set<std::string> ids;
    std::size_t withoutShortName = 0;
    std::size_t withoutColor = 0;
    for (const auto& line : DemoCity::lines()) {
        modes.insert(line.routeType);
        agencies.insert(line.agencyId);
        ids.insert(line.routeId);
        withoutShortName += static_cast<std::size_t>(line.shortName.empty());
        withoutColor += static_cast<std::size_t>(line.color.empty());
        EXPECT_NE(line.longName, line.germanLongName);
        EXPECT_EQ(line.longName.find(','), std::string::npos) << "would need quotes in the file";
        for (const auto& stop : line.stopIds)
            EXPECT_EQ(std::ranges::count(DemoCity::stops(), stop, &DemoCity::Stop::id), 1) << stop;
    }
    EXPECT_GE(DemoCity::lines().size(), 12U);
    EXPECT_EQ(ids.size(), DemoCity::lines().size());
    for (const int mode : {0, 1, 2, 3, 4, 6})
        EXPECT_TRUE(modes.contains(mode)) << mode;
    EXPECT_EQ(agencies.size(), 2U);
    EXPECT_GT(withoutShortName, 0U);
    EXPECT_GT(withoutColor, 0U);
    for (const auto& route : DemoCity::favoriteRouteIds())
        EXPECT_TRUE(ids.contains(route)) << route;
}

TEST(DemoSchedule, EveryRowHasAsManyCellsAsItsHeading) {
    for (const auto& [name, text] : demoSchedule(Written, "Europe/Berlin")) {
        ASSERT_EQ(text.back(), '\n') << name;
        const auto cells =
            std::count(text.begin(), text.begin() + static_cast<long>(text.find('\n')), ',');
        for (std::size_t at = 0; at < text.size();) {
            const std::size_t end = text.find('\n', at);
            const std::string line = text.substr(at, end - at);
            EXPECT_EQ(std::ranges::count(line, ','), cells) << name << ": " << line;
            at = end + 1;
        }
    }
}

TEST(DemoSchedule, IsValidFromTheDayBeforeForAYear) {
    const auto files = demoSchedule(Written, "Europe/Berlin");
    EXPECT_NE(files.at("feed_info.txt").find(",20250614,20260615,"), std::string::npos);
    EXPECT_NE(files.at("agency.txt").find(",Europe/Berlin,en\n"), std::string::npos);
}

TEST(DemoSchedule, IsTheSameForTheSameTime) {
    EXPECT_EQ(demoSchedule(Written, "UTC"), demoSchedule(Written, "UTC"));
}

} // namespace
} // namespace orvo
