#include "WindowWorld.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <functional>
#include <vector>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testing::Mode;
using testing::WindowWorld;

class WidgetWindowTest : public ::testing::Test {
protected:
    void SetUp() override {
        if (!testing::haveGraphicalApplication())
            GTEST_SKIP() << "another test has made the application object";
    }
};

const QPointF Button(330, 18);
const QPointF FirstRow(100, 60);

TEST_F(WidgetWindowTest, IsAsLargeAsTheCard) {
    WindowWorld world;
    world.show();
    EXPECT_EQ(world.window->frame().size, (CGSize{359, 146}));
    EXPECT_EQ(world.toolkitWindow().title(), "A Widget");
    EXPECT_TRUE(world.toolkitWindow().flags().testFlag(Qt::FramelessWindowHint));
}

TEST_F(WidgetWindowTest, WidgetAppearsOnceTheFirstFrameStands) {
    WindowWorld world;
    int appearedAtFirstFrame = -1;
    world.window->setFirstFrameShown([&] { appearedAtFirstFrame = world.widget->appearances; });
    EXPECT_EQ(world.widget->appearances, 0);
    world.show();
    EXPECT_EQ(appearedAtFirstFrame, 0);
    EXPECT_EQ(world.widget->appearances, 1);
    EXPECT_TRUE(world.host->isVisible());
}

TEST_F(WidgetWindowTest, HidingAndMinimisingLetTheWidgetDisappear) {
    WindowWorld world;
    world.show();
    world.window->hide();
    world.settle();
    EXPECT_EQ(world.widget->disappearances, 1);
    world.show();
    EXPECT_EQ(world.widget->appearances, 2);
    world.toolkitWindow().showMinimized();
    world.settle();
    EXPECT_EQ(world.widget->disappearances, 2);
    world.toolkitWindow().showNormal();
    world.settle();
    EXPECT_EQ(world.widget->appearances, 3);
}

TEST_F(WidgetWindowTest, ClosingTellsOnceAndLetsTheWidgetDisappear) {
    WindowWorld world;
    int closed = 0;
    world.window->setClosed([&] {
        ++closed;
        world.window = nullptr;
    });
    world.show();
    world.toolkitWindow().close();
    EXPECT_EQ(world.widget->disappearances, 1);
    world.turn();
    EXPECT_EQ(closed, 1);
    EXPECT_EQ(world.widget->disappearances, 1);
}

TEST_F(WidgetWindowTest, WindowThatGoesLetsTheWidgetDisappear) {
    WindowWorld world;
    world.show();
    world.window = nullptr;
    EXPECT_EQ(world.widget->disappearances, 1);
    EXPECT_FALSE(world.host->isVisible());
}

TEST_F(WidgetWindowTest, DrawsNothingUnlessSomethingChanged) {
    WindowWorld world;
    world.show();
    const auto frames = world.window->framesShown();
    world.finish();
    EXPECT_EQ(world.window->framesShown(), frames);
    world.widget->show({"yellow", "green"});
    world.settle();
    EXPECT_EQ(world.window->framesShown(), frames + 1);
    world.settle();
    EXPECT_EQ(world.window->framesShown(), frames + 1);
}

TEST_F(WidgetWindowTest, FramesComeByThemselvesWhenAViewHasChanged) {
    WindowWorld world;
    world.show();
    const auto frames = world.window->framesShown();
    world.widget->show({"yellow", "green"});
    EXPECT_TRUE(RunLoop::main().runUntil([&] { return world.window->framesShown() > frames; }, 20));
}

TEST_F(WidgetWindowTest, GrowsInAQuarterOfASecond) {
    WindowWorld world;
    world.show();
    world.click(Button);
    EXPECT_EQ(world.host->displayMode(), Mode::Expanded);
    EXPECT_TRUE(world.window->isChangingSize());
    EXPECT_EQ(world.window->frame().size.height, 366) << "there is room for where it goes";
    world.monotonic->advance(0.125);
    world.settle();
    EXPECT_TRUE(world.window->isChangingSize());
    const auto ground = world.colorAt({8, 240});
    const auto card = world.colorAt({8, 300});
    EXPECT_NE(ground, card) << "half of it is seen";
    world.monotonic->advance(0.125);
    world.settle();
    EXPECT_FALSE(world.window->isChangingSize());
    EXPECT_EQ(world.colorAt({8, 300}), ground);
}

