#include "fetching/FetchingFakes.h"
#include "fetching/OWTransitIncidentUpdater.h"
#include "platform/foundation/RunLoop.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "support/LogCapture.h"
#include "support/TestClock.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

// In which order the updater does what it does, as seen from inside its calls.

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::StrEq;

constexpr double Beginning = 1750000000;

/// Stands still, and lets the test look around at each reading. The run loop reads it whenever a
/// timer goes while others are left.
class WatchedClock final : public WallClock {
public:
    double timeIntervalSinceReferenceDate() const override {
        if (whenRead)
            whenRead();
        return Beginning - NSTimeIntervalSince1970;
    }
    std::function<void()> whenRead;
};

/// Belongs to the test alone, whatever its timers hold.
class OwnedUpdater final : public OWTransitIncidentUpdater {
public:
    using OWTransitIncidentUpdater::_initWithTransitLineItems_refreshInterval;
};

class IncidentUpdaterSteps : public ::testing::Test {
protected:
    ~IncidentUpdaterSteps() override {
        clock->whenRead = nullptr;
        another->invalidate();
        EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
    }
    /// Of one line, with an incident that ends after each of these seconds.
    static std::shared_ptr<NSArray> linesEnding(const std::vector<double>& seconds) {
        NSArray::Elements incidents;
        for (const double end : seconds)
            incidents.push_back(TransitIncidentRecord::initWithFields(
                {.muid = 1, .endDate = NSDate::dateWithTimeIntervalSince1970(Beginning + end)}));
        return NSArray::arrayOf({testing::makeItem(7, NSArray::arrayWithObjects(incidents))});
    }
    /// From now on notes which of the two timers has ended while the other still runs.
    void watch(const OWTransitIncidentUpdater& updater) {
        clock->whenRead =
            [this, refresh = updater._autoRefreshTimer(), next = updater._nextUpdateTimer()] {
                if (refresh->isValid() != next->isValid())
                    endedFirst.emplace_back(next->isValid() ? "refresh" : "next update");
            };
    }
    /// From now on looks around at each line of the log.
    EnvironmentSlot<LogSink>::Override whenLogged(std::function<void(const std::string&)> look) {
        return Log::sink().overrideWith(
            [look = std::move(look)](const LogRecord& record) { look(record.format); });
    }

    std::vector<std::string> endedFirst;
    std::shared_ptr<WatchedClock> clock = std::make_shared<WatchedClock>();
    testing::LogCapture log;

private:
    EnvironmentSlot<std::shared_ptr<WallClock>>::Override _clock =
        Environment::wallClock().overrideWith(clock);

protected:
    std::shared_ptr<NSTimer> another =
        NSTimer::scheduledTimerWithTimeInterval_repeats_block(86400, false, [](const auto&) {});
};

TEST_F(IncidentUpdaterSteps, InvalidatingEndsTheRefreshBeforeTheNextUpdate) {
    const auto updater =
        OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(linesEnding({10}), 1800);
    watch(*updater);
    updater->invalidate();
    EXPECT_THAT(endedFirst, ElementsAre("refresh"));
    EXPECT_FALSE(updater->_autoRefreshTimer()->isValid());
    EXPECT_FALSE(updater->_nextUpdateTimer()->isValid());
}

TEST_F(IncidentUpdaterSteps, GoingEndsTheRefreshBeforeTheNextUpdate) {
    auto owned = std::make_unique<OwnedUpdater>();
    std::shared_ptr<OwnedUpdater> reference(owned.get(), [](OwnedUpdater*) {});
    owned->_initWithTransitLineItems_refreshInterval(linesEnding({10}), 1800);
    const auto refresh = owned->_autoRefreshTimer();
    const auto next = owned->_nextUpdateTimer();
    watch(*owned);
    reference.reset();
    ASSERT_TRUE(refresh->isValid());
    ASSERT_TRUE(next->isValid());
    owned.reset();
    EXPECT_THAT(endedFirst, ElementsAre("refresh"));
    EXPECT_FALSE(refresh->isValid());
    EXPECT_FALSE(next->isValid());
}

TEST_F(IncidentUpdaterSteps, ARefreshScheduledAgainEndsTheOldTimerBeforeItIsLogged) {
    const auto updater =
        OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(nullptr, 1800);
    const auto old = updater->_autoRefreshTimer();
    std::vector<bool> isOldValid;
    std::vector<bool> isItTheTimer;
    const auto looking = whenLogged([&](const std::string& format) {
        EXPECT_THAT(format,
                    StrEq("Scheduling incident updater  auto refresh update with interval %.2f"));
        isOldValid.push_back(old->isValid());
        isItTheTimer.push_back(updater->_autoRefreshTimer() == old);
    });
    updater->_scheduleAutoRefreshTimer();
    EXPECT_THAT(isOldValid, ElementsAre(false));
    EXPECT_THAT(isItTheTimer, ElementsAre(true)) << "the new one comes after the line";
    updater->invalidate();
}

TEST_F(IncidentUpdaterSteps, AReachedDateIsLoggedThenRemovedThenTheNextIsArmed) {
    const auto updater = OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(
        linesEnding({10, 20}), 1800);
    const auto first = updater->_nextUpdateTimer();
    std::size_t datesAtLine = 0;
    const auto looking = whenLogged([&](const std::string& format) {
        EXPECT_THAT(format, StrEq("Incident updater next update date was reached: %{private}@."));
        datesAtLine = updater->updateDates()->count();
        EXPECT_EQ(updater->_nextUpdateTimer(), first);
    });
    updater->_nextUpdateTimerFired(first);
    EXPECT_EQ(datesAtLine, 2U);
    EXPECT_EQ(updater->updateDates()->count(), 1U);
    EXPECT_NE(updater->_nextUpdateTimer(), first);
    first->invalidate();
    updater->invalidate();
}

TEST_F(IncidentUpdaterSteps, DatesAreThereWhenTheyAreLoggedAndNoTimerYet) {
    std::vector<std::size_t> timersAtLine;
    const auto before = RunLoop::main().scheduledTimers();
    const auto looking = whenLogged([&](const std::string&) {
        timersAtLine.push_back(RunLoop::main().scheduledTimers() - before);
    });
    const auto updater =
        OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(linesEnding({10}), 1800);
    EXPECT_THAT(timersAtLine, ElementsAre(0U, 0U));
    EXPECT_EQ(RunLoop::main().scheduledTimers() - before, 2U);
    updater->invalidate();
}

} // namespace
} // namespace orvo
