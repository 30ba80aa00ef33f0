#include "platform/uikit/text/private/ProgramFonts.h"

#include "platform/uikit/text/private/ToolkitFonts.h"
#include "support/GraphicalApplication.h"

#include <QFontDatabase>
#include <QImage>
#include <QPainter>
#include <gtest/gtest.h>

#include <algorithm>

namespace orvo {
namespace {

constexpr const char* OfTheSet = "Überseering → Площадь, Πλατεία ✓ 12×";

class ProgramFontsTest : public ::testing::Test {
protected:
    void SetUp() override {
        if (!testing::haveGraphicalApplication())
            GTEST_SKIP() << "this process has an application object without a screen";
        ASSERT_NE(ProgramFonts::faceOf(400).family, "") << "the program's fonts are not installed";
        if (ProgramFonts::haveSystemFonts())
            GTEST_SKIP() << "another test of this process has needed them";
    }

    /// Without the names that the toolkit gives to the system's choices, whether it has any.
    static std::set<QString> readFamilies() {
        const auto families = QFontDatabase::families();
        std::set<QString> read(families.begin(), families.end());
        for (const char* choice : {"Monospace", "Sans Serif", "Serif"})
            read.erase(choice);
        return read;
    }

    /// The text as it is written in each face, one below the other.
    static QImage picture(const char* text) {
        QImage image(400, 200, QImage::Format_ARGB32_Premultiplied);
        image.fill(Qt::transparent);
        QPainter painter(&image);
        int y = 0;
        for (const int weight : {400, 500, 600, 700}) {
            QTextLayout layout;
            const std::string utf8 = text;
            const TextRun run{0, utf8.size(), {.pointSize = 17, .weight = weight}};
            ToolkitFonts::layOut(layout, utf8, {&run, 1}, false);
            layout.draw(&painter, QPointF(0.25, y));
            y += 40;
        }
        return image;
    }
};

TEST_F(ProgramFontsTest, TheSetAloneIsReadAsLongAsItIsEnough) {
    static_cast<void>(picture(OfTheSet));
    ProgramFonts::makeReadyFor(QString::fromUtf8("two\u2028lines\u2029and a paragraph"));
    EXPECT_FALSE(ProgramFonts::haveSystemFonts());
    const std::set<QString> set{"Inter", "Inter Medium", "Inter Semi Bold"};
    EXPECT_EQ(readFamilies(), set);
}

TEST_F(ProgramFontsTest, BoldWhichNoRowHasIsReadWhenItIsAskedFor) {
    EXPECT_FALSE(QFontDatabase::styles("Inter").contains("Bold"));
    EXPECT_EQ(ProgramFonts::faceOf(650).weight, 600);
    EXPECT_FALSE(QFontDatabase::styles("Inter").contains("Bold"));
    EXPECT_EQ(ProgramFonts::faceOf(700).family, "Inter");
    EXPECT_TRUE(QFontDatabase::styles("Inter").contains("Bold"));
}

TEST_F(ProgramFontsTest, ACharacterThatTheSetLacksBringsTheFontsOfTheSystem) {
    const auto before = picture(OfTheSet);
    static_cast<void>(picture("中央駅"));
    EXPECT_TRUE(ProgramFonts::haveSystemFonts());
    EXPECT_EQ(picture(OfTheSet), before);
}

TEST_F(ProgramFontsTest, CharactersBeyondTheFirstPlaneAreLookedForWhole) {
    ProgramFonts::makeReadyFor(QString::fromUtf8("Tram 🚋"));
    EXPECT_TRUE(ProgramFonts::haveSystemFonts());
}

TEST_F(ProgramFontsTest, ATextWithAFaceIsMadeReady) {
    static_cast<void>(ToolkitFonts::fontOf({.pointSize = 17}, "Harbour"));
    EXPECT_FALSE(ProgramFonts::haveSystemFonts());
    static_cast<void>(ToolkitFonts::fontOf({.pointSize = 17}, QString::fromUtf8("محطة")));
    EXPECT_TRUE(ProgramFonts::haveSystemFonts());
}

TEST(ProgramFonts, TheNearestFaceIsTaken) {
    if (!testing::haveGraphicalApplication())
        GTEST_SKIP() << "this process has an application object without a screen";
    EXPECT_EQ(ProgramFonts::faceOf(100).weight, 400);
    EXPECT_EQ(ProgramFonts::faceOf(510).weight, 500);
    EXPECT_EQ(ProgramFonts::faceOf(600).weight, 600);
    EXPECT_EQ(ProgramFonts::faceOf(900).weight, 700);
}

} // namespace
} // namespace orvo
