#include "presentation/VisualEffectWrappingView.h"

#include "platform/uikit/UIFont.h"
#include "platform/uikit/UILabel.h"
#include "platform/uikit/UIStackView.h"
#include "platform/uikit/ViewDumps.h"
#include "support/FixedTextMeasurer.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

class VisualEffectWrappingViewTest : public ::testing::Test {
protected:
    static std::shared_ptr<VisualEffectWrappingView>
    wrapperOf(const std::shared_ptr<UIView>& view) {
        auto wrapper = VisualEffectWrappingView::initWithEffect(
            UIVibrancyEffect::widgetEffectForVibrancyStyle(101));
        wrapper->setIdentifier("wrapper");
        wrapper->setTranslatesAutoresizingMaskIntoConstraints(false);
        wrapper->setWrappedView(view);
        return wrapper;
    }
    static std::shared_ptr<UIView> named(const char* name) {
        auto view = UIView::init();
        view->setIdentifier(name);
        return view;
    }
    /// At 10 points: 10 high, baseline at 8.
    static std::shared_ptr<UILabel> label(const std::string& text) {
        auto label = UILabel::init();
        label->setIdentifier(text);
        label->setFont(UIFont::systemFontOfSize_weight(10, 400));
        label->setText(text);
        return label;
    }

private:
    EnvironmentSlot<std::shared_ptr<TextMeasurer>>::Override _measurer =
        TextMeasurer::shared().overrideWith(std::make_shared<testing::FixedTextMeasurer>());
};

TEST_F(VisualEffectWrappingViewTest, WrapsNothingAtFirst) {
    const auto effect = UIVibrancyEffect::widgetEffectForVibrancyStyle(102);
    const auto wrapper = VisualEffectWrappingView::initWithEffect(effect);
    EXPECT_EQ(wrapper->effect(), effect);
    EXPECT_EQ(wrapper->wrappedView(), nullptr);
    EXPECT_EQ(wrapper->viewForFirstBaselineLayout(), nullptr);
    EXPECT_EQ(wrapper->viewForLastBaselineLayout(), nullptr);
}

TEST_F(VisualEffectWrappingViewTest, PinsTheViewInItsContentViewToItself) {
    const auto view = named("view");
    const auto wrapper = wrapperOf(view);
    EXPECT_EQ(wrapper->wrappedView(), view);
    EXPECT_EQ(view->superview(), wrapper->contentView());
    EXPECT_FALSE(view->translatesAutoresizingMaskIntoConstraints());
    EXPECT_EQ("\n" + dumpConstraints(*wrapper), R"(
view.leading == wrapper.leading
view.trailing == wrapper.trailing
view.top == wrapper.top
view.bottom == wrapper.bottom
)");
    ASSERT_EQ(wrapper->constraints().size(), 4U);
    for (const auto& constraint : wrapper->constraints())
        EXPECT_EQ(constraint->secondItem(), wrapper);
}

TEST_F(VisualEffectWrappingViewTest, TheSameViewAgainDoesNothing) {
    const auto view = named("view");
    const auto wrapper = wrapperOf(view);
    const auto before = wrapper->constraints();
    wrapper->setWrappedView(view);
    EXPECT_EQ(wrapper->constraints(), before);

    const auto elsewhere = named("elsewhere");
    elsewhere->addSubview(view);
    wrapper->setWrappedView(view);
    EXPECT_EQ(view->superview(), elsewhere);
}

TEST_F(VisualEffectWrappingViewTest, AnotherViewTakesTheFirstOnesPlace) {
    const auto first = named("first");
    const auto second = named("second");
    const auto wrapper = wrapperOf(first);
    wrapper->setWrappedView(second);
    EXPECT_EQ(first->superview(), nullptr);
    EXPECT_EQ(wrapper->contentView()->subviews(), (std::vector<std::shared_ptr<UIView>>{second}));
    EXPECT_EQ("\n" + dumpConstraints(*wrapper), R"(
second.leading == wrapper.leading
second.trailing == wrapper.trailing
second.top == wrapper.top
second.bottom == wrapper.bottom
)");
}

TEST_F(VisualEffectWrappingViewTest, AViewThatWasMovedElsewhereStaysThere) {
    const auto first = named("first");
    const auto elsewhere = named("elsewhere");
    const auto wrapper = wrapperOf(first);
    elsewhere->addSubview(first);
    wrapper->setWrappedView(named("second"));
    EXPECT_EQ(first->superview(), elsewhere);
}

TEST_F(VisualEffectWrappingViewTest, NilTakesTheViewOutAndPutsNothingIn) {
    const auto view = named("view");
    const auto wrapper = wrapperOf(view);
    wrapper->setWrappedView(nullptr);
    EXPECT_EQ(wrapper->wrappedView(), nullptr);
    EXPECT_EQ(view->superview(), nullptr);
    EXPECT_TRUE(wrapper->contentView()->subviews().empty());
    EXPECT_EQ(dumpConstraints(*wrapper), "");
    wrapper->setWrappedView(nullptr);
    wrapper->setWrappedView(view);
    EXPECT_EQ(view->superview(), wrapper->contentView());
}

TEST_F(VisualEffectWrappingViewTest, BothBaselinesAreTheWrappedViews) {
    const auto view = named("view");
    const auto wrapper = wrapperOf(view);
    EXPECT_EQ(wrapper->viewForFirstBaselineLayout(), view);
    EXPECT_EQ(wrapper->viewForLastBaselineLayout(), view);
}

TEST_F(VisualEffectWrappingViewTest, AColumnSpacesTheBaselinesOfTheTextsInside) {
    const auto card = UIView::initWithFrame({{0, 0}, {100, 100}});
    const auto column = UIStackView::init();
    column->setAxis(UILayoutConstraintAxis::Vertical);
    column->setBaselineRelativeArrangement(true);
    column->setSpacing(21);
    column->setTranslatesAutoresizingMaskIntoConstraints(false);
    card->addSubview(column);
    const auto lower = label("lower");
    column->addArrangedSubview(wrapperOf(label("upper")));
    column->addArrangedSubview(wrapperOf(lower));
    NSLayoutConstraint::activateConstraints({
        column->topAnchor().constraintEqualToAnchor(card->topAnchor()),
        column->leadingAnchor().constraintEqualToAnchor(card->leadingAnchor()),
        column->trailingAnchor().constraintEqualToAnchor(card->trailingAnchor()),
    });
    card->layoutIfNeeded();
    EXPECT_EQ("\n" + dumpViews(*column), R"(
UIStackView1 0 0 100 31
  wrapper 0 0 100 10
    UIView1 0 0 100 10
      upper 0 0 100 10 "upper"
  wrapper 0 21 100 10
    UIView2 0 21 100 10
      lower 0 21 100 10 "lower"
)");
    lower->setHidden(true);
    card->layoutIfNeeded();
    EXPECT_EQ(column->frame().size.height, 10);
}

} // namespace
} // namespace orvo
