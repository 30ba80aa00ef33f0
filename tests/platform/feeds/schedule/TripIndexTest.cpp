#include "platform/feeds/schedule/TripIndex.h"

#include <gtest/gtest.h>

#include <string>

namespace orvo {
namespace {

TEST(TripIndex, KnowsTheLineOfEachTrip) {
    TripIndex trips;
    for (std::uint32_t number = 0; number < 1000; ++number)
        trips.add("trip" + std::to_string(number), number % 7);
    trips.sort();
    for (std::uint32_t number = 0; number < 1000; ++number)
        EXPECT_EQ(trips.lineOfTrip("trip" + std::to_string(number)), number % 7);
    EXPECT_FALSE(trips.lineOfTrip("trip1000"));
    EXPECT_FALSE(TripIndex().lineOfTrip("trip1"));
}

TEST(TripIndex, OfTwoTripsWithOneIdTheFirstCounts) {
    TripIndex trips;
    trips.add("t", 5);
    trips.add("t", 1);
    trips.sort();
    EXPECT_EQ(trips.lineOfTrip("t"), 5U);
}

} // namespace
} // namespace orvo
