#include "platform/favorites/TransitStorageSystem.h"

namespace orvo {

std::shared_ptr<TransitStorageSystem>
TransitStorageSystem::initWithSystem(const std::shared_ptr<TransitSystem>& system) {
    if (!system)
        return nullptr;
    auto storage = std::make_shared<TransitStorageSystem>();
    storage->_name = system->name();
    storage->_artwork = TransitStorageArtwork::initWithArtwork(system->artwork());
    return storage;
}

} // namespace orvo
