#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSExtensionContext.h"
#include "platform/foundation/NSMapTable.h"
#include "platform/geoservices/TransitWidgetAnalyticsRecord.h"
#include "platform/uikit/NSIndexPath.h"
#include "platform/uikit/UIViewController.h"

#include <cstdint>
#include <memory>

namespace orvo {

/// Records one analytics session for each appearance of the widget: what it showed, what was
/// tapped, how it ended. Main thread.
class OWTransitIncidentsAnalyticsDelegate : public virtual NSObject {
public:
    /// Keeps the controller weakly.
    [[nodiscard]] static std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>
    initWithTransitIncidentsViewController(const std::shared_ptr<UIViewController>& controller);

    /// A session that runs keeps its start; its record is always a new one, so what the old one had
    /// collected is dropped.
    virtual void startSessionIfNeeded();
    /// Ends the session, if there is one, as swiped away.
    virtual void recordCloseSessionSwiping();
    /// Nothing without a session.
    virtual void recordWidgetChangeDisplayMode(NCWidgetDisplayMode mode);
    /// `lines`: every `TransitLine` of the list; `incidents`: the displayed `TransitIncident`s;
    /// `incidentsToLineMapping`: each of these to its line. Adds to what the session has already;
    /// without a session nothing is stored.
    virtual void recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
        const std::shared_ptr<NSArray>& lines,
        const std::shared_ptr<NSArray>& incidents,
        const std::shared_ptr<NSMapTable>& incidentsToLineMapping);
    /// Records the tap, even without a session, and ends the session as opened.
    virtual void recordOpenItemAtIndexPath(const std::shared_ptr<NSIndexPath>& indexPath);

    [[nodiscard]] static std::int64_t _messageTypeForIncidentCount(std::size_t count);

protected:
    void
    _initWithTransitIncidentsViewController(const std::shared_ptr<UIViewController>& controller);

private:
    [[nodiscard]] bool _isExpanded() const;
    void _closeSessionWithEndState(std::int64_t endState);

    std::shared_ptr<NSDate> _sessionStartDate;
    std::shared_ptr<TransitWidgetAnalyticsRecord> _sessionRecord;
    std::weak_ptr<UIViewController> _transitIncidentsViewController;
};

} // namespace orvo
