#include "orvo/window/private/WindowLooks.h"

#include "orvo/window/LineMark.h"
#include "orvo/window/WindowWorld.h"
#include "platform/uikit/text/private/ProgramFonts.h"

#include <QFontDatabase>
#include <QImage>

#include <cmath>

namespace orvo {
namespace {

class WindowLooksTest : public testing::WindowTest {
protected:
    void SetUp() override { ASSERT_TRUE(testing::haveWindowApplication()); }
    void TearDown() override { WindowLooks::of({}).applyToApplication(); }

    static double luminance(const QColor& color) {
        const auto part = [](double value) {
            return value <= 0.04045 ? value / 12.92 : std::pow((value + 0.055) / 1.055, 2.4);
        };
        return 0.2126 * part(color.redF()) + 0.7152 * part(color.greenF()) +
               0.0722 * part(color.blueF());
    }
    /// From 1, the same, to 21, black on white.
    static double contrast(const QColor& one, const QColor& other) {
        const double a = luminance(one) + 0.05;
        const double b = luminance(other) + 0.05;
        return std::max(a, b) / std::min(a, b);
    }
};

TEST_F(WindowLooksTest, EveryTextCanBeReadOnItsGround) {
    for (const bool isDark : {false, true}) {
        for (const bool hasMore : {false, true}) {
            const auto looks = WindowLooks::of({.isDark = isDark, .hasHighContrast = hasMore});
            const double least = hasMore ? 7 : 4.5;
            for (const auto& color :
                 {looks.text, looks.secondary, looks.good, looks.advisory, looks.link})
                EXPECT_GE(contrast(color, looks.card), least)
                    << color.name().toStdString() << " on " << looks.card.name().toStdString();
            for (const auto& ground : {looks.field, looks.highlight}) {
                EXPECT_GE(contrast(looks.text, ground), least);
                EXPECT_GE(contrast(looks.secondary, ground), hasMore ? 7 : 4.5);
            }
        }
    }
}

TEST_F(WindowLooksTest, TheApplicationTakesThemOn) {
    const auto looks = WindowLooks::of({.isDark = true});
    looks.applyToApplication();
    EXPECT_EQ(QApplication::palette().color(QPalette::Window), looks.card);
    EXPECT_EQ(QApplication::palette().color(QPalette::Text), looks.text);
    WindowLooks::of({}).applyToApplication();
    EXPECT_EQ(QApplication::palette().color(QPalette::Window), WindowLooks::of({}).card);
}

TEST_F(WindowLooksTest, TextIsAsLargeAsThePersonWantsIt) {
    WindowLooks::of({}).applyToApplication();
    const double usual = QApplication::font().pointSizeF();
    const auto large = WindowLooks::of({.textScale = 1.5});
    large.applyToApplication();
    large.applyToApplication(); // not once more
    EXPECT_NEAR(QApplication::font().pointSizeF(), 1.5 * usual, 0.01);
    EXPECT_NEAR(WindowLooks::font(2, QFont::Bold).pointSizeF(), 3 * usual, 0.01);
    EXPECT_EQ(WindowLooks::font(2, QFont::Bold).weight(), QFont::Bold);
}

TEST_F(WindowLooksTest, AShieldHasThePixelsOfItsDevice) {
    importCity();
    const auto mark = LineMark::ofLine(*schedules()->line(lineMuid("city", "M1")));
    const auto looks = WindowLooks::of({});
    const auto once = looks.shield(mark, 5, 1);
    const auto twice = looks.shield(mark, 5, 2);
    EXPECT_EQ(once.height(), 22);
    EXPECT_EQ(twice.height(), 44);
    EXPECT_EQ(twice.devicePixelRatio(), 2);
    EXPECT_TRUE(looks.shield({}, 5, 1).isNull());
}

TEST_F(WindowLooksTest, ImagesAreInTheColourThatIsAskedFor) {
    const QColor color(0x1B, 0x7F, 0x3B);
    const auto holds = [&](const QPixmap& pixmap) {
        const auto image = pixmap.toImage();
        for (int y = 0; y < image.height(); ++y) {
            for (int x = 0; x < image.width(); ++x) {
                if (image.pixelColor(x, y) == color)
                    return true;
            }
        }
        return false;
    };
    EXPECT_TRUE(holds(WindowLooks::fixedImage("good-v2", 18, color, 2)));
    EXPECT_EQ(WindowLooks::fixedImage("good-v2", 18, color, 2).size(), QSize(36, 36));
    EXPECT_TRUE(holds(WindowLooks::magnifier(color, 4)));
    EXPECT_EQ(WindowLooks::magnifier(color, 4).deviceIndependentSize(), QSizeF(16, 16));
    EXPECT_TRUE(WindowLooks::fixedImage("no such image", 18, color, 1).isNull());
}

TEST_F(WindowLooksTest, TheFontsOfTheDesktopStayThereBesideThoseOfShields) {
    const auto families = QFontDatabase::families();
    EXPECT_NE(ProgramFonts::faceOf(600).family, "");
    EXPECT_TRUE(ProgramFonts::haveSystemFonts());
    for (const auto& family : families)
        EXPECT_TRUE(QFontDatabase::families().contains(family)) << family.toStdString();
}

} // namespace
} // namespace orvo
