#include "platform/feeds/schedule/LineColors.h"

#include <gtest/gtest.h>

#include <fmt/format.h>

namespace orvo {
namespace {

TEST(LineColors, ContrastIsTheRatioOfWcag) {
    EXPECT_NEAR(contrastRatio("FFFFFF", "000000"), 21, 1e-9);
    EXPECT_NEAR(contrastRatio("777777", "FFFFFF"), 4.48, 0.005);
    EXPECT_NEAR(contrastRatio("FFFFFF", "777777"), 4.48, 0.005);
    EXPECT_NEAR(contrastRatio("123456", "123456"), 1, 1e-9);
}

TEST(LineColors, ColorsThatCanBeReadAreKept) {
    const LineColors colors = LineColors::mended("DA291C", "FFFFFF");
    EXPECT_EQ(colors.shieldColorString(), "DA291C,FFFFFF");
    EXPECT_EQ(LineColors::mended("767676", "FFFFFF").text, "FFFFFF"); // 4.54
    EXPECT_EQ(LineColors::mended("FFFFFF", "00008B").text, "00008B");
}

TEST(LineColors, TextTooCloseToItsBackgroundBecomesBlackOrWhite) {
    EXPECT_EQ(LineColors::mended("777777", "FFFFFF").text, "000000"); // 4.48
    EXPECT_EQ(LineColors::mended("FFB900", "FFFFFF").text, "000000");
    EXPECT_EQ(LineColors::mended("00008B", "000000").text, "FFFFFF");
}

TEST(LineColors, MissingColorsAreMended) {
    EXPECT_EQ(LineColors::mended("005CA9", "").text, "FFFFFF");
    EXPECT_EQ(LineColors::mended("FFB900", "").text, "000000");
    EXPECT_EQ(LineColors::mended("", "").shieldColorString(), "FFFFFF,000000");
    EXPECT_EQ(LineColors::mended("", "FFFFFF").shieldColorString(), "FFFFFF,000000");
    EXPECT_EQ(LineColors::mended("", "00008B").shieldColorString(), "FFFFFF,00008B");
}

TEST(LineColors, WhatIsNoColorCountsAsMissing) {
    for (const char* none : {"-1", "x", "DA291", "DA291C0", "GG0000", "\xFF\x00\xFE"}) {
        EXPECT_EQ(LineColors::mended(none, none).shieldColorString(), "FFFFFF,000000") << none;
        EXPECT_EQ(LineColors::mended("DA291C", none).shieldColorString(), "DA291C,FFFFFF") << none;
    }
}

TEST(LineColors, EveryGreyIsReadableOnceMended) {
    for (int level = 0; level < 256; ++level) {
        const std::string grey = fmt::format("{0:02X}{0:02X}{0:02X}", level);
        const LineColors colors = LineColors::mended(grey, grey);
        EXPECT_GE(contrastRatio(colors.background, colors.text), LineColors::LeastContrast) << grey;
    }
}

} // namespace
} // namespace orvo