/// How high the card is seen, in points, to ten of them: below it the screen is black.
int seenHeight(const WindowWorld& world) {
    int height = static_cast<int>(world.window->frame().size.height);
    while (height > 10 && world.colorAt({40, height - 1}) == QColor(Qt::black))
        height -= 10;
    return height;
}

TEST_F(WidgetWindowTest, GrowthPassesThroughTheHeightsBetween) {
    WindowWorld world;
    world.show();
    world.click(Button);
    std::vector<int> heights;
    while (world.window->isChangingSize()) {
        ASSERT_LT(heights.size(), 100U);
        world.monotonic->advance(0.0625);
        world.settle();
        heights.push_back(seenHeight(world));
    }
    ASSERT_EQ(heights.size(), 4U) << "a quarter of a second";
    EXPECT_GT(heights.front(), 146);
    EXPECT_LT(heights.front(), 366);
    EXPECT_EQ(std::ranges::adjacent_find(heights, std::ranges::greater_equal()), heights.end());
    EXPECT_EQ(heights.back(), 366);
    EXPECT_EQ(world.window->card()->frame().size.height, 36 + world.host->preferredHeight());
}

TEST_F(WidgetWindowTest, ShrinksBeforeTheWindowDoes) {
    WindowWorld world;
    world.show();
    world.expand();
    EXPECT_EQ(world.window->frame().size.height, 366);
    world.click(Button);
    EXPECT_EQ(world.window->frame().size.height, 366);
    world.finish();
    EXPECT_EQ(world.window->frame().size.height, 146);
}

TEST_F(WidgetWindowTest, ChangesAtOnceWithReducedMotion) {
    WindowWorld world;
    world.show();
    world.window->setTraits({.reducesMotion = true});
    world.click(Button);
    EXPECT_FALSE(world.window->isChangingSize());
    EXPECT_EQ(world.window->frame().size.height, 366);
}

TEST_F(WidgetWindowTest, TurnsRoundInTheMiddle) {
    WindowWorld world;
    world.show();
    world.click(Button);
    world.monotonic->advance(0.1);
    world.settle();
    world.click(Button);
    EXPECT_EQ(world.host->displayMode(), Mode::Compact);
    world.finish();
    EXPECT_FALSE(world.window->isChangingSize());
    EXPECT_EQ(world.window->frame().size.height, 146);
}

TEST_F(WidgetWindowTest, MovesUpWhereItWouldLeaveTheScreen) {
    WindowWorld world;
    world.show();
    const auto screen = world.toolkitWindow().screen()->availableGeometry();
    world.toolkitWindow().setPosition(40, screen.height() - 150);
    world.expand();
    EXPECT_EQ(world.window->frame(),
              (CGRect{{40, static_cast<CGFloat>(screen.height() - 366)}, {359, 366}}));
}

TEST_F(WidgetWindowTest, WhatIsHigherThanTheScreenScrolls) {
    WindowWorld world;
    world.widget->rows.assign(20, "row");
    world.show();
    world.expand();
    const auto screen = world.toolkitWindow().screen()->availableGeometry();
    EXPECT_EQ(world.window->frame().size.height, screen.height());
    world.wheel({}, {0, -240});
    EXPECT_EQ(world.widget->table->contentOffset().y, 96) << "two notches";
    world.wheel({0, 30}, {0, 240});
    EXPECT_EQ(world.widget->table->contentOffset().y, 66) << "pixels are exact";
}

