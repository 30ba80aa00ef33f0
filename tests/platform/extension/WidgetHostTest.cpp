#include "platform/extension/WidgetHost.h"

#include "platform/extension/ScriptedWidget.h"
#include "platform/extension/_DisplayModeStore.h"
#include "platform/foundation/NSNotificationCenter.h"
#include "platform/uikit/table/UIScrollView.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using testing::Mode;
using Strings = std::vector<std::string>;

class WidgetHostTest : public ::testing::Test, protected testing::HostWorld {
protected:
    static UITraitCollection traits(UIContentSizeCategory category) {
        return {.preferredContentSizeCategory = category};
    }
    EnvironmentSlot<UITraitCollection>::Override system =
        UITraitCollection::system().overrideWith({});
};

TEST_F(WidgetHostTest, LoadsAtItsWidthThenTellsTheModeThenAppears) {
    const auto held = host();
    EXPECT_EQ(widget->calls, Strings{}) << "nothing is loaded before it is needed";
    held->setShown(true);
    EXPECT_EQ(widget->calls,
              (Strings{"load 359×110, margins 16 16",
                       "mode 0 at most 359×110, active 0",
                       "will appear",
                       "did appear",
                       "update"}));
}

TEST_F(WidgetHostTest, DisappearsWhenHiddenAndWhenLocked) {
    const auto held = host();
    held->setShown(true);
    widget->taken();
    held->setLocked(true);
    EXPECT_EQ(widget->taken(), (Strings{"will disappear", "did disappear"}));
    held->setShown(false);
    held->setShown(true);
    EXPECT_EQ(widget->taken(), Strings{}) << "the screen is still locked";
    held->setLocked(false);
    EXPECT_EQ(widget->taken(), (Strings{"will appear", "did appear", "update"}));
}

TEST_F(WidgetHostTest, AVisibleWidgetDisappearsBeforeItsHostGoes) {
    auto held = host();
    held->setShown(true);
    widget->taken();
    held = nullptr;
    EXPECT_EQ(widget->taken(), (Strings{"will disappear", "did disappear"}));
    EXPECT_NE(widget->extensionContext(), nullptr) << "it still gets answers";
    widget->offer();
}

TEST_F(WidgetHostTest, SeveralUpdatesRunAtOnceAndEachIsAnswered) {
    const auto held = host();
    std::vector<NCUpdateResult> answers;
    const auto note = [&](NCUpdateResult result) {
        answers.push_back(result);
    };
    held->requestUpdate(note);
    held->requestUpdate(note);
    EXPECT_EQ(widget->handlers.size(), 2U);
    widget->answer(NCUpdateResult::Failed);
    EXPECT_EQ(answers, (std::vector{NCUpdateResult::Failed, NCUpdateResult::Failed}));
}

TEST_F(WidgetHostTest, AnAnswerAfterTheHostHasGoneIsStillPassedOn) {
    auto held = host();
    bool answered = false;
    held->requestUpdate([&](NCUpdateResult) { answered = true; });
    held = nullptr;
    widget->answer(NCUpdateResult::NewData);
    EXPECT_TRUE(answered);
}

TEST_F(WidgetHostTest, MaximaFollowTheTextSizeInWholePoints) {
    const auto held = host();
    const auto maxima = [&](UIContentSizeCategory category) {
        held->setTraits(traits(category));
        return std::pair(held->maximumSizeForDisplayMode(Mode::Compact),
                         held->maximumSizeForDisplayMode(Mode::Expanded));
    };
    EXPECT_EQ(maxima(UIContentSizeCategory::L), std::pair(CGSize(359, 110), CGSize(359, 616)));
    EXPECT_EQ(maxima(UIContentSizeCategory::XS).first, CGSize(359, 91)) << "110 × 14 ÷ 17";
    EXPECT_EQ(maxima(UIContentSizeCategory::AX5).first, CGSize(359, 343)) << "110 × 53 ÷ 17";
    EXPECT_DOUBLE_EQ(maxima(UIContentSizeCategory::AX5).second.height, 5.6 * 343);
}

