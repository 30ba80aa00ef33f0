#include "fetching/OWTransitIncidentUpdater.h"

#include "fetching/FetchingFakes.h"
#include "platform/foundation/RunLoop.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "support/LogCapture.h"
#include "support/TestClock.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <optional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testing::LogCapture;
using testing::makeItem;
using testing::StoppedClock;

constexpr double Start = 1750000000;
constexpr double Interval = 1800;

/// Seconds after `Start`, or no date.
using Seconds = std::optional<double>;

std::shared_ptr<NSDate> date(Seconds seconds) {
    return seconds ? NSDate::dateWithTimeIntervalSince1970(Start + *seconds) : nullptr;
}

std::shared_ptr<NSObject> incident(Seconds start, Seconds end, std::uint64_t muid = 1) {
    return TransitIncidentRecord::initWithFields(
        {.muid = muid, .startDate = date(start), .endDate = date(end)});
}

std::shared_ptr<NSObject> line(NSArray::Elements incidents) {
    return makeItem(7, NSArray::arrayWithObjects(std::move(incidents)));
}

double secondsOf(const NSObject* object) {
    return dynamic_cast<const NSDate&>(*object).timeIntervalSince1970() - Start;
}

class Observer final : public OWTransitIncidentUpdaterObserver {
public:
    void
    transitIncidentUpdater_dateExpired(const std::shared_ptr<OWTransitIncidentUpdater>& updater,
                                       const std::shared_ptr<NSDate>& date) override {
        calls.emplace_back("expired");
        expired.push_back(secondsOf(date.get()));
        pendingAtCall.push_back(updater->updateDates()->count());
        if (const auto next = updater->_nextUpdateTimer())
            armedAtCall.push_back(secondsOf(next->fireDate().get()));
        if (whenExpired)
            whenExpired(*updater);
    }
    void
    transitIncidentUpdaterNeedsRefresh(const std::shared_ptr<OWTransitIncidentUpdater>&) override {
        calls.emplace_back("refresh");
        ++refreshes;
    }
    std::vector<std::string> calls;
    std::vector<double> expired;
    std::vector<std::size_t> pendingAtCall;
    std::vector<double> armedAtCall;
    std::function<void(OWTransitIncidentUpdater&)> whenExpired;
    int refreshes = 0;
};

/// A clock that has gone on by `Step` seconds whenever it is read.
class HurryingClock final : public WallClock {
public:
    static constexpr double Step = 100;
    double timeIntervalSinceReferenceDate() const override {
        _now += Step;
        return _now - Step;
    }

private:
    mutable double _now = Start - NSTimeIntervalSince1970;
};

/// An updater on a clock that the test turns, with an observer.
class OWTransitIncidentUpdaterTest : public ::testing::Test {
protected:
    ~OWTransitIncidentUpdaterTest() override {
        for (const auto& updater : updaters)
            updater->invalidate();
        EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
    }

    std::shared_ptr<OWTransitIncidentUpdater> updater(NSArray::Elements lines) {
        auto made = OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(
            NSArray::arrayWithObjects(std::move(lines)), Interval);
        made->setObserver(observer);
        updaters.push_back(made);
        return made;
    }
    std::shared_ptr<OWTransitIncidentUpdater> updaterOf(NSArray::Elements incidents) {
        return updater({line(std::move(incidents))});
    }
    static std::vector<double> dates(const OWTransitIncidentUpdater& updater) {
        std::vector<double> seconds;
        for (const auto& date : updater.updateDates()->elements())
            seconds.push_back(secondsOf(date.get()));
        return seconds;
    }
    void expectOnlyLinesOfTheWidget() const {
        for (const auto& record : log.records())
            EXPECT_EQ(record.category, "TransitWidget") << record.format;
    }
    void turnClockTo(double seconds) {
        clock->setSince1970(Start + seconds);
        RunLoop::main().checkTimers();
    }

    StoppedClock clock{Start};
    LogCapture log;
    std::shared_ptr<Observer> observer = std::make_shared<Observer>();
    std::vector<std::shared_ptr<OWTransitIncidentUpdater>> updaters;
};

TEST_F(OWTransitIncidentUpdaterTest, WithoutIncidentsOnlyTheAutoRefreshTimerRuns) {
    const auto made = updaterOf({});
    EXPECT_THAT(dates(*made), IsEmpty());
    EXPECT_EQ(made->_nextUpdateTimer(), nullptr);
    EXPECT_TRUE(made->_autoRefreshTimer()->isValid());
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U);
}

