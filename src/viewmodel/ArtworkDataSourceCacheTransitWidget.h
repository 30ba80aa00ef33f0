#pragma once

#include "platform/mapuikit/ArtworkDataSourceCache.h"

namespace orvo::ArtworkDataSourceCacheTransitWidget {

/// A new artwork cache, each time, that leaves no atlases behind in the shared icon manager: what a
/// widget can afford.
[[nodiscard]] std::shared_ptr<ArtworkDataSourceCache> memoryConstrainedImageViewCache();

} // namespace orvo::ArtworkDataSourceCacheTransitWidget
