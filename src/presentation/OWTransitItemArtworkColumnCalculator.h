#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSMapTable.h"
#include "presentation/ArtworkWidthCalculatorSizeParameter.h"
#include "viewmodel/OWTransitItem.h"

#include <functional>
#include <memory>

namespace orvo {

class SizedTransitArtwork;

/// Finds the width of the column in which rows show their artworks, and has the rows made again
/// whose artwork must be smaller. Keeps its last answer, and only that. Main thread.
class OWTransitItemArtworkColumnCalculator : public virtual NSObject {
public:
    /// The row to show in place of `item`, with the smaller artwork; nil keeps the item.
    using DownSizingBlock = std::function<std::shared_ptr<OWTransitItem>(
        const std::shared_ptr<OWTransitItem>& item,
        const std::shared_ptr<SizedTransitArtwork>& smallerArtwork)>;

    [[nodiscard]] static std::shared_ptr<OWTransitItemArtworkColumnCalculator> init();

    /// As many `OWTransitItem`s as given, in the same order. Rows whose artwork is no
    /// `SizedTransitArtwork` do not count and stay as they are. `outArtworkColumnWidth` and the
    /// block may be nil. The same items and parameter as the last time are not looked at again, and
    /// the block is not called.
    [[nodiscard]] std::shared_ptr<NSArray>
    itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
        const std::shared_ptr<NSArray>& items,
        const ArtworkWidthCalculatorSizeParameter& sizeParameter,
        double* outArtworkColumnWidth,
        const DownSizingBlock& downSizingBlock);
    /// The same, whatever the last time was.
    [[nodiscard]] std::shared_ptr<NSArray>
    _itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
        const std::shared_ptr<NSArray>& items,
        const ArtworkWidthCalculatorSizeParameter& sizeParameter,
        double* outArtworkColumnWidth,
        const DownSizingBlock& downSizingBlock);

    /// Nil before the first calculation.
    [[nodiscard]] const std::shared_ptr<NSArray>& cachedOriginalItems() const noexcept {
        return _cachedOriginalItems;
    }
    void setCachedOriginalItems(std::shared_ptr<NSArray> items) {
        _cachedOriginalItems = std::move(items);
    }
    [[nodiscard]] const std::shared_ptr<NSArray>& cachedItemsForPreviousWidth() const noexcept {
        return _cachedItemsForPreviousWidth;
    }
    void setCachedItemsForPreviousWidth(std::shared_ptr<NSArray> items) {
        _cachedItemsForPreviousWidth = std::move(items);
    }

private:
    ArtworkWidthCalculatorSizeParameter _previousSizeParameter; // as given
    double _cachedArtworkColumnWidthForPreviousWidth = 0;
    std::shared_ptr<NSArray> _cachedOriginalItems;
    std::shared_ptr<NSArray> _cachedItemsForPreviousWidth;
};

} // namespace orvo
