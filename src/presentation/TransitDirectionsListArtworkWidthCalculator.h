#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSMapTable.h"
#include "platform/mapuikit/SizedTransitArtwork.h"
#include "presentation/ArtworkWidthCalculatorSizeParameter.h"

#include <memory>

namespace orvo {

/// Finds the width of a column that shows some artworks: that of the widest, within the limits.
/// Artworks wider than the maximum are taken in smaller shield sizes, the widest first, one size at
/// a time. For one calculation. Main thread.
class TransitDirectionsListArtworkWidthCalculator : public virtual NSObject {
public:
    /// `artworks`: `SizedTransitArtwork`s. Limits that contradict themselves are put right: a
    /// negative default width counts as 50, one of 0 stays 0, and a maximum below the default is
    /// raised to it.
    [[nodiscard]] static std::shared_ptr<TransitDirectionsListArtworkWidthCalculator>
    initWithSizedArtworks_sizeParameter(std::shared_ptr<NSArray> artworks,
                                        ArtworkWidthCalculatorSizeParameter sizeParameter);

    [[nodiscard]] const std::shared_ptr<NSArray>& artworks() const noexcept { return _artworks; }
    [[nodiscard]] const ArtworkWidthCalculatorSizeParameter& sizeParameter() const noexcept {
        return _sizeParameter;
    }

    /// Each artwork that must be smaller, by equality, to its smaller form. One that is too wide in
    /// every size does not count for the width, and has its smallest form. `width` may be nil.
    [[nodiscard]] std::shared_ptr<NSMapTable>
    calculateArtworkViewWidthAndArtworkSizes(double* width) const;

private:
    std::shared_ptr<NSArray> _artworks;
    ArtworkWidthCalculatorSizeParameter _sizeParameter;
};

} // namespace orvo