TEST_F(WidgetWindowTest, StandsAtTheTopOfALargerWindow) {
    WindowWorld world;
    world.show();
    world.toolkitWindow().resize(800, 600);
    world.settle();
    const auto ground = QColor("#f4f4f6");
    EXPECT_EQ(world.window->card()->frame().size, (CGSize{359, 146}));
    EXPECT_EQ(world.colorAt({400, 3}), ground);
    EXPECT_NE(world.colorAt({215, 70}), ground) << "left of the card one looks through";
    EXPECT_EQ(world.colorAt({225, 70}), ground);
    EXPECT_EQ(world.colorAt({574, 70}), ground);
    EXPECT_NE(world.colorAt({584, 70}), ground);
    EXPECT_NE(world.colorAt({400, 150}), ground);
    world.click({FirstRow.x() + 220, FirstRow.y()});
    EXPECT_THAT(world.widget->pressed, ElementsAre("red"));
}

TEST_F(WidgetWindowTest, RowsAreLaidOutInALargerWindow) {
    WindowWorld world;
    world.show();
    world.host->setDisplayMode(Mode::Expanded);
    world.toolkitWindow().resize(800, 600); // the desktop does not do what it was asked
    world.finish();
    world.toolkitWindow().resize(800, 600);
    world.settle();
    EXPECT_EQ(world.window->card()->frame().size, (CGSize{359, 366}));
    world.click({FirstRow.x() + 220, FirstRow.y() + 220});
    EXPECT_THAT(world.widget->pressed, ElementsAre("blue"));
    EXPECT_EQ(world.colorAt({225, 300}), QColor("#f4f4f6"));
}

TEST_F(WidgetWindowTest, ScrollsInASmallerWindow) {
    WindowWorld world;
    world.show();
    world.expand();
    world.toolkitWindow().resize(300, 200);
    world.settle();
    EXPECT_EQ(world.window->card()->frame().size, (CGSize{300, 200}));
    world.wheel({0, -500}, {0, -120});
    EXPECT_EQ(world.widget->table->contentOffset().y, 330 - 164);
    world.click({100, 190});
    EXPECT_THAT(world.widget->pressed, ElementsAre("blue"));
    world.click({270, 18});
    EXPECT_EQ(world.host->displayMode(), Mode::Compact) << "the button is there";
    world.finish();
    EXPECT_EQ(world.window->frame().size, (CGSize{359, 146})) << "asked for anew";
    EXPECT_EQ(world.window->card()->frame().size, (CGSize{359, 146}));
}

TEST_F(WidgetWindowTest, ChangesAtOnceWhereNobodySeesIt) {
    WindowWorld world;
    world.show();
    world.window->hide();
    world.settle();
    world.host->setDisplayMode(Mode::Expanded);
    EXPECT_FALSE(world.window->isChangingSize());
    EXPECT_EQ(world.window->frame().size.height, 366);
    EXPECT_TRUE(RunLoop::main().runUntil(
        [&] { return world.widget->table->visibleCells().size() == 3; }, 20))
        << "assistive tools may look";
}

TEST_F(WidgetWindowTest, ChangeUnderWayEndsWhenTheWindowIsHidden) {
    WindowWorld world;
    world.show();
    world.click(Button);
    EXPECT_TRUE(world.window->isChangingSize());
    world.window->hide();
    world.settle();
    EXPECT_FALSE(world.window->isChangingSize());
    EXPECT_EQ(world.window->frame().size.height, 366);
}

TEST_F(WidgetWindowTest, ClicksOpenRows) {
    WindowWorld world;
    world.show();
    world.click(FirstRow);
    EXPECT_THAT(world.widget->pressed, ElementsAre("red"));
    world.mouse(QEvent::MouseButtonPress, FirstRow, Qt::RightButton);
    world.mouse(QEvent::MouseButtonRelease, FirstRow, Qt::RightButton);
    EXPECT_THAT(world.widget->pressed, ElementsAre("red"));
}

TEST_F(WidgetWindowTest, ShowsAWidgetThatBegan) {
    WindowWorld world;
    world.show();
    const auto frames = world.window->framesShown();
    const auto old = std::exchange(world.widget, std::make_shared<testing::TableWidget>());
    world.widget->rows = {"rot"};
    world.host->startWidgetAnew();
    world.settle();
    EXPECT_GT(world.window->framesShown(), frames);
    EXPECT_EQ(world.window->frame().size, (CGSize{359, 146}));
    world.click(FirstRow);
    EXPECT_THAT(world.widget->pressed, ElementsAre("rot"));
    EXPECT_THAT(old->pressed, IsEmpty());
}

