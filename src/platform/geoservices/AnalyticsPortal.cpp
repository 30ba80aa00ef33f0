#include "platform/geoservices/AnalyticsPortal.h"

#include "platform/geoservices/LocalAnalyticsStore.h"

namespace orvo {

EnvironmentSlot<std::shared_ptr<AnalyticsStore>>& AnalyticsPortal::store() {
    static EnvironmentSlot<std::shared_ptr<AnalyticsStore>> slot(
        [] { return std::shared_ptr<AnalyticsStore>(std::make_shared<LocalAnalyticsStore>()); });
    return slot;
}

void AnalyticsPortal::captureUserAction_target_value(std::int64_t action,
                                                     std::int64_t target,
                                                     const std::optional<std::string>& value) {
    store().get()->addUserAction(action, target, value);
}

void AnalyticsPortal::
    captureOrvoWidgetsInteractionForType_endState_widgetSpecificObject_wasLocked_startDate_forDuration(
        std::int64_t type,
        std::int64_t endState,
        const std::shared_ptr<TransitWidgetAnalyticsRecord>& widgetSpecificObject,
        bool wasLocked,
        const std::shared_ptr<NSDate>& startDate,
        NSTimeInterval duration) {
    store().get()->addWidgetInteraction(
        type, endState, widgetSpecificObject, wasLocked, startDate, duration);
}

} // namespace orvo
