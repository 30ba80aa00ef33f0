#include "viewmodel/ArtworkDataSourceCacheTransitWidget.h"

namespace orvo {

std::shared_ptr<ArtworkDataSourceCache>
ArtworkDataSourceCacheTransitWidget::memoryConstrainedImageViewCache() {
    const auto iconManager = IconManager::sharedManager();
    if (iconManager)
        iconManager->setIsCachingAtlases(false);
    return ArtworkDataSourceCache::initWithArtworkManager(
        TransitArtworkManager::initWithIconManager(iconManager));
}

} // namespace orvo
