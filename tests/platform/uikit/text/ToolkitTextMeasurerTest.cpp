#include "platform/uikit/text/ToolkitTextMeasurer.h"

#include "platform/uikit/text/TextLayout.h"
#include "support/GraphicalApplication.h"

#include <QGuiApplication>
#include <gtest/gtest.h>

#include <numeric>

namespace orvo {
namespace {

std::vector<double> advancesOf(const std::string& text,
                               std::vector<std::size_t> clusters,
                               FontFace face = {.pointSize = 17},
                               bool rightToLeft = false) {
    const TextRun run{0, text.size(), face};
    return ToolkitTextMeasurer().advances(text, {&run, 1}, clusters, rightToLeft);
}

TEST(ToolkitTextMeasurer, WithoutAScreenMetricsAreThoseOfTheFontAndAdvancesAlike) {
    if (QCoreApplication::instance())
        GTEST_SKIP() << "another test of this process has made a screen";
    const auto metrics = ToolkitTextMeasurer().metricsOf({.pointSize = 100});
    EXPECT_NEAR(metrics.capHeight, 72.73, 0.01);
    EXPECT_NEAR(metrics.lineHeight(), 121.02, 0.01);
    for (const double width : advancesOf("iW", {0, 1}))
        EXPECT_DOUBLE_EQ(width, 9.52);
}

class FontTest : public ::testing::Test {
protected:
    void SetUp() override {
        if (!testing::haveGraphicalApplication())
            GTEST_SKIP() << "this process has an application object without a screen";
        // Without the fonts every character is a box of the same width.
        const auto widths = advancesOf("iW", {0, 1});
        ASSERT_GT(widths[1], 2 * widths[0]) << "the program's fonts are not installed";
    }
};

TEST_F(FontTest, MetricsAreTheFontsOwn) {
    ToolkitTextMeasurer measurer;
    const auto metrics = measurer.metricsOf({.pointSize = 17});
    EXPECT_NEAR(metrics.capHeight, 17 * 0.7273, 0.05);
    EXPECT_NEAR(metrics.ascender, 17 * 2728.0 / 2816, 0.05);
    EXPECT_NEAR(metrics.descender, -17 * 680.0 / 2816, 0.05);
    EXPECT_EQ(measurer.metricsOf({.pointSize = 17}), metrics);
}

TEST_F(FontTest, AdvancesGrowInProportionToTheSize) {
    const auto small = advancesOf("Hauptbahnhof", {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11});
    const auto large =
        advancesOf("Hauptbahnhof", {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11}, {.pointSize = 51});
    const auto sum = [](const auto& widths) {
        return std::accumulate(widths.begin(), widths.end(), 0.0);
    };
    EXPECT_NEAR(sum(large), 3 * sum(small), 0.2);
}

TEST_F(FontTest, BoldIsWider) {
    EXPECT_GT(advancesOf("Green", {0})[0], 0);
    const auto width = [](int weight) {
        const auto widths =
            advancesOf("Green", {0, 1, 2, 3, 4}, {.pointSize = 17, .weight = weight});
        return std::accumulate(widths.begin(), widths.end(), 0.0);
    };
    EXPECT_GT(width(700), width(600));
    EXPECT_GT(width(600), width(400));
}

TEST_F(FontTest, AnotherWeightIsThereWithoutTheOpenFontsBeingForgotten) {
    int changes = 0;
    const auto* const application = qobject_cast<QGuiApplication*>(QCoreApplication::instance());
    const auto watch = QObject::connect(
        application, &QGuiApplication::fontDatabaseChanged, application, [&] { ++changes; });
    for (const int weight : {400, 500, 600})
        EXPECT_GT(advancesOf("W", {0}, {.pointSize = 17, .weight = weight})[0], 0);
    QObject::disconnect(watch);
    EXPECT_EQ(changes, 0);
}

TEST_F(FontTest, BothDirectionsInOneTextAddUpToItsWidth) {
    // "bus", space, three Hebrew letters of two bytes each
    const std::string text = "bus \u05D0\u05D1\u05D2";
    const auto widths = advancesOf(text, {0, 1, 2, 3, 4, 6, 8});
    for (const double width : widths) {
        EXPECT_GT(width, 1);
        EXPECT_LT(width, 17);
    }
    const auto reversed = [&text] {
        const TextRun run{0, text.size(), {.pointSize = 17}};
        const std::vector<std::size_t> clusters{0, 1, 2, 3, 4, 6, 8};
        return ToolkitTextMeasurer().advances(text, {&run, 1}, clusters, true);
    }();
    EXPECT_NEAR(std::accumulate(widths.begin(), widths.end(), 0.0),
                std::accumulate(reversed.begin(), reversed.end(), 0.0),
                0.1);
}

TEST_F(FontTest, SignsAndNumbersAreAsWideFromRightToLeft) {
    for (const char* text : {"+3", "3+", "+", "12"}) {
        const std::vector<std::size_t> clusters = std::string(text).size() == 1
                                                      ? std::vector<std::size_t>{0}
                                                      : std::vector<std::size_t>{0, 1};
        const auto sum = [](const std::vector<double>& widths) {
            return std::accumulate(widths.begin(), widths.end(), 0.0);
        };
        EXPECT_NEAR(sum(advancesOf(text, clusters, {.pointSize = 17}, true)),
                    sum(advancesOf(text, clusters)),
                    0.5) // other neighbours stand closer
            << text;
    }
}

TEST_F(FontTest, LettersThatJoinAreMeasuredAsTheyStandInTheWord) {
    // lam and alef become one glyph, which both share
    const auto widths = advancesOf("\u0644\u0627", {0, 2});
    EXPECT_GT(widths[0], 0);
    EXPECT_NEAR(widths[0], widths[1], 0.01);
}

TEST_F(FontTest, CombiningMarkAddsNothing) {
    const auto plain = advancesOf("e", {0});
    const auto accented = advancesOf("e\u0301", {0});
    EXPECT_NEAR(accented[0], plain[0], 0.5);
}

TEST_F(FontTest, WrappedLinesOfRealTextFitTheirWidth) {
    const std::string text = "Wegen Bauarbeiten kommt es zwischen Hauptbahnhof und Messegelände zu "
                             "Verspätungen von bis zu dreißig Minuten.";
    const TextLayout layout({.text = text, .runs = {{0, text.size(), {.pointSize = 15}}}});
    const auto lines = layout.lines(254);
    EXPECT_GT(lines.lines.size(), 2U);
    for (const auto& line : lines.lines) {
        EXPECT_LE(line.width, 254.01);
        const TextLayout alone(
            {.text = line.text, .runs = {{0, line.text.size(), {.pointSize = 15}}}});
        EXPECT_NEAR(alone.lines(TextLayout::Unlimited).width(), line.width, 1) << line.text;
    }
}

} // namespace
} // namespace orvo
