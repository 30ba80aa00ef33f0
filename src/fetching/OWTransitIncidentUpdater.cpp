#include "fetching/OWTransitIncidentUpdater.h"

#include "platform/geoservices/TransitIncident.h"
#include "platform/geoservices/TransitLineItem.h"
#include "shared/WidgetLog.h"

#include <algorithm>
#include <utility>

namespace orvo {

namespace {

/// Of the refresh interval: how late a refresh may be so that wake-ups can be shared.
constexpr double RefreshTolerance = 0.1;

std::shared_ptr<NSDate> firstOf(const NSOrderedSet& dates) {
    return std::dynamic_pointer_cast<NSDate>(dates.firstObject());
}

bool isAfter(const std::shared_ptr<NSDate>& date, const NSDate& now) {
    return date && date->timeIntervalSinceDate(now) > 0;
}

void addDatesOfIncident(const TransitIncident& incident,
                        const NSDate& now,
                        std::vector<std::shared_ptr<NSDate>>& dates) {
    const auto start = incident.startDate();
    const auto end = incident.endDate();
    const bool hasNotBegun = isAfter(start, now);
    if (hasNotBegun)
        dates.push_back(start);
    // The end of what has not begun is taken as it is, even where it lies in the past.
    if (hasNotBegun ? end != nullptr : isAfter(end, now))
        dates.push_back(end);
}

} // namespace

std::shared_ptr<OWTransitIncidentUpdater>
OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(
    std::shared_ptr<NSArray> lineItems, NSTimeInterval refreshInterval) {
    auto updater = std::make_shared<OWTransitIncidentUpdater>();
    updater->_initWithTransitLineItems_refreshInterval(std::move(lineItems), refreshInterval);
    return updater;
}

void OWTransitIncidentUpdater::_initWithTransitLineItems_refreshInterval(
    std::shared_ptr<NSArray> lineItems, NSTimeInterval refreshInterval) {
    _lineItems = std::move(lineItems); // immutable, so a copy is the array itself
    _refreshInterval = refreshInterval;
    _calculateUpdateDatesForIncidents();
    _scheduleAutoRefreshTimer();
    _schedulateNextUpdate();
}

OWTransitIncidentUpdater::~OWTransitIncidentUpdater() {
    _invalidateTimers();
}

void OWTransitIncidentUpdater::invalidate() {
    _invalidateTimers();
}

void OWTransitIncidentUpdater::_invalidateTimers() {
    if (_refreshTimer)
        _refreshTimer->invalidate();
    if (_nextTimer)
        _nextTimer->invalidate();
}

void OWTransitIncidentUpdater::_calculateUpdateDatesForIncidents() {
    const auto now = NSDate::date();
    std::vector<std::shared_ptr<NSDate>> dates;
    for (const auto& line : typed<TransitLineItem>(_lineItems))
        for (const auto& incident : typed<TransitIncident>(line->incidents()))
            addDatesOfIncident(*incident, *now, dates);
    std::ranges::stable_sort(dates, {}, &NSDate::timeIntervalSinceReferenceDate);
    _updateDates = NSOrderedSet::orderedSetWithObjects({dates.begin(), dates.end()});
    widgetLog()->debug("Incident updater calculated update dates for incidents: %{private}@",
                       _updateDates);
}

void OWTransitIncidentUpdater::_scheduleAutoRefreshTimer() {
    if (_refreshTimer && _refreshTimer->isValid())
        _refreshTimer->invalidate();
    widgetLog()->debug("Scheduling incident updater  auto refresh update with interval %.2f",
                       _refreshInterval);
    _refreshTimer = NSTimer::scheduledTimerWithTimeInterval_target_selector_userInfo_repeats(
        _refreshInterval, strong(this), Selector("_autoRefreshTimerFired:"), nullptr, true);
    _refreshTimer->setTolerance(RefreshTolerance * _refreshInterval);
}

void OWTransitIncidentUpdater::_schedulateNextUpdate() {
    const auto first = firstOf(*_updateDates);
    if (!first)
        return;
    const auto interval = first->timeIntervalSinceNow();
    if (interval > 0)
        _nextTimer = NSTimer::scheduledTimerWithTimeInterval_target_selector_userInfo_repeats(
            interval, strong(this), Selector("_nextUpdateTimerFired:"), nullptr, false);
}

void OWTransitIncidentUpdater::_nextUpdateTimerFired(const std::shared_ptr<NSTimer>&) {
    auto date = firstOf(*_updateDates);
    if (date) {
        widgetLog()->debug("Incident updater next update date was reached: %{private}@.", date);
        const auto& dates = _updateDates->elements();
        _updateDates = NSOrderedSet::orderedSetWithObjects({dates.begin() + 1, dates.end()});
        _schedulateNextUpdate();
    } else {
        widgetLog()->error("Incident updater next update date timer fired but we should not have "
                           "any update anymore.");
        date = NSDate::date();
    }
    if (const auto target = observer())
        target->transitIncidentUpdater_dateExpired(strong(this), date);
}

void OWTransitIncidentUpdater::_autoRefreshTimerFired(const std::shared_ptr<NSTimer>&) {
    widgetLog()->debug("Incident updater auto-refresh timer fired.");
    if (const auto target = observer())
        target->transitIncidentUpdaterNeedsRefresh(strong(this));
}

NSObject::Method OWTransitIncidentUpdater::methodForSelector(const Selector& selector) {
    using Handler = void (OWTransitIncidentUpdater::*)(const std::shared_ptr<NSTimer>&);
    const auto performing = [this](Handler handler) -> Method {
        return [this, handler](const std::shared_ptr<NSObject>& sender) {
            (this->*handler)(std::dynamic_pointer_cast<NSTimer>(sender));
            return nullptr;
        };
    };
    if (selector == Selector("_nextUpdateTimerFired:"))
        return performing(&OWTransitIncidentUpdater::_nextUpdateTimerFired);
    if (selector == Selector("_autoRefreshTimerFired:"))
        return performing(&OWTransitIncidentUpdater::_autoRefreshTimerFired);
    return NSObject::methodForSelector(selector);
}

} // namespace orvo