TEST_F(OWTransitIncidentUpdaterTest, WithOnlyPastIncidentsOnlyTheAutoRefreshTimerRuns) {
    const auto made = updaterOf({incident(-20, -10), incident({}, -5), incident(-3, {})});
    EXPECT_THAT(dates(*made), IsEmpty());
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U);
}

TEST_F(OWTransitIncidentUpdaterTest, NilLinesAreNone) {
    const auto made =
        OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(nullptr, Interval);
    updaters.push_back(made);
    EXPECT_THAT(dates(*made), IsEmpty());
}

TEST_F(OWTransitIncidentUpdaterTest, ALineWithoutAListOfIncidentsHasNoDates) {
    EXPECT_THAT(dates(*updater({makeItem(1, nullptr)})), IsEmpty());
}

TEST_F(OWTransitIncidentUpdaterTest, TwoIncidentsWithTheSameStartGiveOneDate) {
    EXPECT_THAT(dates(*updaterOf({incident(60, {}, 1), incident(60, {}, 2)})), ElementsAre(60));
}

TEST_F(OWTransitIncidentUpdaterTest, AnIncidentThatHasBegunGivesOnlyItsEnd) {
    EXPECT_THAT(dates(*updaterOf({incident(-60, 30)})), ElementsAre(30));
}

TEST_F(OWTransitIncidentUpdaterTest, AnIncidentThatHasNotBegunGivesItsStartAndItsEnd) {
    EXPECT_THAT(dates(*updaterOf({incident(10, 30)})), ElementsAre(10, 30));
    EXPECT_THAT(dates(*updaterOf({incident(10, {})})), ElementsAre(10));
}

TEST_F(OWTransitIncidentUpdaterTest, AnEndBeforeNowIsTakenForWhatHasNotBegun) {
    EXPECT_THAT(dates(*updaterOf({incident(10, -10)})), ElementsAre(-10, 10));
}

TEST_F(OWTransitIncidentUpdaterTest, WithoutAStartAFutureEndIsADate) {
    EXPECT_THAT(dates(*updaterOf({incident({}, 25)})), ElementsAre(25));
}

TEST_F(OWTransitIncidentUpdaterTest, AStartOfNowIsNotToComeAndAnEndOfNowIsNoDate) {
    EXPECT_THAT(dates(*updaterOf({incident(0, 40)})), ElementsAre(40));
    EXPECT_THAT(dates(*updaterOf({incident(-10, 0)})), IsEmpty());
    EXPECT_THAT(dates(*updaterOf({incident(0, 0)})), IsEmpty());
}

TEST_F(OWTransitIncidentUpdaterTest, DatesOfAllLinesAreSorted) {
    const auto made =
        updater({line({incident(50, 90), incident(-5, 70)}), line({incident(10, {})})});
    EXPECT_THAT(dates(*made), ElementsAre(10, 50, 70, 90));
}

TEST_F(OWTransitIncidentUpdaterTest, TheSameMuidWithOtherDatesCountsAgain) {
    EXPECT_THAT(dates(*updater({line({incident(-1, 10, 5)}), line({incident(-1, 20, 5)})})),
                ElementsAre(10, 20));
}

TEST_F(OWTransitIncidentUpdaterTest, KeepsItsLinesAndItsInterval) {
    const auto lines = NSArray::arrayWithObjects({line({})});
    const auto made =
        OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(lines, 12.5);
    updaters.push_back(made);
    EXPECT_TRUE(equal(made->lineItems(), lines));
    EXPECT_EQ(made->refreshInterval(), 12.5);
    EXPECT_EQ(made->observer(), nullptr);
}

TEST_F(OWTransitIncidentUpdaterTest, AllIncidentsAreJudgedByOneMoment) {
    const auto hurrying = Environment::wallClock().overrideWith(std::make_shared<HurryingClock>());
    EXPECT_THAT(dates(*updaterOf({incident(50, {}), incident(60, {}), incident({}, 70)})),
                ElementsAre(50, 60, 70));
}

TEST_F(OWTransitIncidentUpdaterTest, HandedOutDatesStayAsTheyWere) {
    const auto made = updaterOf({incident(-1, 10), incident(-1, 20)});
    const auto& before = made->updateDates();
    turnClockTo(10.5);
    EXPECT_EQ(before->count(), 2U);
    EXPECT_THAT(dates(*made), ElementsAre(20));
}

