#pragma once

#include "platform/foundation/NSError.h"
#include "platform/geoservices/AnalyticsPortal.h"

#include <vector>

namespace orvo {

/// A session as it is kept.
struct StoredAnalyticsSession {
    std::int64_t identifier = 0;
    double startedAt = 0; ///< seconds since 1970
    double duration = 0;  ///< seconds
    std::int64_t widgetType = 0;
    std::int64_t endState = 0;
    bool wasLocked = false;
    bool initiallyExpanded = false;
    bool everExpanded = false;
    std::int64_t messageType = 0;
    std::int64_t tappedItemIndex = 0;
    struct Item {
        std::string lineMuid;
        std::string incidentTitle;
    };
    std::vector<Item> incidents;
};

/// A user action as it is kept.
struct StoredAnalyticsAction {
    double at = 0; ///< seconds since 1970
    std::int64_t action = 0;
    std::int64_t target = 0;
};

/// The pipeline's store: `analytics.sqlite` in the profile's state folder, made at the first write,
/// the last `MaximumSessions` sessions and as many actions. A write that fails is said in the log
/// and lost. While the process keeps its writes in memory nothing is written. Nothing leaves the
/// machine.
class LocalAnalyticsStore final : public AnalyticsStore {
public:
    static constexpr std::int64_t MaximumSessions = 10'000;

    void addUserAction(std::int64_t action,
                       std::int64_t target,
                       const std::optional<std::string>& value) override;
    void
    addWidgetInteraction(std::int64_t type,
                         std::int64_t endState,
                         const std::shared_ptr<TransitWidgetAnalyticsRecord>& widgetSpecificObject,
                         bool wasLocked,
                         const std::shared_ptr<NSDate>& startDate,
                         NSTimeInterval duration) override;

    /// The newest first, at most `limit`. Empty where nothing was recorded; nil with an error for a
    /// file that cannot be read.
    [[nodiscard]] static std::optional<std::vector<StoredAnalyticsSession>>
    sessions(std::int64_t limit, std::shared_ptr<NSError>* error);
    [[nodiscard]] static std::optional<std::vector<StoredAnalyticsAction>>
    actions(std::int64_t limit, std::shared_ptr<NSError>* error);
};

} // namespace orvo
