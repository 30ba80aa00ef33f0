#include "analytics/OWTransitIncidentsAnalyticsDelegate.h"

#include "analytics/DeviceLockState.h"
#include "platform/foundation/NSString.h"
#include "platform/geoservices/AnalyticsPortal.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "platform/geoservices/TransitLineRecord.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <deque>
#include <limits>

namespace orvo {
namespace {

struct Interaction {
    std::int64_t type;
    std::int64_t endState;
    std::shared_ptr<TransitWidgetAnalyticsRecord> record;
    bool wasLocked;
    std::shared_ptr<NSDate> startDate;
    NSTimeInterval duration;
};

class RecordingStore final : public AnalyticsStore {
public:
    void addUserAction(std::int64_t action,
                       std::int64_t target,
                       const std::optional<std::string>& value) override {
        EXPECT_EQ(target, 706);
        EXPECT_FALSE(value);
        actions.push_back(action);
        calls.push_back("action " + std::to_string(action));
    }
    void addWidgetInteraction(std::int64_t type,
                              std::int64_t endState,
                              const std::shared_ptr<TransitWidgetAnalyticsRecord>& record,
                              bool wasLocked,
                              const std::shared_ptr<NSDate>& startDate,
                              NSTimeInterval duration) override {
        interactions.push_back({type, endState, record, wasLocked, startDate, duration});
        calls.push_back("interaction " + std::to_string(endState));
    }

    std::vector<std::int64_t> actions;
    std::vector<Interaction> interactions;
    std::vector<std::string> calls;
};

class FixedContext final : public NSExtensionContext {
public:
    void openURL_completionHandler(const std::shared_ptr<NSURL>&,
                                   std::function<void(bool)>) override {}
    NCWidgetDisplayMode widgetActiveDisplayMode() const override { return mode; }
    NCWidgetDisplayMode widgetLargestAvailableDisplayMode() const override { return mode; }
    void setWidgetLargestAvailableDisplayMode(NCWidgetDisplayMode) override {}
    CGSize widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode) const override { return {}; }

    NCWidgetDisplayMode mode = NCWidgetDisplayMode::Compact;
};

std::shared_ptr<TransitLine> line(std::uint64_t muid) {
    return TransitLineRecord::initWithFields({.muid = muid});
}

std::shared_ptr<TransitIncident> incident(const char* title) {
    return TransitIncidentRecord::initWithFields({.title = title});
}

class AnalyticsDelegateTest : public ::testing::Test {
protected:
    AnalyticsDelegateTest() {
        controller->setExtensionContext(context);
        delegate =
            OWTransitIncidentsAnalyticsDelegate::initWithTransitIncidentsViewController(controller);
    }

    void show(const std::vector<std::shared_ptr<TransitLine>>& lines,
              const std::vector<std::shared_ptr<TransitIncident>>& incidents) {
        const auto mapping = NSMapTable::identityMapTable();
        for (const auto& displayed : incidents)
            if (!lines.empty())
                mapping->setObject_forKey(lines.front(), displayed);
        delegate->recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
            NSArray::arrayOf(lines), NSArray::arrayOf(incidents), mapping);
    }
    /// Ends the session and answers its record.
    std::shared_ptr<TransitWidgetAnalyticsRecord> closedRecord() {
        delegate->recordCloseSessionSwiping();
        return store->interactions.empty() ? nullptr : store->interactions.back().record;
    }
    void open(std::int64_t row) {
        delegate->recordOpenItemAtIndexPath(NSIndexPath::indexPathForRow_inSection(row, 0));
    }

    testing::StoppedClock clock;
    std::deque<int> lockAnswers;
    int lockQuestions = 0;
    double lockSeconds = 0; ///< how long each question takes
    std::shared_ptr<RecordingStore> store = std::make_shared<RecordingStore>();
    EnvironmentSlot<std::shared_ptr<AnalyticsStore>>::Override storeOverride =
        AnalyticsPortal::store().overrideWith(store);
    EnvironmentSlot<DeviceLockStateFunction>::Override lockOverride =
        DeviceLockStateSource().overrideWith([this] {
            ++lockQuestions;
            clock->advance(lockSeconds);
            if (lockAnswers.empty())
                return 0;
            const int answer = lockAnswers.front();
            lockAnswers.pop_front();
            return answer;
        });
    std::shared_ptr<FixedContext> context = std::make_shared<FixedContext>();
    std::shared_ptr<UIViewController> controller = std::make_shared<UIViewController>();
    std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> delegate;
};

TEST_F(AnalyticsDelegateTest, KeepsTheControllerWeakly) {
    const std::weak_ptr<UIViewController> watch = controller;
    controller.reset();
    EXPECT_TRUE(watch.expired());
    delegate->startSessionIfNeeded(); // and does without it
    EXPECT_FALSE(closedRecord()->initiallyExpanded());
}

