#pragma once

#include "platform/favorites/FavoriteTransitLineRecord.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/geoservices/TransitLineItemRecord.h"
#include "platform/mapuikit/LookupService.h"

#include <deque>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace orvo::testing {

inline TransitLineRecord::Fields lineFields(std::uint64_t muid, const std::string& name) {
    TransitLineRecord::Fields fields;
    fields.muid = muid;
    fields.name = name;
    fields.identifier = MapItemIdentifier::identifierWithMuid(muid);
    return fields;
}

inline std::shared_ptr<TransitLineRecord> makeLine(std::uint64_t muid,
                                                   const std::string& name = "Line") {
    return TransitLineRecord::initWithFields(lineFields(muid, name));
}

inline std::shared_ptr<FavoriteTransitLineRecord> makeFavorite(std::uint64_t muid) {
    return FavoriteTransitLineRecord::initWithTransitLine(makeLine(muid));
}

/// An item of the line; its incidents may be nil.
inline std::shared_ptr<TransitLineItemRecord>
makeItem(std::uint64_t muid, std::shared_ptr<NSArray> incidents = NSArray::array()) {
    return TransitLineItemRecord::initWithFields_service(
        lineFields(muid, "Line"), {std::move(incidents), false, true, false, nullptr});
}

/// A lookup service with a queue of answers and a list of what was asked. It answers on the queue
/// it is given, and leaves a lookup for which no answer is left unanswered.
class FakeLookup final : public LookupService {
public:
    struct Answer {
        std::shared_ptr<NSArray> items;
        std::shared_ptr<NSError> error;
    };
    struct Asked {
        std::shared_ptr<NSArray> identifiers;
        std::shared_ptr<NSObject> traits;
        int submissions = 0;
        bool withNetworkActivity = false;
    };

    std::shared_ptr<DispatchQueue> queue = DispatchQueue::mainQueue();

    void answerWith(Answer answer) {
        const std::lock_guard lock(_mutex);
        _answers.push_back(std::move(answer));
    }
    std::vector<Asked> asked() const {
        const std::lock_guard lock(_mutex);
        return _asked;
    }

    std::shared_ptr<LineItemTicket>
    ticketForTransitLines_traits(const std::shared_ptr<NSArray>& identifiers,
                                 const std::shared_ptr<NSObject>& traits) override {
        const std::lock_guard lock(_mutex);
        _asked.push_back({identifiers, traits});
        return std::make_shared<Ticket>(strong(this), _asked.size() - 1);
    }

private:
    class Ticket final : public LineItemTicket {
    public:
        Ticket(std::shared_ptr<FakeLookup> lookup, std::size_t number)
            : _lookup(std::move(lookup))
            , _number(number) {}
        void submitWithHandler_networkActivity(Handler handler,
                                               NetworkActivity networkActivity) override {
            _lookup->submit(_number, std::move(handler), static_cast<bool>(networkActivity));
        }

    private:
        std::shared_ptr<FakeLookup> _lookup;
        std::size_t _number;
    };

    void submit(std::size_t number, LineItemTicket::Handler handler, bool withNetworkActivity) {
        const std::lock_guard lock(_mutex);
        ++_asked[number].submissions;
        _asked[number].withNetworkActivity = withNetworkActivity;
        if (_answers.empty())
            return;
        queue->async([handler = std::move(handler), answer = _answers.front()] {
            handler(answer.items, answer.error);
        });
        _answers.pop_front();
    }

    mutable std::mutex _mutex;
    std::deque<Answer> _answers;
    std::vector<Asked> _asked;
};

} // namespace orvo::testing