TEST_F(WidgetWindowTest, PointerTellsWhatCanBePressed) {
    WindowWorld world;
    world.show();
    world.mouse(QEvent::MouseMove, FirstRow, Qt::NoButton);
    EXPECT_EQ(world.toolkitWindow().cursor().shape(), Qt::PointingHandCursor);
    world.mouse(QEvent::MouseMove, {100, 18}, Qt::NoButton);
    EXPECT_EQ(world.toolkitWindow().cursor().shape(), Qt::ArrowCursor);
}

TEST_F(WidgetWindowTest, KeysDoWhatAPointerDoes) {
    WindowWorld world;
    world.show();
    world.key(Qt::Key_Tab);
    world.key(Qt::Key_Return);
    EXPECT_THAT(world.widget->pressed, ElementsAre("red"));
    world.key(Qt::Key_Tab);
    world.key(Qt::Key_Space);
    EXPECT_EQ(world.host->displayMode(), Mode::Expanded);
    world.key(Qt::Key_Escape);
    EXPECT_EQ(world.host->displayMode(), Mode::Compact);
    world.key(Qt::Key_Escape);
    EXPECT_FALSE(world.toolkitWindow().isVisible());
}

TEST_F(WidgetWindowTest, ControlAndWClose) {
    WindowWorld world;
    world.show();
    world.key(Qt::Key_W);
    EXPECT_TRUE(world.toolkitWindow().isVisible());
    world.key(Qt::Key_W, Qt::ControlModifier);
    EXPECT_FALSE(world.toolkitWindow().isVisible());
}

TEST_F(WidgetWindowTest, FollowsTheDesktopsLooks) {
    WindowWorld world;
    world.show();
    const QPoint ground(180, 3);
    EXPECT_EQ(world.colorAt(ground).name(), "#f4f4f6");
    world.window->setTraits({.userInterfaceStyle = UIUserInterfaceStyle::Dark});
    world.settle();
    EXPECT_EQ(world.colorAt(ground).name(), "#1e1e22");
    world.window->setTraits({.userInterfaceStyle = UIUserInterfaceStyle::Dark,
                             .accessibilityContrast = UIAccessibilityContrast::High});
    world.settle();
    EXPECT_EQ(world.colorAt(ground).name(), "#000000");
    EXPECT_EQ(world.colorAt({180, 0}).name(), "#ffffff") << "a border of one pixel";
}

TEST_F(WidgetWindowTest, LargerTextIsALargerCard) {
    WindowWorld world;
    world.widget->rows = {"red"};
    world.show();
    EXPECT_EQ(world.host->maximumSizeForDisplayMode(Mode::Compact).height, 110);
    world.window->setTraits(
        {.preferredContentSizeCategory = UIContentSizeCategory::AX1, .displayScale = 3});
    EXPECT_GT(world.host->maximumSizeForDisplayMode(Mode::Compact).height, 110);
    EXPECT_EQ(UITraitCollection::system().get().displayScale, 1) << "that of the screen";
}

/// In a process of its own, or after the other tests: the scale is read when the application
/// begins.
TEST(WidgetWindowScale, FractionalScalesAreDrawnInFull) {
    if (QCoreApplication::instance())
        GTEST_SKIP() << "another test has made the application object";
    setenv("QT_SCALE_FACTOR", "1.25", 1);
    ASSERT_TRUE(testing::haveGraphicalApplication());
    WindowWorld world;
    world.show();
    EXPECT_EQ(UITraitCollection::system().get().displayScale, 1.25);
    EXPECT_EQ(world.window->frame().size, (CGSize{359, 146}));
    EXPECT_EQ(world.colorAt({358, 145}).name(), "#f4f4f6") << "in pixels of the screen";
    world.expand();
    EXPECT_EQ(world.window->frame().size.height, 366);
}

} // namespace
} // namespace orvo
