#include "analytics/OWTransitIncidentsAnalyticsDelegate.h"

#include "analytics/DeviceLockState.h"
#include "platform/geoservices/AnalyticsPortal.h"
#include "platform/geoservices/TransitIncident.h"
#include "platform/geoservices/TransitLine.h"
#include "platform/mapuikit/TransitIncidentStringProvider.h"

namespace orvo {

namespace {

// The pipeline's numbers.
constexpr std::int64_t WidgetTarget = 706;
constexpr std::int64_t WidgetType = 2;

constexpr std::int64_t ActionExpanded = 10;
constexpr std::int64_t ActionCompact = 11;
constexpr std::int64_t ActionRowOpened = 9001;

constexpr std::int64_t EndStateRowOpened = 1;
constexpr std::int64_t EndStateSwipedAway = 2;

constexpr std::int64_t MessageNoLines = 1;
constexpr std::int64_t MessageNoIncident = 2;
constexpr std::int64_t MessageOneIncident = 3;
constexpr std::int64_t MessageSeveralIncidents = 4;

void capture(std::int64_t action) {
    AnalyticsPortal::captureUserAction_target_value(action, WidgetTarget, std::nullopt);
}

/// One answer of 1 means locked; else it takes a second question, answered with 2.
bool deviceIsLocked() {
    return DeviceLockState() == 1 || DeviceLockState() == 2;
}

} // namespace

std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>
OWTransitIncidentsAnalyticsDelegate::initWithTransitIncidentsViewController(
    const std::shared_ptr<UIViewController>& controller) {
    auto delegate = std::make_shared<OWTransitIncidentsAnalyticsDelegate>();
    delegate->_initWithTransitIncidentsViewController(controller);
    return delegate;
}

void OWTransitIncidentsAnalyticsDelegate::_initWithTransitIncidentsViewController(
    const std::shared_ptr<UIViewController>& controller) {
    _transitIncidentsViewController = controller;
}

bool OWTransitIncidentsAnalyticsDelegate::_isExpanded() const {
    const auto controller = _transitIncidentsViewController.lock();
    const auto context = controller ? controller->extensionContext() : nullptr;
    return context && context->widgetActiveDisplayMode() == NCWidgetDisplayMode::Expanded;
}

void OWTransitIncidentsAnalyticsDelegate::startSessionIfNeeded() {
    if (!_sessionStartDate)
        _sessionStartDate = NSDate::date();
    _sessionRecord = std::make_shared<TransitWidgetAnalyticsRecord>();
    const bool expanded = _isExpanded();
    _sessionRecord->setInitiallyExpanded(expanded);
    if (expanded)
        _sessionRecord->setEverExpanded(true);
}

void OWTransitIncidentsAnalyticsDelegate::recordWidgetChangeDisplayMode(NCWidgetDisplayMode mode) {
    if (!_sessionStartDate)
        return;
    const bool expanded = mode == NCWidgetDisplayMode::Expanded;
    if (expanded)
        _sessionRecord->setEverExpanded(true);
    capture(expanded ? ActionExpanded : ActionCompact);
}

std::int64_t OWTransitIncidentsAnalyticsDelegate::_messageTypeForIncidentCount(std::size_t count) {
    switch (count) {
    case 0:
        return MessageNoIncident;
    case 1:
        return MessageOneIncident;
    default:
        return MessageSeveralIncidents;
    }
}

void OWTransitIncidentsAnalyticsDelegate::
    recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
        const std::shared_ptr<NSArray>& lines,
        const std::shared_ptr<NSArray>& incidents,
        const std::shared_ptr<NSMapTable>& incidentsToLineMapping) {
    if (!_sessionRecord)
        return;
    const auto displayed = typed<TransitIncident>(incidents);
    const bool hasLines = lines && lines->count() > 0;
    _sessionRecord->setTransitMessageType(hasLines ? _messageTypeForIncidentCount(displayed.size())
                                                   : MessageNoLines);
    for (const auto& incident : displayed) {
        const auto item = std::make_shared<TransitIncidentAnalyticsItem>();
        const auto line = std::dynamic_pointer_cast<TransitLine>(
            incidentsToLineMapping ? incidentsToLineMapping->objectForKey(incident) : nullptr);
        item->setTransitLineMuid(std::to_string(line ? line->muid() : 0));
        item->setTransitIncidentTitle(
            TransitIncidentStringProvider::sharedProvider()->cellTitleForIncident(incident));
        _sessionRecord->addTransitIncidentItem(item);
    }
}

void OWTransitIncidentsAnalyticsDelegate::recordOpenItemAtIndexPath(
    const std::shared_ptr<NSIndexPath>& indexPath) {
    // In the expanded list the first row counts as 1, like the second; only the compact row is 0.
    const auto row = indexPath ? indexPath->row() : 0;
    const auto tapped = row == 0 && _isExpanded() ? 1 : row;
    if (_sessionRecord)
        _sessionRecord->setTappedItemIndex(tapped);
    capture(ActionRowOpened);
    _closeSessionWithEndState(EndStateRowOpened);
}

void OWTransitIncidentsAnalyticsDelegate::recordCloseSessionSwiping() {
    _closeSessionWithEndState(EndStateSwipedAway);
}

void OWTransitIncidentsAnalyticsDelegate::_closeSessionWithEndState(std::int64_t endState) {
    if (_sessionStartDate) {
        const bool locked = deviceIsLocked();
        const auto duration = -_sessionStartDate->timeIntervalSinceNow();
        AnalyticsPortal::
            captureOrvoWidgetsInteractionForType_endState_widgetSpecificObject_wasLocked_startDate_forDuration(
                WidgetType, endState, _sessionRecord, locked, _sessionStartDate, duration);
    }
    _sessionStartDate = nullptr;
    _sessionRecord = nullptr;
}

} // namespace orvo