TEST_F(WidgetHostTest, TheExpandedMaximumIsTheFreeHeightUnlessRowsAreSaid) {
    const auto expanded = [&](const WidgetHostSettings& settings) {
        return host(settings)->maximumSizeForDisplayMode(Mode::Expanded);
    };
    EXPECT_EQ(expanded({.width = 300, .freeHeight = 700}), CGSize(300, 700));
    EXPECT_EQ(expanded({.freeHeight = 700, .maxRows = 3}), CGSize(359, 330));
    EXPECT_EQ(expanded({.maxRows = 0}), CGSize(359, 0)) << "no limit";
}

/// Notes what the maximum heights are whenever the text size is told.
class MaximaListener final : public NSObject {
public:
    [[nodiscard]] Method methodForSelector(const Selector&) override {
        return [this](const std::shared_ptr<NSObject>&) {
            seen.emplace_back(context->widgetMaximumSizeForDisplayMode(Mode::Compact).height,
                              context->widgetMaximumSizeForDisplayMode(Mode::Expanded).height);
            return nullptr;
        };
    }
    static std::shared_ptr<MaximaListener> listening(std::shared_ptr<NSExtensionContext> context) {
        auto listener = std::make_shared<MaximaListener>();
        listener->context = std::move(context);
        NSNotificationCenter::defaultCenter()->addObserver_selector_name_object(
            listener, Selector("changed"), UIContentSizeCategoryDidChangeNotification, nullptr);
        return listener;
    }

    std::shared_ptr<NSExtensionContext> context;
    std::vector<std::pair<double, double>> seen;
};

TEST_F(WidgetHostTest, MaximaChangeBeforeTheTextSizeIsPosted) {
    const auto held = host();
    const auto listener = MaximaListener::listening(widget->extensionContext());
    held->setTraits(traits(UIContentSizeCategory::XL));
    EXPECT_EQ(listener->seen, (std::vector{std::pair(123.0, 5.6 * 123)}));
}

TEST_F(WidgetHostTest, AnotherRowHeightIsToldBeforeAnotherNumberOfRows) {
    const auto held = host({.freeHeight = 1000});
    const auto listener = MaximaListener::listening(widget->extensionContext());
    held->setTraits(traits(UIContentSizeCategory::XL));
    EXPECT_EQ(listener->seen, (std::vector{std::pair(123.0, 9 * 123.0), std::pair(123.0, 1000.0)}));
    EXPECT_EQ(held->maximumSizeForDisplayMode(Mode::Expanded).height, 1000);
}

TEST_F(WidgetHostTest, ChangingTheModeIsOneChangeOfSizeToldBeforeItHappens) {
    const auto held = host();
    held->setShown(true);
    widget->taken();
    held->setDisplayMode(Mode::Expanded);
    EXPECT_EQ(widget->taken(),
              (Strings{"mode 1 at most 359×616, active 1", "to 359×330", "alongside", "done"}));
    EXPECT_EQ(held->contentSize(), CGSize(359, 330));
    EXPECT_EQ(held->view()->frame().size, CGSize(359, 330));
}

TEST_F(WidgetHostTest, AModeThatIsNotOfferedIsNotShown) {
    widget->largest = Mode::Compact;
    const auto held = host();
    held->setShown(true);
    held->setDisplayMode(Mode::Expanded);
    EXPECT_EQ(held->displayMode(), Mode::Compact);
}

TEST_F(WidgetHostTest, APresenterShowsTheChangeInItsOwnTime) {
    const auto held = host();
    const auto presenter = std::make_shared<testing::ScriptedPresenter>();
    held->setPresenter(presenter);
    held->setShown(true);
    EXPECT_EQ(presenter->modes, Strings{"compact, more"});
    held->setDisplayMode(Mode::Expanded);
    EXPECT_EQ(presenter->modes.back(), "expanded, more");
    EXPECT_EQ(presenter->sizes, std::vector{CGSize(359, 330)});
    EXPECT_EQ(widget->calls.back(), "to 359×330");
    EXPECT_EQ(held->view()->frame().size, CGSize(359, 110)) << "the presenter places it";
    presenter->begin();
    presenter->end();
    EXPECT_EQ(widget->calls.back(), "done");
}

