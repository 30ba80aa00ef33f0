#include "platform/extension/window/WindowPlacement.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

constexpr CGRect Screen{{0, 30}, {1000, 700}};

TEST(WindowPlacement, WhatIsSeenWholeStays) {
    EXPECT_EQ(windowFramePlacing({100, 200}, {359, 300}, Screen), (CGRect{{100, 200}, {359, 300}}));
    EXPECT_EQ(windowFramePlacing({641, 430}, {359, 300}, Screen), (CGRect{{641, 430}, {359, 300}}));
}

TEST(WindowPlacement, MovesAsLittleAsItMust) {
    EXPECT_EQ(windowFramePlacing({100, 600}, {359, 300}, Screen).origin, (CGPoint{100, 430}));
    EXPECT_EQ(windowFramePlacing({900, 100}, {359, 300}, Screen).origin, (CGPoint{641, 100}));
    EXPECT_EQ(windowFramePlacing({-20, 0}, {359, 300}, Screen).origin, (CGPoint{0, 30}));
}

TEST(WindowPlacement, WhatIsLargerThanTheScreenKeepsItsTop) {
    EXPECT_EQ(windowFramePlacing({0, 100}, {359, 900}, Screen), (CGRect{{0, 30}, {359, 900}}));
}

TEST(WindowPlacement, UnitesAndGoesBetween) {
    const CGRect low{{10, 100}, {359, 146}};
    const CGRect high{{10, 60}, {359, 366}};
    EXPECT_EQ(rectUniting(low, high), (CGRect{{10, 60}, {359, 366}}));
    EXPECT_EQ(rectUniting({{0, 0}, {10, 10}}, {{5, 20}, {10, 10}}), (CGRect{{0, 0}, {15, 30}}));
    EXPECT_EQ(rectBetween(low, high, 0), low);
    EXPECT_EQ(rectBetween(low, high, 0.5), (CGRect{{10, 80}, {359, 256}}));
    EXPECT_EQ(rectBetween(low, high, 1), high);
}

TEST(WindowPlacement, EdgesBelongToWhatBeginsThere) {
    const CGRect rect{{10, 20}, {30, 40}};
    EXPECT_TRUE(rectContains(rect, {10, 20}));
    EXPECT_TRUE(rectContains(rect, {39.9, 59.9}));
    EXPECT_FALSE(rectContains(rect, {40, 30}));
    EXPECT_FALSE(rectContains(rect, {20, 60}));
    EXPECT_FALSE(rectContains(rect, {9, 30}));
    EXPECT_FALSE(rectContains({{10, 20}, {0, 0}}, {10, 20}));
}

} // namespace
} // namespace orvo
