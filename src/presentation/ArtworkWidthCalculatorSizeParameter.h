#pragma once

#include "platform/uikit/UIGeometry.h"

namespace orvo {

/// How wide a column of artworks may be, in points.
struct ArtworkWidthCalculatorSizeParameter {
    double defaultArtworkViewWidth = 0; ///< at least
    double maxArtworkViewWidth = 0;     ///< at most
    UIEdgeInsets artworkInsets;         ///< around an artwork; left and right count

    /// Every number exactly.
    friend bool operator==(const ArtworkWidthCalculatorSizeParameter&,
                           const ArtworkWidthCalculatorSizeParameter&) = default;
};

} // namespace orvo
