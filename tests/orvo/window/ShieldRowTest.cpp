#include "orvo/window/private/ShieldRow.h"

#include "orvo/window/WindowWorld.h"

namespace orvo {
namespace {

class ShieldRowTest : public testing::WindowTest {
protected:
    void SetUp() override {
        ASSERT_TRUE(testing::haveWindowApplication());
        importCity();
        for (const char* route : {"M1", "T4", "T7"})
            lines.push_back(LineMark::ofLine(*schedules()->line(lineMuid("city", route))));
    }

    /// The columns from the first to the last that anything stands in, of that many.
    static std::pair<int, int> inkIn(ShieldRow& row, int width) {
        row.resize(width, row.heightForWidth(width));
        QImage image(row.size(), QImage::Format_ARGB32_Premultiplied);
        image.fill(Qt::transparent);
        row.render(&image, {}, {}, QWidget::DrawChildren);
        int first = width;
        int last = -1;
        for (int x = 0; x < width; ++x) {
            for (int y = 0; y < image.height(); ++y) {
                if (qAlpha(image.pixel(x, y)) == 0)
                    continue;
                first = std::min(first, x);
                last = x;
            }
        }
        return {first, last};
    }

    WindowLooks looks = WindowLooks::of({});
    std::vector<LineMark> lines;
};

TEST_F(ShieldRowTest, ShieldsStandSideBySideAsLongAsThereIsRoom) {
    const ShieldRow row(lines, {}, looks);
    const auto size = row.sizeHint();
    EXPECT_EQ(row.heightForWidth(size.width()), size.height());
    EXPECT_EQ(row.heightForWidth(10 * size.width()), size.height());
    EXPECT_GT(row.heightForWidth(size.width() - 1), 2 * size.height());
    const int narrow = row.minimumSizeHint().width();
    EXPECT_GT(row.heightForWidth(narrow), 3 * size.height());
}

TEST_F(ShieldRowTest, ALineWithoutAShieldGetsOneWithItsName) {
    const ShieldRow none({}, {}, looks);
    EXPECT_EQ(none.sizeHint().width(), 0);
    LineMark bare;
    bare.title = "Skyline";
    const ShieldRow row({bare}, {}, looks);
    EXPECT_GT(row.sizeHint().width(), row.sizeHint().height());
}

TEST_F(ShieldRowTest, AVoiceSaysAllLinesAndTheTextAfterThem) {
    const ShieldRow row({lines[0], lines[1]}, "and 2 more", looks);
    EXPECT_EQ(row.accessibleName().toStdString(),
              lines[0].spoken() + "; " + lines[1].spoken() + "; and 2 more");
}

TEST_F(ShieldRowTest, TheRowBeginsWhereReadingStarts) {
    ShieldRow row({lines[0]}, {}, looks);
    const int shield = row.sizeHint().width();
    const auto [left, leftEnd] = inkIn(row, 200);
    EXPECT_LT(left, 2);
    EXPECT_LT(leftEnd, shield);
    row.setLayoutDirection(Qt::RightToLeft);
    const auto [right, rightEnd] = inkIn(row, 200);
    EXPECT_GE(right, 200 - shield);
    EXPECT_GT(rightEnd, 197);
}

TEST_F(ShieldRowTest, TheTextAfterTheShieldsTakesItsOwnRoom) {
    ShieldRow shields({lines[0]}, {}, looks);
    ShieldRow row({lines[0]}, "and 2 more", looks);
    EXPECT_GT(inkIn(row, 300).second, inkIn(shields, 300).second + 20);
    EXPECT_LE(inkIn(row, 300).second, row.sizeHint().width());
}

} // namespace
} // namespace orvo
