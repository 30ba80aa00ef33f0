#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSDate.h"
#include "platform/geoservices/TransitWidgetAnalyticsRecord.h"

#include <cstdint>
#include <optional>
#include <string>

namespace orvo {

/// Where the analytics pipeline puts what it is given. Nothing leaves the machine.
class AnalyticsStore : public virtual NSObject {
public:
    virtual void addUserAction(std::int64_t action,
                               std::int64_t target,
                               const std::optional<std::string>& value) = 0;
    virtual void
    addWidgetInteraction(std::int64_t type,
                         std::int64_t endState,
                         const std::shared_ptr<TransitWidgetAnalyticsRecord>& widgetSpecificObject,
                         bool wasLocked,
                         const std::shared_ptr<NSDate>& startDate,
                         NSTimeInterval duration) = 0;
};

/// The entry of the analytics pipeline. It never reports an error back: what cannot be kept is
/// lost, and said in the log. Main thread.
class AnalyticsPortal {
public:
    AnalyticsPortal() = delete;

    /// Default: the profile's local store.
    static EnvironmentSlot<std::shared_ptr<AnalyticsStore>>& store();

    static void captureUserAction_target_value(std::int64_t action,
                                               std::int64_t target,
                                               const std::optional<std::string>& value);

    /// `widgetSpecificObject` may be nil. `duration` in seconds.
    static void
    captureOrvoWidgetsInteractionForType_endState_widgetSpecificObject_wasLocked_startDate_forDuration(
        std::int64_t type,
        std::int64_t endState,
        const std::shared_ptr<TransitWidgetAnalyticsRecord>& widgetSpecificObject,
        bool wasLocked,
        const std::shared_ptr<NSDate>& startDate,
        NSTimeInterval duration);
};

} // namespace orvo
