#include "platform/favorites/TransitStorageAffectedEntity.h"

namespace orvo {

std::shared_ptr<TransitStorageAffectedEntity>
TransitStorageAffectedEntity::initWithAffectedEntity(const TransitIncidentAffectedEntity& entity) {
    auto storage = std::make_shared<TransitStorageAffectedEntity>();
    storage->assign(storage->_muid, entity.muid(), 1);
    storage->assign(storage->_hasNextStopIDs, entity.hasNextStopIDs(), 2);
    if (const auto stops = entity.nextStopIDs())
        for (const auto& stop : stops->elements()) {
            auto message = std::make_shared<TransitStorageStop>();
            message->setStopID(stringValue(stop.get()));
            storage->_nextStopIDs.push_back(std::move(message));
        }
    return storage;
}

std::shared_ptr<NSOrderedSet> TransitStorageAffectedEntity::nextStopIDs() const {
    if (!_hasNextStopIDs)
        return nullptr;
    NSOrderedSet::Elements stops;
    for (const auto& stop : _nextStopIDs)
        stops.push_back(NSString::string(stop->stopID().value_or("")));
    return NSOrderedSet::orderedSetWithObjects(stops);
}

} // namespace orvo
