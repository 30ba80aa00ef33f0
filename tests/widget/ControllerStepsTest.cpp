#include "platform/foundation/NSNotificationCenter.h"
#include "widget/WidgetWorld.h"

#include <gmock/gmock.h>

#include <future>

namespace orvo {
namespace {

using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testing::makeItem;
using testing::RecordingDataSource;
using testing::RecordingUpdater;

/// In which order the controller does what it does, as seen from inside its calls.
class ControllerSteps : public testing::WidgetWorld {
protected:
    NCWidgetProviding::UpdateHandler answering() {
        return [this](NCUpdateResult result) {
            answers.push_back(result);
        };
    }
    static std::size_t observers() {
        return NSNotificationCenter::defaultCenter()->_observerCount();
    }
    static std::shared_ptr<OWTransitListItem> withExpandedRow(const OWTransitListItem& item) {
        return OWTransitListItem::initWithSummaryItem_expandedItems(
            item.summaryItem(), NSArray::arrayOf({item.summaryItem()}));
    }
    std::vector<NCUpdateResult> answers;
};

TEST_F(ControllerSteps, AnUpdaterIsInvalidatedBeforeTheNextIsStored) {
    loadWithDoubles();
    const auto old = std::make_shared<RecordingUpdater>(calls);
    controller->setUpdater(old);
    old->whenInvalidated = [&] {
        EXPECT_EQ(controller->updater(), old);
    };
    const auto next = std::make_shared<RecordingUpdater>(calls);
    controller->setUpdater(next);
    EXPECT_EQ(controller->updater(), next);
    EXPECT_THAT(calls, ElementsAre("invalidate"));
}

TEST_F(ControllerSteps, DisappearingSavesLeavesDropsTheUpdaterAndIsHiddenThen) {
    loadWithDoubles();
    const auto before = observers();
    controller->viewWillAppear(false);
    runUntilFetched();
    const auto updater = std::make_shared<RecordingUpdater>(calls);
    controller->setUpdater(updater);
    updater->whenInvalidated = [&] {
        EXPECT_THAT(log.formats(),
                    Contains("Saving view model to NSUserDefault (key: %{private}@) : "
                             "%{private}@"));
        EXPECT_EQ(observers(), before);
        calls.clear();
        controller->transitIncidentUpdater_dateExpired(updater, NSDate::date());
        EXPECT_THAT(calls, ElementsAre("recalculate")) << "it is visible to the end";
    };
    controller->viewWillDisappear(false);
    EXPECT_THAT(calls, ElementsAre("recalculate"));
    calls.clear();
    controller->transitIncidentUpdater_dateExpired(updater, NSDate::date());
    controller->transitIncidentUpdaterNeedsRefresh(updater);
    EXPECT_THAT(calls, IsEmpty());
    EXPECT_EQ(controller->request(), nullptr);
}

TEST_F(ControllerSteps, WhileItSavesItIsStillRegisteredAndWatched) {
    loadWithDoubles();
    const auto before = observers();
    controller->viewWillAppear(false);
    runUntilFetched();
    int saves = 0;
    const auto looking = Log::sink().overrideWith([&](const LogRecord& record) {
        if (record.format != "Saving view model to NSUserDefault (key: %{private}@) : %{private}@")
            return;
        ++saves;
        EXPECT_EQ(observers(), before + 1);
        EXPECT_TRUE(controller->updater());
    });
    controller->viewWillDisappear(false);
    EXPECT_EQ(saves, 1);
    EXPECT_EQ(observers(), before);
}

TEST_F(ControllerSteps, AFailureIsAnsweredToWhoBeganTheFetchAndToWhoJoinedIt) {
    saveFavorites({1});
    lookup->answerWith({nullptr, someError()});
    loadWithDoubles();
    controller->widgetPerformUpdateWithCompletionHandler(answering());
    controller->widgetPerformUpdateWithCompletionHandler(answering());
    ASSERT_TRUE(runUntil([&] { return answers.size() == 2; }));
    EXPECT_THAT(answers, ElementsAre(NCUpdateResult::Failed, NCUpdateResult::Failed));
}

TEST_F(ControllerSteps, WhoJoinedIsAnsweredWhenTheFetchHasEndedForWhoBeganIt) {
    loadWithDoubles();
    bool joined = false;
    controller->widgetPerformUpdateWithCompletionHandler([&](NCUpdateResult) {
        EXPECT_FALSE(joined);
        EXPECT_TRUE(controller->request());
    });
    controller->widgetPerformUpdateWithCompletionHandler([&](NCUpdateResult) {
        joined = true;
        EXPECT_THAT(calls, Contains("update result"));
        EXPECT_EQ(controller->request(), nullptr);
    });
    ASSERT_TRUE(runUntil([&] { return joined; }));
}

TEST_F(ControllerSteps, EachFetchAsksAnew) {
    saveFavorites({1});
    loadWithDoubles();
    for (int times = 0; times < 2; ++times) {
        lookup->answerWith({NSArray::arrayOf({makeItem(1)}), nullptr});
        controller->_fetchUpdatesWithCompletitionHandler({});
        runUntilFetched();
    }
    EXPECT_EQ(lookup->asked().size(), 2U);
}

TEST_F(ControllerSteps, TheSizeIsToldAfterTheModeIsOfferedAndTheRowsAreReloaded) {
    saveFavorites({1, 2});
    lookup->answerWith(
        {NSArray::arrayWithObjects({disturbedLine(1, "Works"), disturbedLine(2, "Delays")}),
         nullptr});
    loadWithDoubles();
    controller->widgetPerformUpdateWithCompletionHandler([&](NCUpdateResult) {
        EXPECT_THAT(calls,
                    ElementsAre("update result",
                                "recalculate",
                                "offers expanded",
                                "preferred size for 110",
                                "reload 0 automatically"));
        calls.emplace_back("answer");
    });
    runUntilFetched();
    EXPECT_EQ(calls.back(), "answer");
}

TEST_F(ControllerSteps, TheModeOfferedIsOfTheDataSourceThatTellsAndTheSizeOfItsOwn) {
    loadWithDoubles();
    testing::Calls ofTheOther;
    const auto other = RecordingDataSource::make(ofTheOther);
    other->setListItem(withExpandedRow(*other->listItem()));
    controller->dataSourceDidUpdateContent(other);
    EXPECT_THAT(calls,
                ElementsAre("offers expanded", "preferred size for 110", "reload 0 automatically"));
    EXPECT_THAT(ofTheOther, IsEmpty());
}

TEST_F(ControllerSteps, AListWithoutExpandedItemsIsOfferedInTheCompactModeOnly) {
    loadWithDoubles();
    const auto none = dataSource->listItem();
    const auto one = withExpandedRow(*none);
    for (const auto& [list, mode] : {std::pair(one, NCWidgetDisplayMode::Expanded),
                                     std::pair(none, NCWidgetDisplayMode::Compact)}) {
        dataSource->setListItem(list);
        EXPECT_EQ(context->largest, mode);
    }
    context->largest = NCWidgetDisplayMode::Expanded; // a host begins with what it likes
    controller->viewWillAppear(false);
    EXPECT_EQ(context->largest, NCWidgetDisplayMode::Compact);
    runUntilFetched();
}

/// Its lookup waits for the test, on a thread of its own, and then has two disturbed lines.
class LookupOnAnotherThread : public ControllerSteps {
protected:
    LookupOnAnotherThread() {
        saveFavorites({1, 2});
        lookup->queue = queue;
        lookup->answerWith(
            {NSArray::arrayWithObjects({disturbedLine(1, "Works"), disturbedLine(2, "Delays")}),
             nullptr});
        queue->async([opened = gate.get_future().share()] { opened.wait(); });
        loadWithDoubles();
        dataSource->whenCalled = [](const std::string&) {
            EXPECT_TRUE(RunLoop::isMainThread());
        };
    }
    void ask(const char* name) {
        controller->widgetPerformUpdateWithCompletionHandler([this, name](NCUpdateResult) {
            EXPECT_TRUE(RunLoop::isMainThread());
            calls.emplace_back(name);
        });
    }
    void expectAnswersOfBothAfterTheRows() {
        ASSERT_TRUE(runUntil([this] { return std::ranges::count(calls, "second") > 0; }));
        EXPECT_THAT(calls, Contains("update result"));
        EXPECT_EQ(dataSource->listItem()->expandedItems()->count(), 2U);
        ASSERT_GE(calls.size(), 3U);
        EXPECT_EQ(calls[calls.size() - 2], "first");
        EXPECT_EQ(calls.back(), "second");
        EXPECT_EQ(controller->request(), nullptr);
    }

