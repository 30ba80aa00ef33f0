#include "platform/extension/_HeldWidget.h"

#include "platform/extension/ScriptedWidget.h"
#include "platform/extension/_WidgetContext.h"
#include "platform/uikit/table/UIScrollView.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Strings = std::vector<std::string>;

class HeldWidgetTest : public ::testing::Test, protected testing::HostWorld {
protected:
    static std::shared_ptr<_WidgetContext> contextWithMaxima() {
        auto context = _WidgetContext::contextWithApplicationIdentifier("a.map");
        context->setMaxima({300, 100}, {300, 500});
        return context;
    }
    void load() { held.load({300, 100}, {0, 8, 0, 8}); }

    std::shared_ptr<_WidgetContext> context = contextWithMaxima();
    int preferred = 0;
    _HeldWidget held{widget, context, [this] {
                         ++preferred;
                     }};
};

TEST_F(HeldWidgetTest, HearsItsWidthAndMarginsThenItsMode) {
    EXPECT_FALSE(held.isLoaded());
    EXPECT_EQ(widget->extensionContext(), context);
    load();
    EXPECT_TRUE(held.isLoaded());
    EXPECT_EQ(widget->taken(),
              (Strings{"load 300×100, margins 8 8", "mode 0 at most 300×100, active 0"}));
    context->setActiveMode(testing::Mode::Expanded);
    held.tellMode();
    EXPECT_EQ(widget->taken(), Strings{"mode 1 at most 300×500, active 1"});
}

TEST_F(HeldWidgetTest, ItsHeightIsKnownOnceItHasSaidIt) {
    EXPECT_EQ(held.preferredHeight(), std::nullopt);
    load();
    EXPECT_EQ(held.preferredHeight(), 100);
    EXPECT_EQ(preferred, 1);
    widget->setPreferredContentSize({300, -20});
    EXPECT_EQ(held.preferredHeight(), 0) << "never below the top";
    EXPECT_EQ(preferred, 2);
}

TEST_F(HeldWidgetTest, EndsOnceAndIsNoMoreHeard) {
    held.appear();
    held.end();
    held.end();
    EXPECT_EQ(widget->taken(),
              (Strings{"will appear", "did appear", "will disappear", "did disappear"}));
    widget->setPreferredContentSize({300, 50});
    EXPECT_EQ(preferred, 0);
}

TEST_F(HeldWidgetTest, AHiddenOneDoesNotDisappearAtItsEnd) {
    held.appear();
    held.disappear();
    widget->taken();
    held.end();
    EXPECT_EQ(widget->taken(), Strings{});
}

TEST_F(HeldWidgetTest, ItsContentsReachAsFarAsTheyAreOrCanBeScrolled) {
    load();
    const auto plain = UIView::initWithFrame({{0, 20}, {300, 40}});
    widget->view()->addSubview(plain);
    EXPECT_EQ(held.heightOfContentsWithin(500), 60);
    const auto scrolling = UIScrollView::initWithFrame({{0, 10}, {300, 50}});
    scrolling->setContentSize({300, 400});
    widget->view()->addSubview(scrolling);
    EXPECT_EQ(held.heightOfContentsWithin(500), 410);
    EXPECT_EQ(widget->view()->frame(), CGRect({0, 0}, {300, 100})) << "as it was";
}

/// Notes the height that its view has when it is laid out.
class NotingView final : public UIView {
public:
    void layoutSubviews() override { heights.push_back(bounds().size.height); }
    std::vector<double> heights;
};

TEST_F(HeldWidgetTest, ContentsAreLaidOutInTheHeightThatIsAskedFor) {
    load();
    const auto noting = std::make_shared<NotingView>();
    widget->setView(noting);
    (void)held.heightOfContentsWithin(321);
    EXPECT_EQ(noting->heights, std::vector<double>{321});
}

TEST_F(HeldWidgetTest, AControllerThatProvidesNothingHasNothingNew) {
    _HeldWidget bare(
        UIViewController::initWithNibName_bundle(std::nullopt, nullptr), context, [] {});
    bare.load({300, 100}, {});
    bare.tellMode();
    std::optional<NCUpdateResult> answer;
    bare.requestUpdate([&](NCUpdateResult result) { answer = result; });
    bare.requestUpdate({});
    EXPECT_EQ(answer, std::nullopt) << "never inside the call";
    turn();
    EXPECT_EQ(answer, NCUpdateResult::NoData);
    EXPECT_EQ(bare.preferredHeight(), std::nullopt);
}

TEST_F(HeldWidgetTest, UpdatesAreAskedOfTheWidget) {
    std::optional<NCUpdateResult> answer;
    held.requestUpdate([&](NCUpdateResult result) { answer = result; });
    EXPECT_EQ(widget->taken(), Strings{"update"});
    widget->answer(NCUpdateResult::Failed);
    EXPECT_EQ(answer, NCUpdateResult::Failed);
}

/// Notes that it heard of other traits.
class TraitView final : public UIView {
public:
    void traitCollectionDidChange(const UITraitCollection&) override { ++told; }
    int told = 0;
};

TEST_F(HeldWidgetTest, TheViewsAroundItHearOfOtherTraitsToo) {
    const UITraitCollection earlier{.displayScale = 7};
    held.traitsDidChange(earlier);
    EXPECT_FALSE(held.isLoaded());
    load();
    const auto around = std::make_shared<TraitView>();
    around->addSubview(widget->view());
    held.traitsDidChange(earlier);
    EXPECT_EQ(around->told, 1);
}

} // namespace
} // namespace orvo
