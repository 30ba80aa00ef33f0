#include "platform/uikit/table/UIScrollView.h"

#include "platform/uikit/ViewTest.h"

namespace orvo {
namespace {

class ScrollViewTest : public testing::ViewTest {
protected:
    std::shared_ptr<UIScrollView> scroll(CGSize content) {
        const auto view = UIScrollView::initWithFrame({{0, 0}, {100, 50}});
        view->setContentSize(content);
        return view;
    }
};

TEST_F(ScrollViewTest, OffsetStaysWithinTheContent) {
    const auto view = scroll({100, 120});
    view->setContentOffset({30, 500});
    EXPECT_EQ(view->contentOffset(), (CGPoint{0, 70}));
    view->setContentOffset({-5, -5});
    EXPECT_EQ(view->contentOffset(), (CGPoint{0, 0}));
}

TEST_F(ScrollViewTest, ContentThatFitsDoesNotScroll) {
    const auto view = scroll({100, 50});
    EXPECT_FALSE(view->scrollBy({10, 10}));
    EXPECT_EQ(view->contentOffset(), (CGPoint{0, 0}));
}

TEST_F(ScrollViewTest, WheelMovesUntilTheEndAndSaysSo) {
    const auto view = scroll({100, 120});
    EXPECT_TRUE(view->scrollBy({0, 60}));
    EXPECT_TRUE(view->scrollBy({0, 60}));
    EXPECT_EQ(view->contentOffset().y, 70);
    EXPECT_FALSE(view->scrollBy({0, 60}));
    EXPECT_TRUE(view->scrollBy({0, -1}));
}

TEST_F(ScrollViewTest, SmallerContentPullsTheOffsetBack) {
    const auto view = scroll({100, 120});
    view->setContentOffset({0, 70});
    view->setContentSize({100, 80});
    EXPECT_EQ(view->contentOffset().y, 30);
}

TEST_F(ScrollViewTest, LargerViewPullsTheOffsetBack) {
    const auto view = scroll({100, 120});
    view->setContentOffset({0, 70});
    view->setFrame({{0, 0}, {100, 110}});
    view->layoutIfNeeded();
    EXPECT_EQ(view->contentOffset().y, 10);
}

TEST_F(ScrollViewTest, RectanglesComeIntoSightByTheShortestWay) {
    const auto view = scroll({100, 300});
    view->scrollRectToVisible({{0, 100}, {10, 20}});
    EXPECT_EQ(view->contentOffset().y, 70);
    view->scrollRectToVisible({{0, 80}, {10, 20}});
    EXPECT_EQ(view->contentOffset().y, 70);
    view->scrollRectToVisible({{0, 60}, {10, 20}});
    EXPECT_EQ(view->contentOffset().y, 60);
    view->scrollRectToVisible({{0, 90}, {10, 80}});
    EXPECT_EQ(view->contentOffset().y, 90);
}

TEST_F(ScrollViewTest, WhatIsInsideMovesWithTheContent) {
    const auto view = scroll({100, 120});
    const auto inside = UIView::initWithFrame({{0, 60}, {10, 10}});
    view->addSubview(inside);
    view->setContentOffset({0, 20});
    const auto card = root(200, 200);
    card->addSubview(view);
    EXPECT_EQ(inside->convertPoint_toView({0, 0}, *card), (CGPoint{0, 40}));
}

} // namespace
} // namespace orvo
