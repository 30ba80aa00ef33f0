#include "orvo/console/Counted.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(Counted, GroupsDigitsByThree) {
    EXPECT_EQ(Counted::grouped(0), "0");
    EXPECT_EQ(Counted::grouped(999), "999");
    EXPECT_EQ(Counted::grouped(1000), "1,000");
    EXPECT_EQ(Counted::grouped(123456), "123,456");
    EXPECT_EQ(Counted::grouped(1234567), "1,234,567");
}

TEST(Counted, OnlyOneIsSingular) {
    EXPECT_EQ(Counted::text(0, "line", "lines"), "0 lines");
    EXPECT_EQ(Counted::text(1, "line", "lines"), "1 line");
    EXPECT_EQ(Counted::text(2, "agency", "agencies"), "2 agencies");
}

} // namespace
} // namespace orvo
