#include "platform/uikit/drawing/TintedPixels.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

constexpr std::uint32_t Red = 0xFFDA291C;
constexpr std::uint32_t White = 0xFFFFFFFF;
constexpr std::uint32_t Clear = 0;
constexpr RGBA Grey{0x5B, 0x5B, 0x63, 255};

std::uint32_t alphaOf(std::uint32_t pixel) {
    return pixel >> 24;
}

TEST(TintedPixels, MostOfThePictureTakesTheColourAndItsTextIsCutOut) {
    const std::vector<std::uint32_t> shield{Red, Red, Red, Red, White, Clear};
    const auto tinted = TintedPixels::of(shield, Grey);
    ASSERT_EQ(tinted.size(), shield.size());
    EXPECT_GT(alphaOf(tinted[0]), 250U);
    EXPECT_LT(alphaOf(tinted[4]), 30U);
    EXPECT_EQ(tinted[5], 0U);
}

TEST(TintedPixels, DarkTextOnALightShieldIsCutOutAsWell) {
    const std::vector<std::uint32_t> shield{White, White, White, 0xFF000000};
    const auto tinted = TintedPixels::of(shield, Grey);
    EXPECT_GT(alphaOf(tinted[0]), 240U);
    EXPECT_LT(alphaOf(tinted[3]), 30U);
}

TEST(TintedPixels, PictureOfOneColourLosesNothing) {
    const std::vector<std::uint32_t> disc{Red, Red, 0x80000000 | 0x006D150E};
    const auto tinted = TintedPixels::of(disc, Grey);
    EXPECT_EQ(tinted[0], 0xFF5B5B63);
    EXPECT_EQ(alphaOf(tinted[2]), 0x80U);
}

TEST(TintedPixels, TransparencyOfTheTintCounts) {
    const std::vector<std::uint32_t> dot{Red};
    EXPECT_EQ(alphaOf(TintedPixels::of(dot, {0, 0, 0, 128})[0]), 128U);
}

TEST(TintedPixels, NothingStaysNothing) {
    EXPECT_TRUE(TintedPixels::of({}, Grey).empty());
}

} // namespace
} // namespace orvo
