#include "platform/feeds/schedule/StopReader.h"

#include "TestSchedules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(StopReader, ReadsNameAndStationAndTheFirstOfTwo) {
    const auto read = testing::readSchedule(testing::withFile(testing::smallSchedule(),
                                                              "stops.txt",
                                                              "stop_id,stop_name,parent_station\n"
                                                              "S1,Gare,P1\n"
                                                              ",Nowhere,\n"
                                                              "S1,Again,\n"
                                                              "P1,Station,\n"));
    ASSERT_EQ(read.contents.stops.size(), 2U);
    EXPECT_EQ(read.contents.stops[0].id, "S1");
    EXPECT_EQ(read.contents.stops[0].name, "Gare");
    EXPECT_EQ(read.contents.stops[0].parentId, "P1");
    EXPECT_EQ(read.contents.stops[1].id, "P1");
    EXPECT_THAT(
        read.contents.notes.notes(),
        ::testing::ElementsAre(
            ImportNote{"stops.txt", "no stop_id, left out", 1, 3},
            ImportNote{"stops.txt", "a stop_id that stands above already, left out", 1, 4}));
}

} // namespace
} // namespace orvo
