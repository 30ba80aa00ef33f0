#pragma once

#include "platform/mapuikit/LineItemTicket.h"

#include <atomic>
#include <cstdint>
#include <vector>

namespace orvo {

class FeedLookup;
class ScheduleUpdater;

/// A lookup in the person's feeds.
class FeedLineItemTicket final : public virtual LineItemTicket {
public:
    /// `updater` may be nil.
    [[nodiscard]] static std::shared_ptr<FeedLineItemTicket>
    initWithLookup_updater_muids(std::shared_ptr<const FeedLookup> lookup,
                                 std::shared_ptr<ScheduleUpdater> updater,
                                 std::vector<std::uint64_t> muids);

    void submitWithHandler_networkActivity(Handler handler,
                                           NetworkActivity networkActivity) override;

private:
    std::shared_ptr<const FeedLookup> _lookup;
    std::shared_ptr<ScheduleUpdater> _updater;
    std::vector<std::uint64_t> _muids;
    std::atomic<bool> _submitted = false;
};

} // namespace orvo
