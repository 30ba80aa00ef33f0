#include "platform/feeds/schedule/StopTimeReader.h"

#include "TestSchedules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// Which lines serve which stop, as `stop:route`, in order.
std::vector<std::string> served(const ScheduleContents& contents) {
    std::vector<std::string> texts;
    for (const StopOfLine& entry : contents.stopsOfLines)
        texts.push_back(contents.stops[entry.stop].id + ":" + contents.lines[entry.line].routeId);
    return texts;
}

testing::Files files(const std::string& stopTimes) {
    auto files = testing::smallSchedule();
    files.emplace_back("trips.txt",
                       "route_id,service_id,trip_id\nR1,W,T1\nR1,W,T2\nR2,W,T3\nR9,W,T9\n");
    files.emplace_back("stops.txt",
                       "stop_id,stop_name,location_type,parent_station\n"
                       "S1,Gare,0,P\nS2,Mairie,0,\nB,Boarding,4,S1\nP,Station,1,\nX,Loop,0,X\n");
    files.emplace_back("stop_times.txt", stopTimes);
    return files;
}

TEST(StopTimeReader, LearnsWhichLinesServeAStopOnce) {
    const auto read = testing::readSchedule(files("trip_id,stop_sequence,stop_id\n"
                                                  "T1,1,S2\nT2,1,S2\nT3,1,S2\nT1,2,S2\n"));
    EXPECT_THAT(served(read.contents), ElementsAre("S2:R1", "S2:R2"));
    EXPECT_TRUE(read.contents.info.knowsStopsOfLines);
    EXPECT_EQ(read.contents.rows, 18U);
}

TEST(StopTimeReader, AStationIsServedByTheLinesOfItsStops) {
    const auto read = testing::readSchedule(files("trip_id,stop_id\nT1,S1\nT3,B\nT3,X\n"));
    EXPECT_THAT(served(read.contents),
                ElementsAre("S1:R1", "S1:R2", "B:R2", "P:R1", "P:R2", "X:R2"));
}

TEST(StopTimeReader, PassingIsNotServing) {
    const auto read = testing::readSchedule(files("trip_id,stop_id,pickup_type,drop_off_type\n"
                                                  "T1,S2,1,1\nT3,S2,1,0\n"));
    EXPECT_THAT(served(read.contents), ElementsAre("S2:R2"));
}

TEST(StopTimeReader, AStopThatStopsTxtLacksIsServedAllTheSame) {
    const auto read = testing::readSchedule(files("trip_id,stop_id\nT1,S9\nT3,S9\n"));
    EXPECT_THAT(served(read.contents), ElementsAre("S9:R1", "S9:R2"));
    EXPECT_EQ(read.contents.stops.size(), 6U);
}

TEST(StopTimeReader, LeavesOutAndCountsRowsOfUnknownTrips) {
    const auto read = testing::readSchedule(files("trip_id,stop_id\nT8,S1\nT9,S1\n,S1\nT1,\n"));
    EXPECT_THAT(served(read.contents), IsEmpty());
    EXPECT_FALSE(read.contents.info.knowsStopsOfLines);
    EXPECT_THAT(
        read.contents.notes.notes(),
        ElementsAre(
            ImportNote{"trips.txt", "a route_id that routes.txt does not have, left out", 1, 5},
            ImportNote{"stop_times.txt", "a trip_id that trips.txt does not have, left out", 3, 2},
            ImportNote{"stop_times.txt", "no stop_id, left out", 1, 5}));
}

TEST(StopTimeReader, ManyRowsOfFewStopsAreLearntWhole) {
    std::string text = "trip_id,stop_id\n";
    for (int count = 0; count < 100'000; ++count)
        text += count % 2 ? "T1,S2\n" : "T3,S2\n";
    const auto read = testing::readSchedule(files(text));
    EXPECT_THAT(served(read.contents), ElementsAre("S2:R1", "S2:R2"));
}

TEST(StopTimeReader, WithoutTripsNothingIsKnown) {
    const auto read = testing::readSchedule(
        testing::withFile(files("trip_id,stop_id\nT1,S1\n"), "trips.txt", ""));
    EXPECT_EQ(read.error, "");
    EXPECT_THAT(served(read.contents), IsEmpty());
}

} // namespace
} // namespace orvo
