#include "orvo/window/private/MarkDelegate.h"

#include "orvo/window/WindowWorld.h"
#include "orvo/window/private/MarkList.h"

#include <QPainter>

namespace orvo {
namespace {

constexpr int RowWidth = 320;
constexpr int TitlesBegin = 60; // right of any usual shield, left of all titles

class MarkDelegateTest : public testing::WindowTest {
protected:
    void SetUp() override {
        ASSERT_TRUE(testing::haveWindowApplication());
        importCity();
        delegate.emplace(nullptr);
        delegate->setLooks(looks);
        metro = LineMark::ofLine(*schedules()->line(lineMuid("city", "M1")));
        ASSERT_TRUE(metro.artwork);
        bare = metro;
        bare.artwork = bare.systemArtwork = nullptr;
        option.rect = {0, 0, RowWidth, delegate->sizeHint(option, {}).height()};
        option.direction = Qt::LeftToRight;
    }

    QImage painted(const LineMark& mark, const QString& note = {}) {
        MarkList list(&*delegate, "rows");
        list.addMark(mark, note);
        QImage image(option.rect.size(), QImage::Format_RGB32);
        image.fill(looks.field);
        QPainter painter(&image);
        delegate->paint(&painter, option, list.model()->index(0, 0));
        return image;
    }
    static QImage columns(const QImage& image, int from, int to) {
        return image.copy(from, 0, to - from, image.height());
    }
    bool isEmpty(const QImage& image) const {
        QImage empty(image.size(), image.format());
        empty.fill(looks.field);
        return image == empty;
    }

    WindowLooks looks = WindowLooks::of({});
    std::optional<MarkDelegate> delegate;
    LineMark metro;
    LineMark bare; ///< the same without a picture
    QStyleOptionViewItem option;
};

TEST_F(MarkDelegateTest, TitlesBeginBelowOneAnotherWithAndWithoutAShield) {
    const auto with = painted(metro);
    const auto without = painted(bare);
    EXPECT_EQ(columns(with, TitlesBegin, RowWidth), columns(without, TitlesBegin, RowWidth));
    EXPECT_FALSE(isEmpty(columns(with, TitlesBegin, RowWidth)));
    EXPECT_FALSE(isEmpty(columns(with, 0, TitlesBegin)));
    EXPECT_TRUE(isEmpty(columns(without, 0, TitlesBegin)));
}

TEST_F(MarkDelegateTest, ShieldsStandWhereReadingStarts) {
    option.direction = Qt::RightToLeft;
    bare.title = bare.detail = "x";
    metro.title = metro.detail = "x";
    EXPECT_EQ(columns(painted(metro), 0, RowWidth - TitlesBegin),
              columns(painted(bare), 0, RowWidth - TitlesBegin));
    EXPECT_FALSE(isEmpty(columns(painted(metro), RowWidth - TitlesBegin, RowWidth)));
    EXPECT_TRUE(isEmpty(columns(painted(bare), RowWidth - TitlesBegin, RowWidth)));
    EXPECT_TRUE(isEmpty(columns(painted(bare), 0, RowWidth / 2)));
}

TEST_F(MarkDelegateTest, AChosenRowHasAGroundAndARingWhereKeysGo) {
    const int middle = option.rect.height() / 2;
    constexpr int Edge = 5;
    EXPECT_EQ(painted(bare).pixel(Edge, middle), looks.field.rgb());
    option.state = QStyle::State_Selected;
    EXPECT_EQ(painted(bare).pixel(Edge, middle), looks.highlight.rgb());
    option.state |= QStyle::State_HasFocus;
    EXPECT_EQ(painted(bare).pixel(Edge, middle), looks.link.rgb());
}

TEST_F(MarkDelegateTest, ALongTitleEndsBeforeTheNote) {
    auto untitled = bare;
    untitled.title = untitled.detail = "";
    bare.title = bare.detail = std::string(300, 'W');
    const int room = QFontMetrics(WindowLooks::font(1)).horizontalAdvance("Favorite") + 12;
    const auto note = columns(painted(untitled, "Favorite"), RowWidth - room, RowWidth);
    EXPECT_FALSE(isEmpty(note));
    EXPECT_EQ(columns(painted(bare, "Favorite"), RowWidth - room, RowWidth), note);
    EXPECT_NE(columns(painted(bare), RowWidth - room, RowWidth), note);
}

TEST_F(MarkDelegateTest, ATitleWithoutADetailStandsInTheMiddle) {
    bare.title = "x";
    bare.detail = "x";
    const int above = option.rect.height() / 4;
    EXPECT_FALSE(isEmpty(painted(bare).copy(0, 3 * above - 4, RowWidth, above)));
    bare.detail = "";
    const auto alone = painted(bare);
    EXPECT_TRUE(isEmpty(alone.copy(0, 0, RowWidth, above)));
    EXPECT_TRUE(isEmpty(alone.copy(0, 3 * above - 4, RowWidth, above)));
    EXPECT_FALSE(isEmpty(alone));
}

} // namespace
} // namespace orvo