TEST_F(AnalyticsDelegateTest, RunningSessionKeepsItsStartDate) {
    delegate->startSessionIfNeeded();
    clock->advance(10);
    delegate->startSessionIfNeeded();
    clock->advance(5);
    delegate->recordCloseSessionSwiping();
    ASSERT_EQ(store->interactions.size(), 1U);
    EXPECT_DOUBLE_EQ(store->interactions[0].duration, 15);
    EXPECT_DOUBLE_EQ(store->interactions[0].startDate->timeIntervalSince1970(), 1750000000);
}

TEST_F(AnalyticsDelegateTest, StartingAgainDropsWhatTheOldRecordCollected) {
    delegate->startSessionIfNeeded();
    show({line(1)}, {incident("a")});
    delegate->startSessionIfNeeded();
    const auto record = closedRecord();
    EXPECT_TRUE(record->transitIncidentItems().empty());
    EXPECT_EQ(record->transitMessageType(), 0);
}

TEST_F(AnalyticsDelegateTest, InitiallyExpandedIsAlsoEverExpanded) {
    context->mode = NCWidgetDisplayMode::Expanded;
    delegate->startSessionIfNeeded();
    auto record = closedRecord();
    EXPECT_TRUE(record->initiallyExpanded());
    EXPECT_TRUE(record->everExpanded());
    context->mode = NCWidgetDisplayMode::Compact;
    delegate->startSessionIfNeeded();
    record = closedRecord();
    EXPECT_FALSE(record->initiallyExpanded());
    EXPECT_FALSE(record->everExpanded());
}

TEST_F(AnalyticsDelegateTest, DisplayModeChangeBeforeTheSessionCapturesNothing) {
    delegate->recordWidgetChangeDisplayMode(NCWidgetDisplayMode::Expanded);
    EXPECT_TRUE(store->calls.empty());
}

TEST_F(AnalyticsDelegateTest, DisplayModeChangesAreCapturedAndEverExpandedIsNeverCleared) {
    delegate->startSessionIfNeeded();
    delegate->recordWidgetChangeDisplayMode(NCWidgetDisplayMode::Expanded);
    delegate->recordWidgetChangeDisplayMode(NCWidgetDisplayMode::Compact);
    EXPECT_EQ(store->actions, (std::vector<std::int64_t>{10, 11}));
    const auto record = closedRecord();
    EXPECT_TRUE(record->everExpanded());
    EXPECT_FALSE(record->initiallyExpanded());
}

TEST_F(AnalyticsDelegateTest, MessageTypeTellsTheNumberOfIncidents) {
    const auto typeFor = [&](std::vector<std::shared_ptr<TransitLine>> lines,
                             std::vector<std::shared_ptr<TransitIncident>> incidents) {
        delegate->startSessionIfNeeded();
        show(lines, incidents);
        return closedRecord()->transitMessageType();
    };
    EXPECT_EQ(typeFor({}, {}), 1);
    EXPECT_EQ(typeFor({line(1)}, {}), 2);
    EXPECT_EQ(typeFor({line(1)}, {incident("a")}), 3);
    EXPECT_EQ(typeFor({line(1)}, {incident("a"), incident("b")}), 4);
}

TEST_F(AnalyticsDelegateTest, NoLinesIsMessageTypeOneEvenWithIncidents) {
    delegate->startSessionIfNeeded();
    show({}, {incident("a")});
    EXPECT_EQ(closedRecord()->transitMessageType(), 1);
}

TEST_F(AnalyticsDelegateTest, MessageTypeForCounts) {
    EXPECT_EQ(OWTransitIncidentsAnalyticsDelegate::_messageTypeForIncidentCount(0), 2);
    EXPECT_EQ(OWTransitIncidentsAnalyticsDelegate::_messageTypeForIncidentCount(1), 3);
    EXPECT_EQ(OWTransitIncidentsAnalyticsDelegate::_messageTypeForIncidentCount(2), 4);
    EXPECT_EQ(OWTransitIncidentsAnalyticsDelegate::_messageTypeForIncidentCount(50), 4);
}

TEST_F(AnalyticsDelegateTest, OneItemForEachDisplayedIncidentInOrder) {
    delegate->startSessionIfNeeded();
    show({line(std::numeric_limits<std::uint64_t>::max())},
         {incident("first\nof all"), incident("second")});
    const auto& items = closedRecord()->transitIncidentItems();
    ASSERT_EQ(items.size(), 2U);
    EXPECT_EQ(items[0]->transitLineMuid(), "18446744073709551615");
    EXPECT_EQ(items[0]->transitIncidentTitle(), "first of all"); // the title as a cell shows it
    EXPECT_EQ(items[1]->transitIncidentTitle(), "second");
}

TEST_F(AnalyticsDelegateTest, IncidentWithoutALineIsAddedUnderZero) {
    delegate->startSessionIfNeeded();
    delegate->recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
        NSArray::arrayOf({line(1)}),
        NSArray::arrayOf({incident("a")}),
        NSMapTable::identityMapTable());
    const auto& items = closedRecord()->transitIncidentItems();
    ASSERT_EQ(items.size(), 1U);
    EXPECT_EQ(items[0]->transitLineMuid(), "0");
}