TEST_F(WidgetHostTest, APreferredHeightIsCutAtTheScreensAndNotByRows) {
    const auto held = host({.freeHeight = 250, .maxRows = 0, .mode = Mode::Expanded});
    held->setShown(true);
    EXPECT_EQ(held->contentSize(), CGSize(359, 250));
    EXPECT_EQ(held->preferredHeight(), 330);
    held->setFreeHeight(std::nullopt);
    EXPECT_EQ(held->contentSize(), CGSize(359, 330));
}

TEST_F(WidgetHostTest, OnlyCompactOfferedChangesTheModeInTheNextTurn) {
    const auto held = host();
    held->setShown(true);
    held->setDisplayMode(Mode::Expanded);
    widget->taken();
    widget->largest = Mode::Compact;
    widget->joins = NCUpdateResult::NewData;
    widget->offer();
    widget->setPreferredContentSize({359, 0}); // no rows until the mode changes
    EXPECT_EQ(held->displayMode(), Mode::Expanded) << "never inside the call";
    EXPECT_EQ(held->contentSize(), CGSize(359, 330)) << "and does not collapse meanwhile";
    turn();
    EXPECT_EQ(held->displayMode(), Mode::Compact);
    EXPECT_EQ(held->contentSize(), CGSize(359, 110));
}

TEST_F(WidgetHostTest, TheChosenModeComesBackWhenItIsOfferedAgain) {
    const auto held = host();
    held->setShown(true);
    held->setDisplayMode(Mode::Expanded);
    widget->joins = NCUpdateResult::NewData;
    widget->largest = Mode::Compact;
    widget->offer();
    turn();
    widget->largest = Mode::Expanded;
    widget->offer();
    turn();
    EXPECT_EQ(held->displayMode(), Mode::Expanded);
}

TEST_F(WidgetHostTest, KeepsTheChosenModeBetweenStarts) {
    host()->setDisplayMode(Mode::Compact);
    {
        const auto held = host();
        held->setShown(true);
        held->setDisplayMode(Mode::Expanded);
    }
    widget = std::make_shared<testing::ScriptedWidget>();
    const auto held = host();
    held->setShown(true);
    EXPECT_EQ(widget->calls[1], "mode 1 at most 359×616, active 1");
    EXPECT_EQ(held->contentSize(), CGSize(359, 330));
}

TEST_F(WidgetHostTest, AModeFromTheSettingsIsNotKept) {
    const auto held = host({.mode = Mode::Compact});
    held->setShown(true);
    held->setDisplayMode(Mode::Expanded);
    EXPECT_EQ(_DisplayModeStore::load("a.widget"), std::nullopt);
}

TEST_F(WidgetHostTest, ASilentExpandedWidgetIsAsHighAsWhatItShows) {
    widget->silent = true;
    const auto held = host({.mode = Mode::Expanded});
    widget->loadView();
    const auto scrolling = UIScrollView::initWithFrame({{0, 10}, {300, 50}});
    scrolling->setContentSize({300, 400});
    widget->view()->addSubview(scrolling);
    EXPECT_EQ(held->preferredHeight(), 410);
}

TEST_F(WidgetHostTest, AnotherWidthIsATransition) {
    const auto held = host();
    held->setShown(true);
    widget->taken();
    held->setWidth(300);
    EXPECT_EQ(widget->calls[0], "to 300×110");
    EXPECT_EQ(held->maximumSizeForDisplayMode(Mode::Compact), CGSize(300, 110));
}

TEST_F(WidgetHostTest, TellsWheneverTheWidgetSaysSomethingOfItsContent) {
    const auto held = host();
    int told = 0;
    held->setContentTold([&] { ++told; });
    held->setShown(true);
    widget->offer();
    EXPECT_EQ(told, 2) << "also where nothing is another than before";
}

