#include "widget/OWTransitIncidentsViewController.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSNotificationCenter.h"
#include "platform/uikit/UIContentSizeCategory.h"
#include "platform/uikit/UIVisualEffectView.h"
#include "widget/WidgetWorld.h"

#include <gmock/gmock.h>

#include <limits>
#include <thread>

namespace orvo {
namespace {

using testing::Calls;
using ::testing::ElementsAre;
using testing::FakeCoordinator;
using ::testing::IsEmpty;
using testing::makeItem;
using testing::RecordingUpdater;

constexpr std::uint64_t NoLimit = std::numeric_limits<std::uint64_t>::max();

/// Answers as told, at once or when asked.
class FakeOpenable final : public OWOpenable {
public:
    void openInContext_completionHandler(const std::shared_ptr<NSObject>& context,
                                         CompletionHandler completionHandler) override {
        openedIn = context;
        handler = std::move(completionHandler);
    }
    std::shared_ptr<NSObject> openedIn;
    CompletionHandler handler;
};

class WidgetController : public testing::WidgetWorld {
protected:
    void appear() {
        controller->viewWillAppear(false);
        controller->viewDidAppear(false);
    }
    /// Appears, and waits for the fetch.
    void appearAndFetch() {
        appear();
        runUntilFetched();
        calls.clear();
    }
    std::vector<NCUpdateResult> answers;
    NCWidgetProviding::UpdateHandler answering() {
        return [this](NCUpdateResult result) {
            answers.push_back(result);
        };
    }
    std::size_t observers() const {
        return NSNotificationCenter::defaultCenter()->_observerCount();
    }
};

// Made

TEST_F(WidgetController, HasItsAnalyticsFromTheStartAndNothingElse) {
    controller = makeController();
    EXPECT_TRUE(controller->analyticsDelegate());
    EXPECT_EQ(controller->tableView(), nullptr);
    EXPECT_EQ(controller->dataSource(), nullptr);
    EXPECT_EQ(controller->transitLineItemResult(), nullptr);
    EXPECT_FALSE(controller->isViewLoaded());
}

TEST_F(WidgetController, TheArtworkCacheIsMadeOnceAndOutlivesAMemoryWarning) {
    controller = makeController();
    const auto cache = controller->artworkCache();
    ASSERT_TRUE(cache);
    (void)controller->view();
    controller->didReceiveMemoryWarning();
    EXPECT_EQ(controller->artworkCache(), cache);
    EXPECT_EQ(controller->dataSource()->artworkCache(), cache);
}

TEST_F(WidgetController, LoadingMakesAPlainTableServedByTheDataSource) {
    controller = makeController();
    const auto view = controller->view();
    const auto table = controller->tableView();
    ASSERT_TRUE(table);
    EXPECT_EQ(table->style(), UITableViewStyle::Plain);
    EXPECT_EQ(table->rowHeight(), UITableViewAutomaticDimension);
    EXPECT_TRUE(
        table->separatorEffect()->isEqual(UIVibrancyEffect::widgetTertiaryVibrancyEffect().get()));
    EXPECT_EQ(table->dataSource(), controller->dataSource());
    EXPECT_EQ(table->delegate(), controller->dataSource());
    EXPECT_EQ(controller->dataSource()->delegate(), controller);
    EXPECT_EQ(table->superview(), view);
}

TEST_F(WidgetController, LoadingFitsTheHostsCompactWidthAndItsRows) {
    context->compactMaximum = {300, 110};
    context->expandedMaximum = {340, 300};
    controller = makeController();
    (void)controller->view();
    EXPECT_EQ(controller->dataSource()->availableWidth(), 300);
    EXPECT_EQ(controller->_maxNumberOfRowsFromAvailableWidgetSize(), 2U);
}

TEST_F(WidgetController, TheTableFillsTheRootViewsMargins) {
    controller = makeController();
    const auto view = controller->view();
    view->setFrame({{0, 0}, {359, 220}});
    view->setDirectionalLayoutMargins({0, 16, 0, 16});
    view->layoutIfNeeded();
    EXPECT_EQ(controller->tableView()->frame(), (CGRect{{16, 0}, {327, 220}}));
    view->setDirectionalLayoutMargins({0, 20, 10, 20});
    view->layoutIfNeeded();
    EXPECT_EQ(controller->tableView()->frame(), (CGRect{{20, 0}, {319, 210}}));
}

// Appearing

TEST_F(WidgetController, AppearingGoesUpdaterThenSizesThenRegistrationThenModeThenFetch) {
    loadWithDoubles();
    controller->setTransitLineItemResult(success());
    calls.clear();
    const auto before = observers();
    dataSource->whenCalled = [&](const std::string&) {
        EXPECT_TRUE(controller->updater());
        EXPECT_EQ(observers(), before);
    };
    context->whenOffered = [&] {
        EXPECT_EQ(observers(), before + 1);
        EXPECT_EQ(controller->request(), nullptr);
    };
    controller->viewWillAppear(false);
    dataSource->whenCalled = nullptr;
    context->whenOffered = nullptr;
    ASSERT_GE(calls.size(), 2U);
    EXPECT_EQ(calls.front(), "row height");
    EXPECT_EQ(calls.back(), "offers compact");
    EXPECT_TRUE(controller->request());
    runUntilFetched();
}

TEST_F(WidgetController, HavingAppearedItStartsASession) {
    loadWithDoubles();
    controller->viewDidAppear(false);
    EXPECT_THAT(calls, ElementsAre("start session"));
}

TEST_F(WidgetController, ATextSizeThatChangesWhileVisibleSendsRowHeightAndLimitAgain) {
    loadWithDoubles();
    appearAndFetch();
    context->compactMaximum = {359, 140};
    const auto change = [] {
        NSNotificationCenter::defaultCenter()->postNotificationName_object(
            UIContentSizeCategoryDidChangeNotification, nullptr);
    };
    change();
    EXPECT_EQ(calls.front(), "row height");
    EXPECT_EQ(dataSource->rowHeight, 140);
    EXPECT_EQ(dataSource->maxRows, 4U);
    controller->viewWillDisappear(false);
    calls.clear();
    change();
    EXPECT_THAT(calls, IsEmpty());
}

TEST_F(WidgetController, DisappearingSavesThenLeavesThenDropsTheUpdater) {
    loadWithDoubles();
    const auto before = observers();
    appearAndFetch();
    const auto updater = std::make_shared<RecordingUpdater>(calls);
    controller->setUpdater(updater);
    calls.clear();
    controller->viewWillDisappear(false);
    EXPECT_THAT(calls, ElementsAre("invalidate"));
    EXPECT_EQ(controller->updater(), nullptr);
    EXPECT_EQ(observers(), before);
    EXPECT_EQ(log.formats().back(),
              "Saving view model to NSUserDefault (key: %{private}@) : %{private}@");
    controller->viewDidDisappear(false);
    EXPECT_EQ(calls.back(), "close session");
}

// Fetching

TEST_F(WidgetController, TwoUpdatesDuringOneFetchAreOneFetchWithTwoAnswers) {
    saveFavorites({1});
    lookup->answerWith({NSArray::arrayOf({makeItem(1)}), nullptr});
    loadWithDoubles();
    controller->widgetPerformUpdateWithCompletionHandler(answering());
    const auto request = controller->request();
    controller->widgetPerformUpdateWithCompletionHandler(answering());
    EXPECT_EQ(controller->request(), request);
    runUntilFetched();
    ASSERT_TRUE(runUntil([&] { return answers.size() == 2; }));
    EXPECT_EQ(lookup->asked().size(), 1U);
    EXPECT_THAT(answers, ElementsAre(NCUpdateResult::NewData, NCUpdateResult::NewData));
    EXPECT_EQ(std::ranges::count(calls, "update result"), 1);
}

TEST_F(WidgetController, TheHostIsAnsweredAfterTheRowsAndBeforeTheRequestEnds) {
    loadWithDoubles();
    bool asked = false;
    controller->widgetPerformUpdateWithCompletionHandler([&](NCUpdateResult) {
        asked = true;
        EXPECT_THAT(calls, ::testing::Contains("update result"));
        EXPECT_TRUE(controller->transitLineItemResult());
        EXPECT_TRUE(controller->request());
    });
    EXPECT_TRUE(controller->request());
    runUntilFetched();
    EXPECT_TRUE(asked);
}

TEST_F(WidgetController, AnUpdateAskedForInsideTheAnswerJoinsTheFetchThatEnds) {
    loadWithDoubles();
    const auto first = [&](NCUpdateResult) {
        controller->widgetPerformUpdateWithCompletionHandler(answering());
        EXPECT_EQ(answers.size(), 1U);
    };
    controller->widgetPerformUpdateWithCompletionHandler(first);
    runUntilFetched();
    EXPECT_EQ(std::ranges::count(calls, "update result"), 1);
}

TEST_F(WidgetController, WithoutAHandlerARunningFetchIsLeftAlone) {
    loadWithDoubles();
    controller->_fetchUpdatesWithCompletitionHandler({});
    const auto request = controller->request();
    controller->_fetchUpdatesWithCompletitionHandler({});
    EXPECT_EQ(controller->request(), request);
    runUntilFetched();
    EXPECT_EQ(std::ranges::count(calls, "update result"), 1);
}

TEST_F(WidgetController, AFailureIsAnsweredAsFailedAndShown) {
    saveFavorites({1});
    lookup->answerWith({nullptr, someError()});
    loadWithDoubles();
    appear();
    controller->widgetPerformUpdateWithCompletionHandler(answering());
    runUntilFetched();
    ASSERT_TRUE(runUntil([&] { return !answers.empty(); }));
    EXPECT_THAT(answers, ElementsAre(NCUpdateResult::Failed));
    EXPECT_EQ(controller->updater(), nullptr);
    EXPECT_FALSE(dataSource->transitLineItemResult()->isSuccess());
}

TEST_F(WidgetController, TheSameDataFetchedTwiceIsNewDataTwice) {
    loadWithDoubles();
    for (int times = 0; times < 2; ++times) {
        controller->widgetPerformUpdateWithCompletionHandler(answering());
        runUntilFetched();
    }
    EXPECT_THAT(answers, ElementsAre(NCUpdateResult::NewData, NCUpdateResult::NewData));
}

TEST_F(WidgetController, ItsHostIsAnsweredAlsoWhenItHasGone) {
    auto made = makeController();
    (void)made->view();
    made->widgetPerformUpdateWithCompletionHandler(answering());
    const std::weak_ptr<Controller> weak = made;
    made.reset();
    EXPECT_TRUE(weak.expired());
    ASSERT_TRUE(runUntil([&] { return !answers.empty(); }));
    EXPECT_THAT(answers, ElementsAre(NCUpdateResult::NewData));
}

TEST_F(WidgetController, UpdatesAreFetchedOnTheMainThreadOnly) {
    loadWithDoubles();
    bool raised = false;
    std::thread([&] {
        try {
            controller->_fetchUpdatesWithCompletitionHandler({});
        } catch (const NSInvalidArgumentException&) {
            raised = true;
        }
    }).join();
    EXPECT_TRUE(raised);
    EXPECT_EQ(controller->request(), nullptr);
}

// Results and updaters

TEST_F(WidgetController, AResultIsKeptThenWatchedThenShown) {
    loadWithDoubles();
    appearAndFetch();
    const auto old = controller->updater();
    const auto result = success();
    dataSource->whenCalled = [&](const std::string& call) {
        if (call != "update result")
            return;
        EXPECT_EQ(controller->transitLineItemResult(), result);
        EXPECT_NE(controller->updater(), old);
    };
    controller->setTransitLineItemResult(result);
    dataSource->whenCalled = nullptr;
    EXPECT_EQ(calls.front(), "update result");
    EXPECT_EQ(controller->transitLineItemResult(), result);
    EXPECT_EQ(dataSource->resultAnalytics, controller->analyticsDelegate());
}

TEST_F(WidgetController, WhileVisibleAnUpdaterWatchesEverySuccessEvenAnEmptyOne) {
    loadWithDoubles();
    appearAndFetch();
    ASSERT_TRUE(controller->updater());
    EXPECT_EQ(controller->updater()->refreshInterval(), 1800);
    EXPECT_EQ(controller->updater()->observer(), controller);
    controller->setTransitLineItemResult(failure());
    EXPECT_EQ(controller->updater(), nullptr);
}

TEST_F(WidgetController, WhileHiddenThereIsNoUpdater) {
    loadWithDoubles();
    controller->setTransitLineItemResult(success());
    EXPECT_EQ(controller->updater(), nullptr);
    const auto updater = std::make_shared<RecordingUpdater>(calls);
    controller->setUpdater(updater);
    controller->_createUpdaterForTransitLineItemsIfVisible();
    EXPECT_EQ(controller->updater(), nullptr);
    EXPECT_EQ(calls.back(), "invalidate");
}

TEST_F(WidgetController, BeforeTheFirstResultAnUpdaterIsLeftAlone) {
    loadWithDoubles();
    appear();
    const auto updater = std::make_shared<RecordingUpdater>(calls);
    controller->setUpdater(updater);
    controller->_createUpdaterForTransitLineItemsIfVisible();
    EXPECT_EQ(controller->updater(), updater);
    runUntilFetched();
}

TEST_F(WidgetController, TheSameUpdaterAgainIsNotInvalidated) {
    loadWithDoubles();
    const auto updater = std::make_shared<RecordingUpdater>(calls);
    controller->setUpdater(updater);
    controller->setUpdater(updater);
    EXPECT_THAT(calls, IsEmpty());
    controller->setUpdater(nullptr);
    EXPECT_THAT(calls, ElementsAre("invalidate"));
}

TEST_F(WidgetController, EachAppearanceHasAnUpdaterOfItsOwn) {
    loadWithDoubles();
    appearAndFetch();
    const auto first = controller->updater();
    controller->viewWillDisappear(false);
    EXPECT_FALSE(first->_autoRefreshTimer()->isValid());
    appearAndFetch();
    EXPECT_TRUE(controller->updater());
    EXPECT_NE(controller->updater(), first);
}

TEST_F(WidgetController, ADateThatExpiresRebuildsTheRowsWithoutAFetchAndOnlyWhileVisible) {
    loadWithDoubles();
    controller->transitIncidentUpdater_dateExpired(nullptr, NSDate::date());
    EXPECT_THAT(calls, IsEmpty());
    appearAndFetch();
    controller->transitIncidentUpdater_dateExpired(nullptr, NSDate::date());
    EXPECT_THAT(calls, ElementsAre("recalculate"));
    EXPECT_EQ(dataSource->recalculateAnalytics, controller->analyticsDelegate());
    EXPECT_EQ(controller->request(), nullptr);
}

TEST_F(WidgetController, ARefreshFetchesWhileVisibleAndNotTwice) {
    loadWithDoubles();
    controller->transitIncidentUpdaterNeedsRefresh(nullptr);
    EXPECT_EQ(controller->request(), nullptr);
    appearAndFetch();
    controller->transitIncidentUpdaterNeedsRefresh(nullptr);
    const auto request = controller->request();
    ASSERT_TRUE(request);
    controller->transitIncidentUpdaterNeedsRefresh(nullptr);
    EXPECT_EQ(controller->request(), request);
    runUntilFetched();
}

// Modes and sizes

TEST_F(WidgetController, TheModeGivenIsRecordedAndTheContextsIsShown) {
    loadWithDoubles();
    controller->widgetActiveDisplayModeDidChange_withMaximumSize(NCWidgetDisplayMode::Expanded,
                                                                 {1, 1});
    EXPECT_THAT(calls, ElementsAre("record mode 1", "compact"));
    calls.clear();
    context->mode = NCWidgetDisplayMode::Expanded;
    controller->widgetActiveDisplayModeDidChange_withMaximumSize(NCWidgetDisplayMode::Compact, {});
    ASSERT_GE(calls.size(), 2U);
    EXPECT_EQ(calls[0], "record mode 0");
    EXPECT_EQ(calls[1], "expand");
}

TEST_F(WidgetController, ATransitionSetsTheWidthAndItsReloadStaysClosed) {
    loadWithDoubles();
    const auto coordinator = std::make_shared<FakeCoordinator>();
    controller->viewWillTransitionToSize_withTransitionCoordinator({320, 500}, coordinator);
    EXPECT_EQ(calls.front(), "width 320");
    EXPECT_FALSE(coordinator->hasCompletion);
    calls.clear();
    ASSERT_TRUE(coordinator->animation);
    coordinator->animation();
    EXPECT_THAT(calls, IsEmpty());
}

TEST_F(WidgetController, HowManyRowsFitIsRoundedDownAndNoneIsNoLimit) {
    controller = makeController();
    const auto rows = [&](double compact, double expanded) {
        context->compactMaximum.height = compact;
        context->expandedMaximum.height = expanded;
        return controller->_maxNumberOfRowsFromAvailableWidgetSize();
    };
    EXPECT_EQ(rows(110, 300), 2U);
    EXPECT_EQ(rows(110, 90), NoLimit);
    EXPECT_EQ(rows(110, 110), 1U);
    EXPECT_EQ(rows(0, 300), NoLimit);
    EXPECT_EQ(rows(-1, 300), NoLimit);
    EXPECT_EQ(rows(110, 0), NoLimit);
    controller->setExtensionContext(nullptr);
    EXPECT_EQ(controller->_maxNumberOfRowsFromAvailableWidgetSize(), NoLimit);
}

TEST_F(WidgetController, WithoutAContextTheWidthIsTheViewsAndRowsHaveNoHeight) {
    loadWithDoubles();
    EXPECT_EQ(controller->_availablWidth(), 359);
    controller->setExtensionContext(nullptr);
    controller->view()->setFrame({{0, 0}, {280, 100}});
    EXPECT_EQ(controller->_availablWidth(), 280);
    controller->_contentSizeCategoryDidChange();
    EXPECT_EQ(dataSource->rowHeight, 0);
    EXPECT_EQ(dataSource->maxRows, NoLimit);
}

TEST_F(WidgetController, NewContentOffersTheModeReloadsAndThenTellsItsSize) {
    loadWithDoubles();
    controller->_setPreferredContentSizeChanged(
        [&](CGSize size) { calls.push_back("size " + std::to_string(int(size.height))); });
    controller->dataSourceDidUpdateContent(dataSource);
    EXPECT_THAT(
        calls,
        ElementsAre(
            "offers compact", "preferred size for 110", "reload 0 automatically", "size 110"));
    EXPECT_EQ(controller->preferredContentSize(), (CGSize{359, 110}));
}

TEST_F(WidgetController, AFailureLeavesTheModeToTheHost) {
    loadWithDoubles();
    dataSource->setListItem(OWTransitListItem::initWithSummaryItem_expandedItems(
        dataSource->listItem()->summaryItem(), NSArray::arrayOf({NSDate::date()})));
    appear();
    runUntilFetched();
    controller->setTransitLineItemResult(success({makeItem(1)}));
    context->mode = NCWidgetDisplayMode::Expanded;
    dataSource->setListItem(OWTransitListItem::initWithSummaryItem_expandedItems(
        dataSource->listItem()->summaryItem(),
        NSArray::arrayOf({dataSource->listItem()->summaryItem()})));
    controller->widgetActiveDisplayModeDidChange_withMaximumSize(NCWidgetDisplayMode::Expanded, {});
    ASSERT_TRUE(dataSource->isExpanded());
    controller->setTransitLineItemResult(failure());
    EXPECT_TRUE(dataSource->isExpanded());
    EXPECT_EQ(context->largest, NCWidgetDisplayMode::Compact);
}

// Taps

TEST_F(WidgetController, ATapOpensWithTheControllerAndIsRecordedOnlyWhenItWentWell) {
    loadWithDoubles();
    const auto path = NSIndexPath::indexPathForRow_inSection(2, 0);
    const auto openable = std::make_shared<FakeOpenable>();
    controller->dataSource_didSelectOpenableItem_atIndexPath(dataSource, openable, path);
    EXPECT_EQ(openable->openedIn, controller);
    openable->handler(false, someError());
    EXPECT_THAT(calls, IsEmpty());
    openable->handler(true, nullptr);
    EXPECT_THAT(calls, ElementsAre("record open 2"));
}

} // namespace
} // namespace orvo