TEST_F(OWTransitIncidentUpdaterTest, LogsTheDatesThenArmsTheRefreshThenTheFirstDate) {
    const auto made = updaterOf({incident(-1, 10)});
    EXPECT_THAT(log.formats(),
                ElementsAre("Incident updater calculated update dates for incidents: %{private}@",
                            "Scheduling incident updater  auto refresh update with interval %.2f"));
    EXPECT_EQ(log.messages()[0],
              "Incident updater calculated update dates for incidents: " +
                  made->updateDates()->description());
    EXPECT_EQ(log.messages()[1],
              "Scheduling incident updater  auto refresh update with interval 1800.00");
    for (const auto& record : log.records()) {
        EXPECT_EQ(record.category, "TransitWidget");
        EXPECT_EQ(record.level, LogLevel::Debug);
    }
    EXPECT_EQ(secondsOf(made->_nextUpdateTimer()->fireDate().get()), 10);
    EXPECT_FALSE(made->_nextUpdateTimer()->repeats());
    EXPECT_EQ(made->_nextUpdateTimer()->userInfo(), nullptr);
}

TEST_F(OWTransitIncidentUpdaterTest, TheRefreshIsArmedBeforeTheFirstDate) {
    const auto made = updaterOf({incident({}, Interval)}); // both at the same moment
    turnClockTo(Interval + 1);
    EXPECT_THAT(observer->calls, ElementsAre("refresh", "expired"));
}

TEST_F(OWTransitIncidentUpdaterTest, ItsTimersRunOnTheThreadThatMadeIt) {
    std::size_t timers = 0;
    std::thread([&] {
        const auto made = OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(
            NSArray::arrayWithObjects({line({incident(-1, 10)})}), Interval);
        timers = RunLoop::current().scheduledTimers();
        made->invalidate();
    }).join();
    EXPECT_EQ(timers, 2U);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
}

TEST_F(OWTransitIncidentUpdaterTest, OnlyTheRefreshMayBeLateByATenthOfItsInterval) {
    const auto made = updaterOf({incident(-1, 10)});
    EXPECT_EQ(made->_autoRefreshTimer()->timeInterval(), 1800);
    EXPECT_DOUBLE_EQ(made->_autoRefreshTimer()->tolerance(), 180);
    EXPECT_EQ(made->_autoRefreshTimer()->userInfo(), nullptr);
    EXPECT_EQ(made->_nextUpdateTimer()->tolerance(), 0);
}

TEST_F(OWTransitIncidentUpdaterTest, SchedulingTheRefreshAgainEndsTheOldTimer) {
    const auto made = updaterOf({});
    const auto old = made->_autoRefreshTimer();
    made->_scheduleAutoRefreshTimer();
    EXPECT_FALSE(old->isValid());
    EXPECT_TRUE(made->_autoRefreshTimer()->isValid());
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U);
}

TEST_F(OWTransitIncidentUpdaterTest, PastHeadDateBlocksLaterDates) {
    const auto made = updaterOf({incident(10, -10), incident(-1, 20)});
    EXPECT_EQ(made->_nextUpdateTimer(), nullptr);
    turnClockTo(30);
    EXPECT_THAT(dates(*made), ElementsAre(-10, 10, 20));
    EXPECT_THAT(observer->expired, IsEmpty());
}

TEST_F(OWTransitIncidentUpdaterTest, AFirstDateOfNowArmsNoTimer) {
    const auto made = updaterOf({incident(-1, 10)});
    const auto armed = made->_nextUpdateTimer();
    clock->setSince1970(Start + 10);
    made->_schedulateNextUpdate();
    EXPECT_EQ(made->_nextUpdateTimer(), armed);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 2U);
}

TEST_F(OWTransitIncidentUpdaterTest, OfTwoDatesThatPassedMeanwhileTheSecondBlocksTheRest) {
    const auto made = updaterOf({incident(-1, 10), incident(-1, 20), incident(-1, 30)});
    turnClockTo(25); // the machine was asleep
    EXPECT_THAT(observer->expired, ElementsAre(10));
    turnClockTo(40);
    EXPECT_THAT(observer->expired, ElementsAre(10));
    EXPECT_THAT(dates(*made), ElementsAre(20, 30));
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U);
}

TEST_F(OWTransitIncidentUpdaterTest, AReachedDateIsRemovedTheNextArmedAndThenTheObserverTold) {
    const auto made = updaterOf({incident(10, 20)});
    turnClockTo(10.5);
    EXPECT_THAT(observer->expired, ElementsAre(10));
    EXPECT_THAT(observer->pendingAtCall, ElementsAre(1U));
    EXPECT_THAT(observer->armedAtCall, ElementsAre(20));
    EXPECT_EQ(log.formats().back(), "Incident updater next update date was reached: %{private}@.");
    EXPECT_EQ(log.messages().back(),
              "Incident updater next update date was reached: " + date(10)->description() + ".");
    EXPECT_EQ(log.records().back().level, LogLevel::Debug);
    EXPECT_EQ(secondsOf(made->_nextUpdateTimer()->fireDate().get()), 20);
    turnClockTo(20.5);
    EXPECT_THAT(observer->expired, ElementsAre(10, 20));
    EXPECT_THAT(dates(*made), IsEmpty());
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U);
    expectOnlyLinesOfTheWidget();
}

