#include "viewmodel/OWTransitSummaryItem.h"

#include "platform/foundation/NSString.h"
#include "viewmodel/TransitArtworkEquality.h"

#include <algorithm>

namespace orvo {

namespace {

bool sameArtworks(const std::shared_ptr<NSArray>& a, const std::shared_ptr<NSArray>& b) {
    if (!a || !b)
        return !a && !b;
    const auto artworksOfA = typed<TransitArtworkDataSource>(a);
    const auto artworksOfB = typed<TransitArtworkDataSource>(b);
    return std::ranges::equal(artworksOfA, artworksOfB, [](const auto& x, const auto& y) {
        return sameTransitArtwork(x, y);
    });
}

} // namespace

std::shared_ptr<OWTransitSummaryItem> OWTransitSummaryItem::initWithText_artworks_userActivityData(
    std::optional<std::string> text,
    std::shared_ptr<NSArray> artworks,
    std::shared_ptr<OWUserActivityData> userActivityData) {
    auto item = std::make_shared<OWTransitSummaryItem>();
    item->_primaryText = std::move(text);
    item->_artworks = std::move(artworks); // immutable, so a copy is the array itself
    item->_userActivityData = std::move(userActivityData);
    return item;
}

bool OWTransitSummaryItem::isEqual(const NSObject* other) const {
    const auto* item = dynamic_cast<const OWTransitSummaryItem*>(other);
    return item && isEqualToSummaryItem(*item);
}

bool OWTransitSummaryItem::isEqualToSummaryItem(const OWTransitSummaryItem& other) const {
    return _primaryText == other._primaryText &&
           equal(_userActivityData, other._userActivityData) &&
           sameArtworks(_artworks, other._artworks);
}

std::uint64_t OWTransitSummaryItem::hash() const {
    return hashOf(_primaryText) ^ hashOf(_artworks) ^ hashOf(_userActivityData);
}

std::string OWTransitSummaryItem::description() const {
    return rootDescription() + " text: " + _primaryText.value_or("(null)") +
           " artworks: " + descriptionOf(_artworks);
}

} // namespace orvo
