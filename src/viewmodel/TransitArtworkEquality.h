#pragma once

#include "platform/geoservices/TransitArtworkDataSource.h"

#include <memory>

namespace orvo {

/// Whether two lines' or systems' artworks are called the same: both nil, or equal in every field.
[[nodiscard]] inline bool sameTransitArtwork(const std::shared_ptr<TransitArtworkDataSource>& a,
                                             const std::shared_ptr<TransitArtworkDataSource>& b) {
    return equal(a, b);
}

} // namespace orvo
