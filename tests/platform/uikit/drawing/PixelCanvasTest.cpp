#include "platform/uikit/drawing/PixelCanvas.h"

#include "platform/uikit/drawing/_ShapedLines.h"
#include "support/GraphicalApplication.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace orvo {
namespace {

constexpr RGBA Black{0, 0, 0, 255};

/// Ten by ten device pixels.
class CanvasTest : public ::testing::Test {
protected:
    static constexpr int Side = 10;

    [[nodiscard]] std::uint32_t at(int x, int y) const {
        return pixels.at(static_cast<std::size_t>(y * Side + x));
    }
    [[nodiscard]] int painted() const {
        return static_cast<int>(
            std::ranges::count_if(pixels, [](auto pixel) { return pixel != 0; }));
    }
    std::vector<std::uint32_t> pixels = std::vector<std::uint32_t>(Side * Side);
};

TEST_F(CanvasTest, FilledRectanglesHaveCrispEdgesWhereverTheyLie) {
    PixelCanvas(pixels, Side, Side, 1).fill({{1.3, 1.4}, {3, 2}}, 0, Black);
    EXPECT_EQ(painted(), 6);
    EXPECT_EQ(at(1, 1), 0xFF000000);
    EXPECT_EQ(at(3, 2), 0xFF000000);
}

TEST_F(CanvasTest, LengthsArePointsOfTheScale) {
    PixelCanvas(pixels, Side, Side, 2).fill({{1, 1}, {2, 1}}, 0, Black);
    EXPECT_EQ(painted(), 8);
    EXPECT_EQ(at(2, 2), 0xFF000000);
    EXPECT_EQ(at(5, 3), 0xFF000000);
}

TEST_F(CanvasTest, LineThinnerThanAPixelIsOnePixelNotNothing) {
    PixelCanvas(pixels, Side, Side, 1).fill({{0, 3.2}, {10, 0.3}}, 0, Black);
    EXPECT_EQ(painted(), 10);
    EXPECT_EQ(at(0, 3), 0xFF000000);
}

TEST_F(CanvasTest, TranslationClipAndFadeEndWithRestore) {
    PixelCanvas canvas(pixels, Side, Side, 1);
    canvas.save();
    canvas.translate(5, 5);
    canvas.clip({{0, 0}, {1, 1}}, 0);
    canvas.fade(0.5);
    canvas.fill({{0, 0}, {3, 3}}, 0, Black);
    canvas.restore();
    EXPECT_EQ(painted(), 1);
    EXPECT_NEAR(at(5, 5) >> 24, 128, 2);
    canvas.fill({{0, 0}, {1, 1}}, 0, Black);
    EXPECT_EQ(at(0, 0), 0xFF000000);
}

TEST_F(CanvasTest, StrokeLiesInsideItsRectangle) {
    PixelCanvas(pixels, Side, Side, 1).stroke({{2, 2}, {6, 6}}, 0, 1, Black);
    EXPECT_EQ(at(1, 4), 0U);
    EXPECT_EQ(at(2, 4), 0xFF000000);
    EXPECT_EQ(at(3, 4), 0U);
    EXPECT_EQ(at(7, 4), 0xFF000000);
}

TEST_F(CanvasTest, PixelsOfTheScaleAreCopiedAsTheyAre) {
    const std::vector<std::uint32_t> picture{0xFFFF0000, 0xFF00FF00, 0xFF0000FF, 0xFFFFFFFF};
    PixelCanvas(pixels, Side, Side, 2).pixels(picture, 2, 2, {{1, 1}, {1, 1}}, nullptr);
    EXPECT_EQ(painted(), 4);
    EXPECT_EQ(at(2, 2), 0xFFFF0000);
    EXPECT_EQ(at(3, 3), 0xFFFFFFFF);
}

TEST_F(CanvasTest, TintedPixelsHaveTheOneColour) {
    const std::vector<std::uint32_t> picture(4, 0xFFFF0000);
    const RGBA tint{0, 0, 255, 255};
    PixelCanvas(pixels, Side, Side, 2).pixels(picture, 2, 2, {{1, 1}, {1, 1}}, &tint);
    EXPECT_EQ(at(2, 2), 0xFF0000FF);
}

TEST_F(CanvasTest, FixedImageFillsItsRectangleAndAnUnknownOneNothing) {
    PixelCanvas canvas(pixels, Side, Side, 1);
    canvas.fixedImage("no-such-image", {{0, 0}, {10, 10}}, Black);
    EXPECT_EQ(painted(), 0);
    canvas.fixedImage("good-alt-v2", {{0, 0}, {10, 10}}, Black);
    EXPECT_GT(painted(), 30);
}

class CanvasTextTest : public CanvasTest {
protected:
    void SetUp() override {
        if (!testing::haveGraphicalApplication())
            GTEST_SKIP() << "this process has an application object without a screen";
    }
    static TextLine line(const std::string& text) {
        return TextLayout({.text = text, .runs = {{0, text.size(), {.pointSize = 8}}}})
            .lines(TextLayout::Unlimited)
            .lines.front();
    }
    [[nodiscard]] int lowestRow() const {
        for (int y = Side - 1; y >= 0; --y) {
            for (int x = 0; x < Side; ++x) {
                if (at(x, y) >> 24 > 60)
                    return y;
            }
        }
        return -1;
    }
};

TEST_F(CanvasTextTest, BaselineStandsOnAWholePixel) {
    PixelCanvas(pixels, Side, Side, 1).text(line("H"), {1, 8.3}, Black);
    EXPECT_EQ(lowestRow(), 7);
    std::ranges::fill(pixels, 0);
    PixelCanvas(pixels, Side, Side, 1).text(line("H"), {1, 7.6}, Black);
    EXPECT_EQ(lowestRow(), 7);
}

TEST_F(CanvasTextTest, BaselineIsThatOfTheScreenWhereverTheViewLies) {
    PixelCanvas canvas(pixels, Side, Side, 1);
    canvas.translate(0, 0.4);
    canvas.text(line("H"), {1, 7.2}, Black);
    EXPECT_EQ(lowestRow(), 7);
}

TEST_F(CanvasTextTest, TextReadFromRightToLeftStartsAtItsLeftEdgeToo) {
    PixelCanvas(pixels, Side, Side, 1).text(line("\u05D0"), {1, 8}, Black);
    EXPECT_GT(painted(), 5);
}

TEST_F(CanvasTextTest, LineThatWasDrawnIsNotShapedAgain) {
    PixelCanvas canvas(pixels, Side, Side, 1);
    canvas.text(line("once"), {1, 8}, Black);
    const auto before = _ShapedLines::shaped();
    canvas.text(line("once"), {1, 8}, Black);
    EXPECT_EQ(_ShapedLines::shaped(), before);
    canvas.text(line("twice"), {1, 8}, Black);
    EXPECT_EQ(_ShapedLines::shaped(), before + 1);
}

} // namespace
} // namespace orvo
