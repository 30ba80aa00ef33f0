#include "platform/feeds/schedule/LineIndex.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::Optional;

ScheduleLine line(const std::string& routeId, const std::string& agencyId, int type) {
    ScheduleLine line;
    line.feed = "city";
    line.routeId = routeId;
    line.muid = lineMuid("city", routeId);
    line.agencyId = agencyId;
    line.routeType = type;
    return line;
}

LineIndex::Contents contents() {
    LineIndex::Contents contents;
    contents.feed = "city";
    contents.language = "fr";
    contents.timezone = "Europe/Paris";
    contents.lines = {
        line("R3", "A1", 3), line("R1", "A1", 715), line("R2", "A2", 0), line("R4", "", 900)};
    return contents;
}

std::uint64_t muid(const char* routeId) {
    return lineMuid("city", routeId);
}

TEST(LineIndex, FindsALineByItsRoute) {
    const LineIndex index(contents());
    EXPECT_EQ(index.lineForRoute("R1"), muid("R1"));
    EXPECT_EQ(index.lineForRoute(" R1 "), muid("R1"));
    EXPECT_FALSE(index.lineForRoute("r1"));
    EXPECT_FALSE(index.lineForRoute("R9"));
    EXPECT_FALSE(index.lineForRoute(""));
}

TEST(LineIndex, FindsTheLinesOfExactlyOneAgencyInTheSchedulesOrder) {
    const LineIndex index(contents());
    EXPECT_THAT(index.linesOfAgency("A1"), ElementsAre(muid("R3"), muid("R1")));
    EXPECT_THAT(index.linesOfAgency("a1"), IsEmpty());
    EXPECT_THAT(index.linesOfAgency("A9"), IsEmpty());
    EXPECT_THAT(index.linesOfAgency(""), IsEmpty());
}

TEST(LineIndex, MapsExtendedTypesOnBothSides) {
    const LineIndex index(contents());
    EXPECT_THAT(index.linesOfType(3), ElementsAre(muid("R3"), muid("R1")));
    EXPECT_THAT(index.linesOfType(700), ElementsAre(muid("R3"), muid("R1")));
    EXPECT_THAT(index.linesOfType(0), ElementsAre(muid("R2"), muid("R4")));
    EXPECT_THAT(index.linesOfType(1), IsEmpty());
}

TEST(LineIndex, GivesLinesOfAStopOnceAndInTheSchedulesOrder) {
    auto given = contents();
    given.stops.linesServingStop = [](std::string_view stop) {
        if (stop != "S1")
            return std::vector<std::uint64_t>{};
        return std::vector<std::uint64_t>{muid("R2"), muid("R3"), muid("R2"), muid("gone")};
    };
    given.stops.stopName = [](std::string_view stop) -> std::optional<std::string> {
        if (stop != "S1")
            return std::nullopt;
        return "Gare";
    };
    const LineIndex index(std::move(given));
    EXPECT_THAT(index.linesServingStop(" S1"), Optional(ElementsAre(muid("R3"), muid("R2"))));
    EXPECT_THAT(index.linesServingStop("S2"), Optional(IsEmpty()));
    EXPECT_THAT(index.linesServingStop(""), Optional(IsEmpty()));
    EXPECT_EQ(index.stopName("S1"), "Gare");
    EXPECT_FALSE(index.stopName("S2"));
}

TEST(LineIndex, TellsAScheduleThatCannotBeAskedFromAStopWithoutLines) {
    auto given = contents();
    given.stops.linesServingStop = [](std::string_view) {
        return std::nullopt;
    };
    EXPECT_EQ(LineIndex(std::move(given)).linesServingStop("S1"), std::nullopt);
}

TEST(LineIndex, WithoutStopsKnowsNone) {
    const LineIndex index(contents());
    EXPECT_THAT(index.linesServingStop("S1"), Optional(IsEmpty()));
    EXPECT_FALSE(index.stopName("S1"));
}

TEST(LineIndex, AnswersTheLineItself) {
    const LineIndex index(contents());
    ASSERT_TRUE(index.line(muid("R2")));
    EXPECT_EQ(index.line(muid("R2"))->routeId, "R2");
    EXPECT_EQ(index.line(muid("R9")), nullptr);
    EXPECT_EQ(index.lines().size(), 4U);
    EXPECT_EQ(index.language(), "fr");
    EXPECT_EQ(index.timezone(), "Europe/Paris");
    EXPECT_EQ(index.feed(), "city");
}

} // namespace
} // namespace orvo
