#pragma once

#include "platform/mapuikit/LookupService.h"

namespace orvo {

class FeedLookup;
class ScheduleUpdater;

/// Looks lines up in the person's feeds.
class FeedLookupService final : public virtual LookupService {
public:
    /// Over the profile in use, whichever that is at each lookup. What was kept of lines that no
    /// schedule knows comes from the favourites. Once a day, after an answer, the schedules are
    /// checked for newer ones.
    [[nodiscard]] static std::shared_ptr<FeedLookupService> init();
    /// `updater` is asked to check the schedules after each answer; nil does not.
    /// @throws NSInvalidArgumentException for a nil lookup
    [[nodiscard]] static std::shared_ptr<FeedLookupService>
    initWithLookup_updater(std::shared_ptr<const FeedLookup> lookup,
                           std::shared_ptr<ScheduleUpdater> updater);

    [[nodiscard]] std::shared_ptr<LineItemTicket>
    ticketForTransitLines_traits(const std::shared_ptr<NSArray>& identifiers,
                                 const std::shared_ptr<NSObject>& traits) override;

private:
    std::shared_ptr<const FeedLookup> _lookup;
    std::shared_ptr<ScheduleUpdater> _updater;
};

} // namespace orvo
