#include "platform/mapuikit/_ShieldRow.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Rects = std::vector<CGRect>;

/// Shields 20 wide and 10 high, 5 between; lines 10 high; a text of 3 for each shield left out.
class ShieldRow : public ::testing::Test {
protected:
    _ShieldRow row(CGFloat width) {
        request.shields = sizes.size();
        request.sizeOf = [this](std::size_t index) {
            asked = index + 1;
            return sizes.at(index);
        };
        request.width = width;
        return _ShieldRow::arrange(request);
    }
    static CGRect at(CGFloat x, CGFloat y = 0, CGFloat width = 20, CGFloat height = 10) {
        return {{x, y}, {width, height}};
    }

    std::vector<CGSize> sizes = std::vector<CGSize>(4, CGSize{20, 10});
    _ShieldRow::Request request{.space = 5, .lineHeight = 10, .textWidth = [](std::size_t leftOut) {
                                    return 3 * static_cast<CGFloat>(leftOut);
                                }};
    std::size_t asked = 0;
};

TEST_F(ShieldRow, AllShieldsStandSideBySideWhereTheyFit) {
    const auto all = row(95);
    EXPECT_EQ(all.shields, (Rects{at(0), at(25), at(50), at(75)}));
    EXPECT_EQ(all.text, std::nullopt);
    EXPECT_EQ(all.size, (CGSize{95, 10}));
}

TEST_F(ShieldRow, WhereOneHasNoRoomATextStandsForIt) {
    const auto three = row(94);
    EXPECT_EQ(three.shields, (Rects{at(0), at(25), at(50)}));
    EXPECT_EQ(three.text, at(75, 0, 3));
    EXPECT_EQ(three.size, (CGSize{78, 10}));
}

TEST_F(ShieldRow, ShieldGivesWayToTheTextForTheOthers) {
    EXPECT_EQ(row(78).shields.size(), 3U);
    const auto two = row(77);
    EXPECT_EQ(two.shields.size(), 2U);
    EXPECT_EQ(two.text, at(50, 0, 6));
}

TEST_F(ShieldRow, NarrowestRowsHoldTheTextAlone) {
    const auto text = row(12);
    EXPECT_TRUE(text.shields.empty());
    EXPECT_EQ(text.text, at(0, 0, 12));
    const auto cut = row(8);
    EXPECT_EQ(cut.text, at(0, 0, 8));
    EXPECT_EQ(cut.size, (CGSize{8, 10}));
    EXPECT_EQ(row(0).size, (CGSize{0, 10}));
}

TEST_F(ShieldRow, NoWidthShowsAShieldOutsideOfIt) {
    for (CGFloat width = 0; width <= 100; width += 0.5) {
        const auto any = row(width);
        EXPECT_LE(any.size.width, width);
        for (const auto& shield : any.shields)
            EXPECT_LE(shield.origin.x + shield.size.width, width);
        EXPECT_EQ(any.text.has_value(), any.shields.size() < 4);
        if (any.text) {
            EXPECT_LE(any.text->origin.x + any.text->size.width, width);
        }
    }
}

TEST_F(ShieldRow, WithoutATextTheOthersAreLeftOutSilently) {
    request.textWidth = [](std::size_t) {
        return 0;
    };
    EXPECT_EQ(row(94).shields.size(), 3U);
    EXPECT_EQ(row(94).text, std::nullopt);
    EXPECT_EQ(row(94).size, (CGSize{70, 10}));
    request.textWidth = nullptr;
    EXPECT_EQ(row(94).shields.size(), 3U);
}

TEST_F(ShieldRow, LowShieldsStandInTheMiddleOfTheLine) {
    sizes = {{20, 10}, {10, 4}};
    EXPECT_EQ(row(100).shields, (Rects{at(0), at(25, 3, 10, 4)}));
}

TEST_F(ShieldRow, ShieldThatShowsNothingTakesNoRoom) {
    sizes = {{20, 10}, {0, 0}, {20, 10}};
    EXPECT_EQ(row(45).shields.size(), 3U);
    EXPECT_EQ(row(45).size.width, 45);
    EXPECT_EQ(row(45).shields.at(2), at(25));
}

TEST_F(ShieldRow, ShieldsBeyondTheFirstWithoutRoomAreNotAskedFor) {
    sizes.assign(1000, {20, 10});
    row(60);
    EXPECT_EQ(asked, 3U);
}

TEST_F(ShieldRow, FurtherLinesTakeWhatTheFirstCannot) {
    request.lines = 2;
    const auto two = row(45);
    EXPECT_EQ(two.shields, (Rects{at(0), at(25), at(0, 15), at(25, 15)}));
    EXPECT_EQ(two.size, (CGSize{45, 25}));
    sizes.assign(6, {20, 10});
    const auto cut = row(45);
    EXPECT_EQ(cut.shields.size(), 3U);
    EXPECT_EQ(cut.text, at(25, 15, 9));
    request.lines = 0;
    EXPECT_EQ(row(45).size, (CGSize{45, 40}));
}

TEST_F(ShieldRow, NoShieldsAreOneEmptyLine) {
    sizes.clear();
    EXPECT_EQ(row(100), (_ShieldRow{{}, std::nullopt, {0, 10}}));
}

} // namespace
} // namespace orvo
