#include "platform/mapuikit/FeedLineItemTicket.h"

#include "platform/feeds/FeedLookup.h"
#include "platform/feeds/ScheduleUpdater.h"
#include "platform/foundation/DispatchQueue.h"

namespace orvo {

std::shared_ptr<FeedLineItemTicket>
FeedLineItemTicket::initWithLookup_updater_muids(std::shared_ptr<const FeedLookup> lookup,
                                                 std::shared_ptr<ScheduleUpdater> updater,
                                                 std::vector<std::uint64_t> muids) {
    auto ticket = std::make_shared<FeedLineItemTicket>();
    ticket->_lookup = std::move(lookup);
    ticket->_updater = std::move(updater);
    ticket->_muids = std::move(muids);
    return ticket;
}

void FeedLineItemTicket::submitWithHandler_networkActivity(Handler handler,
                                                           NetworkActivity networkActivity) {
    if (_submitted.exchange(true))
        throw NSInvalidArgumentException("A line item ticket is submitted once.");
    const auto& mainQueue = DispatchQueue::mainQueue();
    if (networkActivity)
        mainQueue->async([networkActivity] { networkActivity(true); });
    auto answered = [handler = std::move(handler),
                     networkActivity = std::move(networkActivity),
                     updater = _updater](const std::shared_ptr<NSArray>& items,
                                         const std::shared_ptr<NSError>& error) {
        if (networkActivity)
            networkActivity(false);
        if (handler)
            handler(items, error);
        if (updater)
            updater->checkSchedules({});
    };
    _lookup->lookUpLines(
        _muids, [&mainQueue, answered = std::move(answered)](const FeedLookup::Answer& answer) {
            auto items = answer.error ? nullptr : NSArray::arrayOf(answer.items);
            mainQueue->async([answered, items = std::move(items), error = answer.error] {
                answered(items, error);
            });
        });
}

} // namespace orvo