TEST_F(WidgetHostTest, ANewWidgetBeginsWhereTheOldOneEnds) {
    const auto held = host();
    const auto presenter = std::make_shared<testing::ScriptedPresenter>();
    held->setPresenter(presenter);
    held->setShown(true);
    held->setDisplayMode(Mode::Expanded);
    presenter->sizes.clear();
    auto old = std::exchange(widget, std::make_shared<testing::ScriptedWidget>());
    old->taken();
    widget->rows = 2;
    held->startWidgetAnew();
    EXPECT_EQ(old->calls, (Strings{"will disappear", "did disappear"}));
    EXPECT_EQ(widget->taken(),
              (Strings{"load 359×330, margins 16 16",
                       "mode 1 at most 359×616, active 1",
                       "to 359×220",
                       "will appear",
                       "did appear",
                       "update"}));
    EXPECT_EQ(held->controller(), widget);
    EXPECT_EQ(presenter->views, std::vector{widget->view()});
    EXPECT_EQ(presenter->sizes, std::vector{CGSize(359, 220)});
    old->setPreferredContentSize({359, 50});
    EXPECT_EQ(held->contentSize(), CGSize(359, 220)) << "nobody listens to the old one";
    EXPECT_EQ(old.use_count(), 1);
}

TEST_F(WidgetHostTest, ANewWidgetThatNobodySeesIsNotLoaded) {
    const auto held = host();
    const auto old = std::exchange(widget, std::make_shared<testing::ScriptedWidget>());
    held->startWidgetAnew();
    EXPECT_EQ(widget->calls, Strings{});
    held->setShown(true);
    EXPECT_EQ(old->calls, Strings{});
    EXPECT_FALSE(widget->calls.empty());
}

TEST_F(WidgetHostTest, PassesMemoryWarningsOn) {
    const auto held = host();
    held->didReceiveMemoryWarning();
    EXPECT_EQ(widget->taken(), Strings{"memory warning"});
}

TEST_F(WidgetHostTest, AsksAgainWhenTheMachineWakesOrTheNetworkChangesWhileVisible) {
    const auto held = host();
    held->machineDidWake();
    held->networkDidChange();
    EXPECT_EQ(widget->taken(), Strings{}) << "hidden";
    held->setShown(true);
    widget->taken();
    held->machineDidWake();
    held->networkDidChange();
    EXPECT_EQ(widget->taken(), (Strings{"update", "update"}));
}

TEST_F(WidgetHostTest, AFailureIsAskedAboutAgain) {
    const auto held = host();
    held->setShown(true);
    widget->answer(NCUpdateResult::Failed);
    widget->taken();
    advance(67);
    EXPECT_EQ(widget->taken(), Strings{"update"});
}

TEST_F(WidgetHostTest, AFailureThatTheHostDidNotAskForIsAskedAboutToo) {
    const auto held = host();
    held->setShown(true);
    widget->answer(NCUpdateResult::NewData);
    widget->taken();
    // A fetch of the widget's own has failed: it shows one row, and joining it tells why.
    widget->largest = Mode::Compact;
    widget->joins = NCUpdateResult::Failed;
    widget->offer();
    EXPECT_EQ(widget->taken(), Strings{"update"});
    advance(67);
    EXPECT_EQ(widget->taken(), Strings{"update"});
}

TEST_F(WidgetHostTest, AControllerThatProvidesNothingIsShownAsItIs) {
    const Extension extension(
        {}, [] { return UIViewController::initWithNibName_bundle(std::nullopt, nullptr); });
    const auto held = WidgetHost::hostWithExtension_settings(extension, {});
    std::optional<NCUpdateResult> answer;
    held->requestUpdate([&](NCUpdateResult result) { answer = result; });
    EXPECT_EQ(answer, std::nullopt);
    turn();
    EXPECT_EQ(answer, NCUpdateResult::NoData);
    held->setShown(true);
    EXPECT_EQ(held->contentSize(), CGSize(359, 110));
}

} // namespace
} // namespace orvo
