#include "presentation/OWTransitItemArtworkColumnCalculator.h"

#include "platform/foundation/NSNumber.h"
#include "platform/mapuikit/SizedTransitArtwork.h"
#include "presentation/TransitDirectionsListArtworkWidthCalculator.h"
#include "shared/OrvoMap.h"

namespace orvo {

namespace {

using Calculator = OWTransitItemArtworkColumnCalculator;

/// Nil where the row shows something else, or nothing.
std::shared_ptr<SizedTransitArtwork> sizedArtworkOf(const OWTransitItem& item) {
    return item.artwork()
               ? std::dynamic_pointer_cast<SizedTransitArtwork>(item.artwork()->artworkSource())
               : nullptr;
}

/// Of two rows with equal artworks `positions` knows the later, so that only that one is replaced.
std::shared_ptr<NSArray> replaced(const std::shared_ptr<NSArray>& items,
                                  const std::shared_ptr<NSMapTable>& replacements,
                                  const NSMapTable& positions,
                                  const Calculator::DownSizingBlock& downSizingBlock) {
    auto adjusted = typed<OWTransitItem>(items);
    replacements->enumerate([&](const std::shared_ptr<NSObject>& artwork) {
        const auto number = std::dynamic_pointer_cast<NSNumber>(positions.objectForKey(artwork));
        const auto position = number ? number->unsignedIntegerValue() : adjusted.size();
        if (position >= adjusted.size() || !downSizingBlock)
            return true;
        if (auto item = downSizingBlock(adjusted[position],
                                        std::dynamic_pointer_cast<SizedTransitArtwork>(
                                            replacements->objectForKey(artwork))))
            adjusted[position] = std::move(item);
        return true;
    });
    return NSArray::arrayOf(adjusted);
}

} // namespace

std::shared_ptr<OWTransitItemArtworkColumnCalculator> OWTransitItemArtworkColumnCalculator::init() {
    return std::make_shared<OWTransitItemArtworkColumnCalculator>();
}

std::shared_ptr<NSArray> OWTransitItemArtworkColumnCalculator::
    itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
        const std::shared_ptr<NSArray>& items,
        const ArtworkWidthCalculatorSizeParameter& sizeParameter,
        double* outArtworkColumnWidth,
        const DownSizingBlock& downSizingBlock) {
    const bool isKnown = sizeParameter == _previousSizeParameter && _cachedOriginalItems &&
                         equal(_cachedOriginalItems, items);
    if (!isKnown)
        return _itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
            items, sizeParameter, outArtworkColumnWidth, downSizingBlock);
    if (outArtworkColumnWidth)
        *outArtworkColumnWidth = _cachedArtworkColumnWidthForPreviousWidth;
    return _cachedItemsForPreviousWidth;
}

std::shared_ptr<NSArray> OWTransitItemArtworkColumnCalculator::
    _itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
        const std::shared_ptr<NSArray>& items,
        const ArtworkWidthCalculatorSizeParameter& sizeParameter,
        double* outArtworkColumnWidth,
        const DownSizingBlock& downSizingBlock) {
    const auto positions = NSMapTable::strongToStrongObjectsMapTable();
    const auto artworks = OrvoMap(items, [&](const auto& element, std::size_t position) {
        const auto item = std::dynamic_pointer_cast<OWTransitItem>(element);
        auto artwork = item ? sizedArtworkOf(*item) : nullptr;
        if (artwork)
            positions->setObject_forKey(NSNumber::numberWithUnsignedInteger(position), artwork);
        return artwork;
    });
    const auto replacements =
        TransitDirectionsListArtworkWidthCalculator::initWithSizedArtworks_sizeParameter(
            artworks, sizeParameter)
            ->calculateArtworkViewWidthAndArtworkSizes(&_cachedArtworkColumnWidthForPreviousWidth);
    setCachedItemsForPreviousWidth(
        replacements->count() == 0 ? items
                                   : replaced(items, replacements, *positions, downSizingBlock));
    setCachedOriginalItems(items);
    _previousSizeParameter = sizeParameter;
    if (outArtworkColumnWidth)
        *outArtworkColumnWidth = _cachedArtworkColumnWidthForPreviousWidth;
    return cachedItemsForPreviousWidth();
}

} // namespace orvo
