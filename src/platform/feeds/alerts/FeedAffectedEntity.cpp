#include "platform/feeds/alerts/FeedAffectedEntity.h"

#include "platform/foundation/NSString.h"

#include <utility>

namespace orvo {

std::shared_ptr<FeedAffectedEntity> FeedAffectedEntity::initWithMuid_stops_firstStop_endStop(
    std::uint64_t muid, Stops stops, std::size_t firstStop, std::size_t endStop) {
    auto entity = std::make_shared<FeedAffectedEntity>();
    entity->_muid = muid;
    if (firstStop < endStop) {
        entity->_stops = std::move(stops);
        entity->_firstStop = firstStop;
        entity->_endStop = endStop;
    }
    return entity;
}

std::shared_ptr<NSOrderedSet> FeedAffectedEntity::nextStopIDs() const {
    if (!hasNextStopIDs())
        return nullptr;
    NSOrderedSet::Elements stops;
    stops.reserve(_endStop - _firstStop);
    for (std::size_t i = _firstStop; i < _endStop; ++i)
        stops.push_back(NSString::string((*_stops)[i]));
    return NSOrderedSet::orderedSetWithObjects(stops);
}

} // namespace orvo