    std::promise<void> gate;
    std::shared_ptr<DispatchQueue> queue = DispatchQueue::serialQueue("lookup");
};

TEST_F(LookupOnAnotherThread, WhatItAnswersIsShownOnTheMainThread) {
    ask("first");
    ask("second");
    gate.set_value();
    expectAnswersOfBothAfterTheRows();
}

TEST_F(LookupOnAnotherThread, WhoAsksWhenItHasEndedButNothingIsShownIsAnsweredAfterTheRows) {
    ask("first");
    ASSERT_TRUE(runUntil([this] {
        const auto asked = lookup->asked();
        return !asked.empty() && asked[0].submissions == 1;
    }));
    gate.set_value();
    std::promise<void> ended;
    queue->async([&] { ended.set_value(); });
    ended.get_future().wait();
    ask("second");
    EXPECT_THAT(calls, IsEmpty());
    expectAnswersOfBothAfterTheRows();
}

TEST_F(ControllerSteps, TheSizeIsThatOfTheContextsModeAndWithoutAContextNone) {
    loadWithDoubles();
    context->mode = NCWidgetDisplayMode::Expanded;
    controller->dataSourceDidUpdateContent(dataSource);
    EXPECT_THAT(calls, Contains("preferred size for 616"));
    controller->setExtensionContext(nullptr);
    calls.clear();
    controller->dataSourceDidUpdateContent(dataSource);
    EXPECT_THAT(calls, ElementsAre("preferred size for 0", "reload 0 automatically"));
    EXPECT_EQ(controller->preferredContentSize().width, 0);
}

TEST_F(ControllerSteps, AppearingOffersWhatTheRowsCanFillBeforeTheFetchBegins) {
    loadWithDoubles();
    dataSource->setListItem(withExpandedRow(*dataSource->listItem()));
    context->largest = NCWidgetDisplayMode::Compact;
    context->expandedMaximum.height = 100 * context->compactMaximum.height; // as many as it knows
    context->whenOffered = [&] {
        EXPECT_EQ(controller->request(), nullptr);
    };
    controller->viewWillAppear(false);
    EXPECT_EQ(context->largest, NCWidgetDisplayMode::Expanded);
    context->whenOffered = nullptr;
    runUntilFetched();
}

TEST_F(ControllerSteps, AHostMayTellModeAndSizeBeforeTheViewIsLoaded) {
    controller = makeController();
    controller->setAnalyticsDelegate(std::make_shared<testing::RecordingAnalytics>(calls));
    context->mode = NCWidgetDisplayMode::Expanded;
    controller->widgetActiveDisplayModeDidChange_withMaximumSize(NCWidgetDisplayMode::Expanded, {});
    EXPECT_THAT(calls, ElementsAre("record mode 1"));
    const auto coordinator = std::make_shared<testing::FakeCoordinator>();
    controller->viewWillTransitionToSize_withTransitionCoordinator({320, 110}, coordinator);
    ASSERT_TRUE(coordinator->animation);
    coordinator->animation();
    EXPECT_FALSE(controller->isViewLoaded());
    controller->widgetPerformUpdateWithCompletionHandler(answering());
    runUntilFetched();
    EXPECT_THAT(answers, ElementsAre(NCUpdateResult::NewData));
    EXPECT_TRUE(controller->transitLineItemResult());
}

} // namespace
} // namespace orvo
