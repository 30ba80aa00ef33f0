#include "platform/mapuikit/TransitArtworkManager.h"

namespace orvo {

std::shared_ptr<TransitArtworkManager>
TransitArtworkManager::initWithIconManager(std::shared_ptr<IconManager> iconManager) {
    auto manager = std::make_shared<TransitArtworkManager>();
    manager->_iconManager = std::move(iconManager);
    return manager;
}

} // namespace orvo
