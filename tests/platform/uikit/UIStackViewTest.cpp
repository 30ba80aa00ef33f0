#include "platform/uikit/UIStackView.h"

#include "ViewTest.h"

namespace orvo {
namespace {

class StackTest : public testing::ViewTest {
protected:
    std::shared_ptr<UIStackView> stackIn(const std::shared_ptr<UIView>& card,
                                         UILayoutConstraintAxis axis) {
        const auto stack = constrained(UIStackView::init(), card, "stack");
        stack->setAxis(axis);
        pin(stack, card);
        return stack;
    }
    std::shared_ptr<UIView>
    arranged(const std::shared_ptr<UIStackView>& stack, const std::string& name, CGFloat length) {
        const auto view = constrained(UIView::init(), nullptr, name);
        stack->addArrangedSubview(view);
        const auto side = stack->axis() == UILayoutConstraintAxis::Vertical ? view->heightAnchor()
                                                                            : view->widthAnchor();
        activate({side.constraintEqualToConstant(length)});
        return view;
    }
    /// At 10 points: 10 high, baseline at 8.
    std::shared_ptr<UILabel> arrangedLabel(const std::shared_ptr<UIStackView>& stack,
                                           const std::string& name) {
        const auto made = label(nullptr, name, name);
        stack->addArrangedSubview(made);
        return made;
    }
    std::shared_ptr<UIView> column() {
        const auto card = root(100, 100);
        const auto stack = constrained(UIStackView::init(), card, "stack");
        stack->setAxis(UILayoutConstraintAxis::Vertical);
        place(stack, 0, 0);
        activate({stack->widthAnchor().constraintEqualToConstant(100)});
        return card;
    }
    static std::shared_ptr<UIStackView> stackOf(const std::shared_ptr<UIView>& card) {
        return std::dynamic_pointer_cast<UIStackView>(card->subviews().front());
    }
};

TEST_F(StackTest, ColumnPutsViewsBelowOneAnotherAcrossItsWidth) {
    const auto card = column();
    const auto stack = stackOf(card);
    stack->setSpacing(4);
    arranged(stack, "a", 10);
    arranged(stack, "b", 20);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 100 100
  stack 0 0 100 34
    a 0 0 100 10
    b 0 14 100 20
)");
}

TEST_F(StackTest, RowPutsViewsBesideOneAnotherWhereReadingStarts) {
    const auto card = root(100, 20);
    const auto stack = stackIn(card, UILayoutConstraintAxis::Horizontal);
    stack->setSpacing(5);
    arranged(stack, "a", 30);
    const auto rest = constrained(UIView::init(), nullptr, "rest");
    stack->addArrangedSubview(rest);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 100 20
  stack 0 0 100 20
    a 0 0 30 20
    rest 35 0 65 20
)");
    card->setTraitCollection(
        UITraitCollection{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 100 20
  stack 0 0 100 20
    a 70 0 30 20
    rest 0 0 65 20
)");
}

TEST_F(StackTest, BaselineRelativeSpacingIsFromBaselineToBaseline) {
    const auto card = column();
    const auto stack = stackOf(card);
    stack->setBaselineRelativeArrangement(true);
    stack->setSpacing(21);
    arrangedLabel(stack, "a");
    arrangedLabel(stack, "b");
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 100 100
  stack 0 0 100 31
    a 0 0 100 10 "a"
    b 0 21 100 10 "b"
)");
}

TEST_F(StackTest, BaselineRelativeViewWithoutTextStandsOnItsBottom) {
    const auto card = column();
    const auto stack = stackOf(card);
    stack->setBaselineRelativeArrangement(true);
    stack->setSpacing(35);
    arrangedLabel(stack, "title");
    arranged(stack, "shields", 28);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 100 100
  stack 0 0 100 43
    title 0 0 100 10 "title"
    shields 0 15 100 28
)");
}

TEST_F(StackTest, SpacingChangesWithoutARebuild) {
    const auto card = column();
    const auto stack = stackOf(card);
    arranged(stack, "a", 10);
    const auto b = arranged(stack, "b", 10);
    layout(card);
    const auto before = stack->_ownConstraints();
    stack->setSpacing(7);
    layout(card);
    EXPECT_EQ(frameOf(b).origin.y, 17);
    EXPECT_EQ(stack->_ownConstraints(), before);
}

TEST_F(StackTest, HiddenViewIsLeftOutWithItsSpacing) {
    const auto card = column();
    const auto stack = stackOf(card);
    stack->setSpacing(4);
    arranged(stack, "a", 10);
    const auto middle = arrangedLabel(stack, "b");
    arranged(stack, "c", 10);
    middle->setHidden(true);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 100 100
  stack 0 0 100 24
    a 0 0 100 10
    b 0 0 100 0 hidden
    c 0 14 100 10
)");
    middle->setHidden(false);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 100 100
  stack 0 0 100 38
    a 0 0 100 10
    b 0 14 100 10 "b"
    c 0 28 100 10
)");
    EXPECT_TRUE(log.messages().empty());
}

/// Shows another view in its place, as an effect view does.
class Wrapper : public UIView {
public:
    std::shared_ptr<UIView> wrapped;
    std::shared_ptr<UIView> viewForFirstBaselineLayout() override { return wrapped; }
    std::shared_ptr<UIView> viewForLastBaselineLayout() override { return wrapped; }
};

