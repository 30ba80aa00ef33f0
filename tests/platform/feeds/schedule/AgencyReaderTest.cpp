#include "platform/feeds/schedule/AgencyReader.h"

#include "TestSchedules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::ElementsAre;

testing::ReadSchedule withAgencies(const std::string& text) {
    return testing::readSchedule(testing::withFile(testing::smallSchedule(), "agency.txt", text));
}

TEST(AgencyReader, ReadsWhatAnAgencySaysOfItself) {
    const auto read = testing::readSchedule(testing::smallSchedule());
    EXPECT_THAT(
        read.contents.agencies,
        ElementsAre(
            ScheduleAgency{"A1", "City Lines", "https://city.example/", "Europe/Paris", "fr"},
            ScheduleAgency{"A2", "River Boats", "https://boats.example/", "Europe/Paris", "fr"}));
}

TEST(AgencyReader, OfTwoAgenciesWithOneIdTheFirstCounts) {
    const auto read = withAgencies("agency_id,agency_name\nA1,First\nA1,Second\nA2,Third\n");
    ASSERT_EQ(read.contents.agencies.size(), 2U);
    EXPECT_EQ(read.contents.agencies[0].name, "First");
    EXPECT_THAT(read.contents.notes.notes(),
                ElementsAre(ImportNote{
                    "agency.txt", "an agency_id that stands above already, left out", 1, 3}));
}

TEST(AgencyReader, AFileWithoutNamesIsLeftOut) {
    const auto read = withAgencies("agency_id\nA1\n");
    EXPECT_TRUE(read.contents.agencies.empty());
    ASSERT_FALSE(read.contents.notes.notes().empty());
    EXPECT_EQ(read.contents.notes.notes().front(),
              (ImportNote{"agency.txt", "no column agency_name, left out", 1, 0}));
}

} // namespace
} // namespace orvo
