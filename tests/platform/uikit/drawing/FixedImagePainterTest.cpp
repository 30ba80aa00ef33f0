#include "platform/uikit/drawing/FixedImagePainter.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

constexpr RGBA Grey = RGBA::fromHex(0x5B5B63);
constexpr std::uint32_t GreyPixel = 0xFF5B5B63;
constexpr int Points = 24;

/// An image, asked by points.
class Picture {
public:
    Picture(std::string_view name, int side, RGBA color = Grey)
        : _side(side)
        , _pixels(FixedImagePainter::draw(name, side, color)) {}

    bool isEmpty() const { return _pixels.empty(); }
    std::uint32_t pixel(int column, int row) const {
        return _pixels[static_cast<std::size_t>(row * _side + column)];
    }
    std::uint32_t at(double x, double y) const {
        const double scale = static_cast<double>(_side) / Points;
        return pixel(static_cast<int>(x * scale), static_cast<int>(y * scale));
    }
    int alpha(int column, int row) const { return static_cast<int>(pixel(column, row) >> 24U); }
    /// The part of the square that is covered.
    double coverage() const {
        double sum = 0;
        for (const std::uint32_t pixel : _pixels)
            sum += pixel >> 24U;
        return sum / 255 / (_side * _side);
    }

private:
    int _side;
    std::vector<std::uint32_t> _pixels;
};

class EveryFixedImage : public ::testing::TestWithParam<const char*> {};
INSTANTIATE_TEST_SUITE_P(
    Names,
    EveryFixedImage,
    ::testing::Values("good-v2", "good-alt-v2", "advisories-v2", "WidgetGenericTransit"));

TEST_P(EveryFixedImage, HasOneColour) {
    const Picture picture(GetParam(), 240);
    for (int row = 0; row < 240; ++row)
        for (int column = 0; column < 240; ++column)
            if (picture.alpha(column, row) == 255) {
                ASSERT_EQ(picture.pixel(column, row), GreyPixel) << column << ", " << row;
            }
}

TEST_P(EveryFixedImage, TransparentColourIsNowhereLaidOnTwice) {
    const Picture picture(GetParam(), 240, {0x5B, 0x5B, 0x63, 77});
    for (int row = 0; row < 240; ++row)
        for (int column = 0; column < 240; ++column)
            ASSERT_LE(picture.alpha(column, row), 77) << column << ", " << row;
}

TEST_P(EveryFixedImage, CoversTheSamePartAtEverySize) {
    const double large = Picture(GetParam(), 240).coverage();
    EXPECT_GT(large, 0.2);
    EXPECT_LT(large, 0.6);
    for (const int side : {14, 17, 24, 25, 48, 53, 72})
        EXPECT_NEAR(Picture(GetParam(), side).coverage(), large, 0.02) << side;
}

TEST_P(EveryFixedImage, KeepsAMarginSoThatNothingIsCutOff) {
    for (const int side : {24, 53, 72}) {
        const Picture picture(GetParam(), side);
        for (int i = 0; i < side; ++i) {
            EXPECT_EQ(picture.alpha(i, 0), 0);
            EXPECT_EQ(picture.alpha(i, side - 1), 0);
            EXPECT_EQ(picture.alpha(0, i), 0);
            EXPECT_EQ(picture.alpha(side - 1, i), 0);
        }
    }
}

class AtEveryScale : public ::testing::TestWithParam<int> {};
INSTANTIATE_TEST_SUITE_P(Scales, AtEveryScale, ::testing::Values(1, 2, 3));

TEST_P(AtEveryScale, TramHasSharpSides) {
    const int scale = GetParam();
    const Picture tram("WidgetGenericTransit", Points * scale);
    const int row = 13 * scale; // between window and lamps
    EXPECT_EQ(tram.alpha(5 * scale - 1, row), 0);
    EXPECT_EQ(tram.alpha(5 * scale, row), 255);
    EXPECT_EQ(tram.alpha(19 * scale - 1, row), 255);
    EXPECT_EQ(tram.alpha(19 * scale, row), 0);
    const int column = 12 * scale; // through the window
    EXPECT_EQ(tram.alpha(column, 8 * scale - 1), 255);
    EXPECT_EQ(tram.alpha(column, 8 * scale), 0);
    EXPECT_EQ(tram.alpha(column, 12 * scale - 1), 0);
    EXPECT_EQ(tram.alpha(column, 12 * scale), 255);
}

TEST_P(AtEveryScale, TriangleStandsOnASharpBase) {
    const int scale = GetParam();
    const Picture triangle("advisories-v2", Points * scale);
    EXPECT_EQ(triangle.alpha(12 * scale, 21 * scale - 1), 255);
    EXPECT_EQ(triangle.alpha(12 * scale, 21 * scale), 0);
}

TEST_P(AtEveryScale, TramAndTriangleAreTheSameOnBothSides) {
    const int side = Points * GetParam();
    for (const char* name : {"WidgetGenericTransit", "advisories-v2"}) {
        const Picture picture(name, side);
        for (int row = 0; row < side; ++row)
            for (int column = 0; column < side / 2; ++column)
                ASSERT_NEAR(picture.alpha(column, row), picture.alpha(side - 1 - column, row), 12)
                    << name << " " << column << ", " << row;
    }
}

TEST(FixedImagePainter, OneLooksThroughTheCheckTheMarkTheWindowAndTheLamps) {
    const Picture good("good-v2", 240);
    EXPECT_EQ(good.at(10.5, 15.5), 0U);
    EXPECT_EQ(good.at(12, 4), GreyPixel);
    const Picture advisories("advisories-v2", 240);
    EXPECT_EQ(advisories.at(12, 11), 0U);
    EXPECT_EQ(advisories.at(12, 17.25), 0U);
    EXPECT_EQ(advisories.at(12, 15.25), GreyPixel);
    const Picture tram("WidgetGenericTransit", 240);
    EXPECT_EQ(tram.at(12, 10), 0U);
    EXPECT_EQ(tram.at(8.5, 15.5), 0U);
    EXPECT_EQ(tram.at(15.5, 15.5), 0U);
}

TEST(FixedImagePainter, BothImagesOfGoodServiceHaveOneShape) {
    EXPECT_EQ(FixedImagePainter::draw("good-v2", 48, Grey),
              FixedImagePainter::draw("good-alt-v2", 48, Grey));
}

TEST(FixedImagePainter, NothingIsDrawnOfOtherNamesOrIntoNothing) {
    EXPECT_TRUE(Picture("good", 24).isEmpty());
    EXPECT_TRUE(Picture("", 24).isEmpty());
    EXPECT_TRUE(Picture("good-v2", 0).isEmpty());
    EXPECT_TRUE(Picture("good-v2", -1).isEmpty());
    EXPECT_FALSE(Picture("good-v2", 1).isEmpty());
}

} // namespace
} // namespace orvo