TEST_F(StackTest, ViewThatShowsAHiddenOneIsLeftOut) {
    const auto card = column();
    const auto stack = stackOf(card);
    stack->setBaselineRelativeArrangement(true);
    stack->setSpacing(21);
    arrangedLabel(stack, "title");
    const auto wrapper = constrained(std::make_shared<Wrapper>(), nullptr, "wrapper");
    wrapper->wrapped = label(wrapper, "text", "text");
    pin(wrapper->wrapped, wrapper);
    stack->addArrangedSubview(wrapper);
    layout(card);
    EXPECT_EQ(frameOf(stack).size.height, 31);
    wrapper->wrapped->setHidden(true);
    layout(card);
    EXPECT_EQ(frameOf(stack).size.height, 10);
    EXPECT_EQ(stack->viewForLastBaselineLayout()->identifier(), "title");
    wrapper->wrapped->setHidden(false);
    layout(card);
    EXPECT_EQ(frameOf(stack).size.height, 31);
    EXPECT_TRUE(log.messages().empty());
}

TEST_F(StackTest, BaselinesGoThroughAWrappingView) {
    const auto card = root(100, 100);
    const auto wrapper = constrained(std::make_shared<Wrapper>(), card, "wrapper");
    wrapper->wrapped = label(wrapper, "text", "text");
    pin(wrapper->wrapped, wrapper);
    activate(
        {wrapper->firstBaselineAnchor().constraintEqualToAnchor_constant(card->topAnchor(), 50),
         wrapper->leadingAnchor().constraintEqualToAnchor(card->leadingAnchor())});
    layout(card);
    EXPECT_EQ(frameOf(wrapper).origin.y, 42);
}

TEST_F(StackTest, BaselinesOfAColumnAreThoseOfItsFirstAndLastShownView) {
    const auto card = column();
    const auto stack = stackOf(card);
    const auto mark = child(card, "mark");
    arrangedLabel(stack, "a");
    const auto last = arrangedLabel(stack, "b");
    activate({mark->topAnchor().constraintEqualToAnchor(stack->lastBaselineAnchor())});
    layout(card);
    EXPECT_EQ(frameOf(mark).origin.y, 18);
    last->setHidden(true);
    layout(card);
    EXPECT_EQ(frameOf(mark).origin.y, 8);
}

TEST_F(StackTest, StackWithoutShownViewsHasNoLengthOfItsOwn) {
    const auto card = column();
    const auto stack = stackOf(card);
    const auto only = arrangedLabel(stack, "a");
    layout(card);
    only->setHidden(true);
    layout(card);
    EXPECT_EQ(frameOf(stack).size.height, 0);
    EXPECT_EQ(stack->viewForFirstBaselineLayout(), stack);
    EXPECT_TRUE(log.messages().empty());
}

TEST_F(StackTest, RemovedViewIsArrangedNoMore) {
    const auto card = column();
    const auto stack = stackOf(card);
    const auto a = arranged(stack, "a", 10);
    const auto b = arranged(stack, "b", 10);
    layout(card);
    a->removeFromSuperview();
    EXPECT_EQ(stack->arrangedSubviews(), std::vector{b});
    layout(card);
    EXPECT_EQ(frameOf(b).origin.y, 0);
}

TEST_F(StackTest, AddingAnArrangedViewAgainMovesItToTheEnd) {
    const auto card = column();
    const auto stack = stackOf(card);
    const auto a = arranged(stack, "a", 10);
    const auto b = arranged(stack, "b", 10);
    stack->addArrangedSubview(a);
    layout(card);
    EXPECT_EQ(stack->arrangedSubviews(), (std::vector{b, a}));
    EXPECT_EQ(frameOf(a).origin.y, 10);
}

TEST_F(StackTest, FillEquallySharesTheLength) {
    const auto card = root(100, 20);
    const auto stack = stackIn(card, UILayoutConstraintAxis::Horizontal);
    stack->setDistribution(UIStackViewDistribution::FillEqually);
    stack->setSpacing(10);
    const auto first = label(nullptr, "a", "a");
    const auto second = label(nullptr, "b", "bbbb");
    stack->addArrangedSubview(first);
    stack->addArrangedSubview(second);
    layout(card);
    EXPECT_EQ(frameOf(first).size.width, 45);
    EXPECT_EQ(frameOf(second).size.width, 45);
}

TEST_F(StackTest, AlignmentAcrossARow) {
    const auto across = [this](UIStackViewAlignment alignment) {
        const auto card = root(100, 40);
        const auto stack = stackIn(card, UILayoutConstraintAxis::Horizontal);
        stack->setAlignment(alignment);
        const auto small = label(nullptr, "a", "a");
        const auto large = label(nullptr, "b", "b", 20);
        stack->addArrangedSubview(large);
        stack->addArrangedSubview(small);
        layout(card);
        return frameOf(small).origin.y;
    };
    EXPECT_EQ(across(UIStackViewAlignment::Leading), 0);
    EXPECT_EQ(across(UIStackViewAlignment::Center), 15);
    EXPECT_EQ(across(UIStackViewAlignment::Trailing), 30);
    EXPECT_EQ(across(UIStackViewAlignment::FirstBaseline), 8); // 16 - 8 below the large one's top
    EXPECT_EQ(across(UIStackViewAlignment::Fill), 0);
}

TEST_F(StackTest, ConstraintsOfAStackAreInTheDump) {
    const auto card = column();
    const auto stack = stackOf(card);
    stack->setBaselineRelativeArrangement(true);
    stack->setSpacing(21);
    arrangedLabel(stack, "a");
    arrangedLabel(stack, "b");
    EXPECT_EQ(dumpConstraints(*card), R"(stack.leading == UIView1.leading
stack.top == UIView1.top
stack.width == 100
a.top == stack.top
a.leading == stack.leading
a.trailing == stack.trailing
b.firstBaseline == a.lastBaseline + 21
b.leading == stack.leading
b.trailing == stack.trailing
b.bottom == stack.bottom
)");
}

} // namespace
} // namespace orvo