TEST_F(OWTransitIncidentUpdaterTest, AFireTakesTheFirstDateWhateverTheClockShows) {
    const auto made = updaterOf({incident(-1, 10)});
    made->_nextUpdateTimerFired(nullptr);
    EXPECT_THAT(observer->expired, ElementsAre(10));
    EXPECT_THAT(dates(*made), IsEmpty());
}

TEST_F(OWTransitIncidentUpdaterTest, AFireWithoutDatesIsAnErrorAndGivesTheCurrentDate) {
    const auto made = updaterOf({});
    clock->setSince1970(Start + 3);
    made->_nextUpdateTimerFired(nullptr);
    EXPECT_THAT(observer->expired, ElementsAre(3));
    EXPECT_EQ(log.records().back().level, LogLevel::Error);
    EXPECT_EQ(log.records().back().format,
              "Incident updater next update date timer fired but we should not have any update "
              "anymore.");
    expectOnlyLinesOfTheWidget();
}

TEST_F(OWTransitIncidentUpdaterTest, RefreshIsAskedForAgainAndAgain) {
    const auto made = updaterOf({});
    turnClockTo(1800 + 181);
    EXPECT_EQ(observer->refreshes, 1);
    EXPECT_EQ(log.formats().back(), "Incident updater auto-refresh timer fired.");
    EXPECT_EQ(log.records().back().level, LogLevel::Debug);
    expectOnlyLinesOfTheWidget();
    turnClockTo(3600 + 181);
    EXPECT_EQ(observer->refreshes, 2);
    EXPECT_TRUE(made->_autoRefreshTimer()->isValid());
}

TEST_F(OWTransitIncidentUpdaterTest, AfterInvalidateNothingFires) {
    const auto made = updaterOf({incident(-1, 10)});
    made->invalidate();
    turnClockTo(4000);
    EXPECT_THAT(observer->expired, IsEmpty());
    EXPECT_EQ(observer->refreshes, 0);
    EXPECT_FALSE(made->_autoRefreshTimer()->isValid());
    EXPECT_FALSE(made->_nextUpdateTimer()->isValid());
}

TEST_F(OWTransitIncidentUpdaterTest, InvalidatedInsideACallItNeverFiresAgain) {
    const auto made = updaterOf({incident(10, 20)});
    observer->whenExpired = [](OWTransitIncidentUpdater& updater) {
        updater.invalidate();
    };
    turnClockTo(10.5);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
    turnClockTo(4000);
    EXPECT_THAT(observer->calls, ElementsAre("expired"));
}

TEST_F(OWTransitIncidentUpdaterTest, ItsTimersKeepItAliveUntilItIsInvalidated) {
    std::weak_ptr<OWTransitIncidentUpdater> weak = updaterOf({incident(-1, 10)});
    updaters.clear();
    turnClockTo(10.5);
    EXPECT_THAT(observer->expired, ElementsAre(10));
    ASSERT_FALSE(weak.expired());
    weak.lock()->invalidate();
    RunLoop::main().runOnce();
    EXPECT_TRUE(weak.expired());
}

TEST_F(OWTransitIncidentUpdaterTest, WithoutAnObserverAFireGoesToNoOne) {
    const auto made = updaterOf({incident(-1, 10)});
    made->setObserver(nullptr);
    turnClockTo(10.5);
    EXPECT_THAT(dates(*made), IsEmpty());
    turnClockTo(2000);
    EXPECT_THAT(observer->expired, IsEmpty());
    EXPECT_EQ(observer->refreshes, 0);
}

TEST_F(OWTransitIncidentUpdaterTest, HoldsItsObserverWeakly) {
    const auto made = updaterOf({incident(-1, 10)});
    observer.reset();
    EXPECT_EQ(made->observer(), nullptr);
    turnClockTo(10.5);
    EXPECT_THAT(dates(*made), IsEmpty());
}

TEST_F(OWTransitIncidentUpdaterTest, NeverHasMoreThanTwoTimers) {
    const auto made = updaterOf({incident(10, 20), incident(-1, 30), incident(40, {})});
    for (const double seconds : {10.5, 20.5, 30.5, 40.5, 2000.0}) {
        EXPECT_LE(RunLoop::main().scheduledTimers(), 2U);
        turnClockTo(seconds);
    }
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 1U);
    EXPECT_THAT(observer->expired, ElementsAre(10, 20, 30, 40));
}

} // namespace
} // namespace orvo
