#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSOrderedSet.h"
#include "platform/foundation/NSTimer.h"

#include <memory>

namespace orvo {

class OWTransitIncidentUpdater;

/// Hears when what is shown has gone stale. Main thread.
class OWTransitIncidentUpdaterObserver : public virtual NSObject {
public:
    /// An incident begins or ends now, at `date`: the rows change without new data.
    virtual void
    transitIncidentUpdater_dateExpired(const std::shared_ptr<OWTransitIncidentUpdater>& updater,
                                       const std::shared_ptr<NSDate>& date) = 0;
    /// The data is as old as the refresh interval.
    virtual void transitIncidentUpdaterNeedsRefresh(
        const std::shared_ptr<OWTransitIncidentUpdater>& updater) = 0;
};

/// Works out when the incidents of some lines begin and end, and arms a timer for the first of
/// these dates, and another that asks for fresh data again and again. Never more than these two.
///
/// The timers keep the updater alive: whoever drops it calls `invalidate` first. Main thread.
class OWTransitIncidentUpdater : public virtual NSObject {
public:
    /// Starts both timers on the current run loop. `lineItems`: `TransitLineItem`s; nil is none.
    /// `refreshInterval` in seconds.
    [[nodiscard]] static std::shared_ptr<OWTransitIncidentUpdater>
    initWithTransitLineItems_refreshInterval(std::shared_ptr<NSArray> lineItems,
                                             NSTimeInterval refreshInterval);
    ~OWTransitIncidentUpdater() override;

    /// The dates not reached yet, earliest first, each once. What is handed out does not change.
    [[nodiscard]] std::shared_ptr<NSOrderedSet> updateDates() const { return _updateDates; }
    [[nodiscard]] const std::shared_ptr<NSArray>& lineItems() const noexcept { return _lineItems; }
    [[nodiscard]] NSTimeInterval refreshInterval() const noexcept { return _refreshInterval; }
    /// Held weakly; nil at first.
    [[nodiscard]] std::shared_ptr<OWTransitIncidentUpdaterObserver> observer() const {
        return _observer.lock();
    }
    void setObserver(const std::shared_ptr<OWTransitIncidentUpdaterObserver>& observer) {
        _observer = observer;
    }

    /// Ends both timers. It never fires again.
    virtual void invalidate();

    /// The start and end of what has not begun, whatever that end is; of all else only an end that
    /// is still to come. Every incident counts, also one that no row shows.
    void _calculateUpdateDatesForIncidents();
    void _scheduleAutoRefreshTimer();
    /// Arms the timer for the first date. One that has passed arms none, and keeps all later ones
    /// from being armed. Kept so.
    void _schedulateNextUpdate();
    void _nextUpdateTimerFired(const std::shared_ptr<NSTimer>& timer);
    void _autoRefreshTimerFired(const std::shared_ptr<NSTimer>& timer);
    /// Nil where none was armed.
    [[nodiscard]] const std::shared_ptr<NSTimer>& _nextUpdateTimer() const noexcept {
        return _nextTimer;
    }
    [[nodiscard]] const std::shared_ptr<NSTimer>& _autoRefreshTimer() const noexcept {
        return _refreshTimer;
    }

    [[nodiscard]] Method methodForSelector(const Selector& selector) override;

protected:
    void _initWithTransitLineItems_refreshInterval(std::shared_ptr<NSArray> lineItems,
                                                   NSTimeInterval refreshInterval);

private:
    void _invalidateTimers();

    std::shared_ptr<NSOrderedSet> _updateDates = NSOrderedSet::orderedSet();
    std::shared_ptr<NSTimer> _nextTimer;
    std::shared_ptr<NSTimer> _refreshTimer;
    std::shared_ptr<NSArray> _lineItems;
    NSTimeInterval _refreshInterval = 0;
    std::weak_ptr<OWTransitIncidentUpdaterObserver> _observer;
};

} // namespace orvo