TEST_F(AnalyticsDelegateTest, RepeatedReportsAddItemsAgainAndOverwriteTheType) {
    delegate->startSessionIfNeeded();
    show({line(1)}, {incident("a"), incident("b")});
    show({line(1)}, {incident("a")});
    const auto record = closedRecord();
    EXPECT_EQ(record->transitIncidentItems().size(), 3U);
    EXPECT_EQ(record->transitMessageType(), 3);
}

TEST_F(AnalyticsDelegateTest, ReportsWithoutASessionStoreNothing) {
    show({line(1)}, {incident("a")});
    delegate->startSessionIfNeeded();
    const auto record = closedRecord();
    EXPECT_TRUE(record->transitIncidentItems().empty());
}

TEST_F(AnalyticsDelegateTest, FirstRowCountsAsOneWhenExpandedAndAsZeroWhenCompact) {
    const auto tapped = [&](NCWidgetDisplayMode mode, std::int64_t row) {
        context->mode = mode;
        delegate->startSessionIfNeeded();
        open(row);
        return store->interactions.back().record->tappedItemIndex();
    };
    EXPECT_EQ(tapped(NCWidgetDisplayMode::Expanded, 0), 1);
    EXPECT_EQ(tapped(NCWidgetDisplayMode::Expanded, 1), 1);
    EXPECT_EQ(tapped(NCWidgetDisplayMode::Expanded, 3), 3);
    EXPECT_EQ(tapped(NCWidgetDisplayMode::Compact, 0), 0);
    EXPECT_EQ(tapped(NCWidgetDisplayMode::Compact, 1), 1);
    EXPECT_EQ(tapped(NCWidgetDisplayMode::Compact, 3), 3);
}

TEST_F(AnalyticsDelegateTest, OpeningCapturesTheTapThenEndsTheSession) {
    delegate->startSessionIfNeeded();
    open(2);
    EXPECT_EQ(store->calls, (std::vector<std::string>{"action 9001", "interaction 1"}));
    EXPECT_EQ(store->interactions[0].type, 2);
    delegate->recordCloseSessionSwiping();
    EXPECT_EQ(store->interactions.size(), 1U);
    delegate->recordWidgetChangeDisplayMode(NCWidgetDisplayMode::Expanded);
    EXPECT_EQ(store->actions, (std::vector<std::int64_t>{9001}));
}

TEST_F(AnalyticsDelegateTest, WhatComesAfterTheEndLeavesTheCapturedRecordAsItWas) {
    delegate->startSessionIfNeeded();
    open(2);
    const auto record = store->interactions.at(0).record;
    show({line(1)}, {incident("a")});
    open(5);
    EXPECT_TRUE(record->transitIncidentItems().empty());
    EXPECT_EQ(record->transitMessageType(), 0);
    EXPECT_EQ(record->tappedItemIndex(), 2);
    EXPECT_EQ(store->interactions.size(), 1U);
}

TEST_F(AnalyticsDelegateTest, OpeningWithoutASessionStillCapturesTheTapAlone) {
    open(0);
    EXPECT_EQ(store->calls, (std::vector<std::string>{"action 9001"}));
    EXPECT_EQ(lockQuestions, 0);
}

TEST_F(AnalyticsDelegateTest, SwipingAwayEndsWithStateTwoOnce) {
    delegate->recordCloseSessionSwiping();
    EXPECT_TRUE(store->calls.empty());
    delegate->startSessionIfNeeded();
    delegate->recordCloseSessionSwiping();
    delegate->recordCloseSessionSwiping();
    EXPECT_EQ(store->calls, (std::vector<std::string>{"interaction 2"}));
}

TEST_F(AnalyticsDelegateTest, LockedIsOneAtFirstOrTwoAtTheSecondQuestion) {
    const auto locked = [&](std::deque<int> answers, int questions) {
        lockAnswers = std::move(answers);
        lockQuestions = 0;
        delegate->startSessionIfNeeded();
        delegate->recordCloseSessionSwiping();
        EXPECT_EQ(lockQuestions, questions);
        return store->interactions.back().wasLocked;
    };
    EXPECT_TRUE(locked({1}, 1));
    EXPECT_TRUE(locked({2, 2}, 2));
    EXPECT_FALSE(locked({2, 1}, 2));
    EXPECT_TRUE(locked({0, 2}, 2));
    EXPECT_FALSE(locked({2, 0}, 2));
    EXPECT_FALSE(locked({0, 1}, 2));
}

TEST_F(AnalyticsDelegateTest, DurationIsTakenAfterTheLockWasAskedFor) {
    lockSeconds = 2;
    delegate->startSessionIfNeeded();
    clock->advance(10);
    delegate->recordCloseSessionSwiping();
    ASSERT_EQ(store->interactions.size(), 1U);
    EXPECT_DOUBLE_EQ(store->interactions[0].duration, 14);
}

} // namespace
} // namespace orvo
