#include "platform/uikit/UIView.h"

#include "ViewTest.h"
#include "platform/foundation/Exceptions.h"

namespace orvo {
namespace {

using ViewTest = testing::ViewTest;

TEST_F(ViewTest, SubviewsStandFromBackToFront) {
    const auto card = root(10, 10);
    const auto a = child(card, "a");
    const auto b = child(card, "b");
    const auto c = UIView::init();
    card->insertSubview_atIndex(c, 1);
    EXPECT_EQ(card->subviews(), (std::vector{a, c, b}));
    card->addSubview(a);
    EXPECT_EQ(card->subviews(), (std::vector{c, b, a}));
    card->insertSubview_atIndex(c, 99);
    EXPECT_EQ(card->subviews(), (std::vector{b, a, c}));
}

TEST_F(ViewTest, ViewLeavesItsEarlierSuperview) {
    const auto first = root(10, 10);
    const auto second = root(10, 10);
    const auto box = child(first, "box");
    second->addSubview(box);
    EXPECT_TRUE(first->subviews().empty());
    EXPECT_EQ(box->superview(), second);
    EXPECT_TRUE(box->isDescendantOfView(*second));
    EXPECT_FALSE(box->isDescendantOfView(*first));
}

TEST_F(ViewTest, CirclesAndNilCannotBeAdded) {
    const auto card = root(10, 10);
    const auto box = child(card, "box");
    EXPECT_THROW(box->addSubview(card), NSInvalidArgumentException);
    EXPECT_THROW(box->addSubview(box), NSInvalidArgumentException);
    EXPECT_THROW(box->addSubview(nullptr), NSInvalidArgumentException);
}

TEST_F(ViewTest, SuperviewDoesNotOutliveItsOwner) {
    const auto box = UIView::init();
    root(10, 10)->addSubview(box);
    EXPECT_EQ(box->superview(), nullptr);
    EXPECT_EQ(box->traitCollection(), UITraitCollection());
}

TEST_F(ViewTest, PointsConvertThroughFramesAndScrolledBounds) {
    const auto card = root(100, 100);
    const auto scroller = UIView::initWithFrame({{10, 20}, {50, 50}});
    card->addSubview(scroller);
    const auto inner = UIView::initWithFrame({{5, 100}, {10, 10}});
    scroller->addSubview(inner);
    scroller->setBounds({{0, 80}, {50, 50}});
    EXPECT_EQ(inner->convertPoint_toView({1, 2}, *card), (CGPoint{16, 42}));
    EXPECT_EQ(card->convertPoint_toView({16, 42}, *inner), (CGPoint{1, 2}));
    EXPECT_EQ(scroller->bounds(), (CGRect{{0, 80}, {50, 50}}));
    EXPECT_EQ(scroller->frame(), (CGRect{{10, 20}, {50, 50}}));
}

/// Counts its layouts and asks for the next `again` times.
class Counter : public UIView {
public:
    int layouts = 0;
    int again = 0;
    void layoutSubviews() override {
        UIView::layoutSubviews();
        ++layouts;
        if (again-- > 0)
            setNeedsLayout();
    }
};

TEST_F(ViewTest, OnlyWhatNeedsItIsLaidOut) {
    const auto card = root(10, 10);
    const auto first = std::make_shared<Counter>();
    const auto second = std::make_shared<Counter>();
    card->addSubview(first);
    card->addSubview(second);
    card->layoutIfNeeded();
    EXPECT_EQ(first->layouts, 1);
    first->setNeedsLayout();
    card->layoutIfNeeded();
    EXPECT_EQ(first->layouts, 2);
    EXPECT_EQ(second->layouts, 1);
    card->layoutIfNeeded();
    EXPECT_EQ(first->layouts, 2);
}

TEST_F(ViewTest, LayoutGoesOnUntilNothingNeedsIt) {
    const auto view = std::make_shared<Counter>();
    view->again = 3;
    view->layoutIfNeeded();
    EXPECT_EQ(view->layouts, 4);
    EXPECT_TRUE(log.messages().empty());
}

TEST_F(ViewTest, LayoutThatNeverSettlesEndsAndIsTold) {
    const auto view = std::make_shared<Counter>();
    view->setIdentifier("restless");
    view->again = 1000;
    view->layoutIfNeeded();
    EXPECT_LT(view->layouts, 20);
    EXPECT_EQ(log.messages(), std::vector<std::string>{"The layout of restless does not settle"});
}

TEST_F(ViewTest, ChangedSizeAsksForLayoutAMoveDoesNot) {
    const auto view = std::make_shared<Counter>();
    view->layoutIfNeeded();
    view->setFrame({{5, 5}, {10, 10}});
    EXPECT_TRUE(view->needsLayout());
    view->layoutIfNeeded();
    EXPECT_EQ(view->layouts, 2);
}

TEST_F(ViewTest, DumpTellsWhatIsNotAsUsual) {
    const auto card = root(100, 50);
    const auto text = label(card, "text", "hello");
    text->setAlpha(0.5);
    text->setFrame({{1.5, 2}, {25, 10}});
    const auto hidden = UIView::initWithFrame({{0, 0}, {5, 5}});
    hidden->setHidden(true);
    card->addSubview(hidden);
    EXPECT_EQ(dumpViews(*card), R"(UIView1 0 0 100 50
  text 1.5 2 25 10 alpha 0.5 "hello"
  UIView2 0 0 5 5 hidden
)");
}

} // namespace
} // namespace orvo
