#include "viewmodel/OWTransitItem.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSString.h"

#include <sstream>
#include <typeinfo>

namespace orvo {

std::shared_ptr<OWTransitItem>
OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
    std::optional<std::string> primaryText,
    std::optional<std::string> secondaryText,
    std::shared_ptr<OWConfiguredArtwork> artwork,
    bool artworkHidden,
    std::shared_ptr<OWOpenable> openable) {
    auto item = std::make_shared<OWTransitItem>();
    item->_initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        std::move(primaryText),
        std::move(secondaryText),
        std::move(artwork),
        artworkHidden,
        std::move(openable));
    return item;
}

void OWTransitItem::_initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
    std::optional<std::string> primaryText,
    std::optional<std::string> secondaryText,
    std::shared_ptr<OWConfiguredArtwork> artwork,
    bool artworkHidden,
    std::shared_ptr<OWOpenable> openable) {
    _primaryText = std::move(primaryText);
    _secondaryText = std::move(secondaryText);
    _artwork = std::move(artwork);
    _artworkHidden = artworkHidden;
    _openable = std::move(openable);
}

bool OWTransitItem::isEqual(const NSObject* other) const {
    if (this == other)
        return true;
    if (!other || typeid(*other) != typeid(OWTransitItem))
        return false;
    return isEqualToTransitItem(dynamic_cast<const OWTransitItem&>(*other));
}

bool OWTransitItem::isEqualToTransitItem(const OWTransitItem& other) const {
    return equal(_artwork, other._artwork) && _artworkHidden == other._artworkHidden &&
           _primaryText == other._primaryText && _secondaryText == other._secondaryText &&
           equal(_openable, other._openable);
}

std::uint64_t OWTransitItem::hash() const {
    return hashOf(_primaryText) ^ hashOf(_secondaryText) ^ hashOf(_artwork) ^
           (_artworkHidden ? HashMultiplier : 0) ^ hashOf(_openable);
}

std::string OWTransitItem::description() const {
    std::ostringstream text;
    text << "<" << className() << ":" << static_cast<const void*>(this)
         << " | text: " << _primaryText.value_or("(null)")
         << " | subtext: " << _secondaryText.value_or("(null)")
         << " | artwork: " << descriptionOf(_artwork)
         << " | hideArtwork?: " << (_artworkHidden ? "YES" : "NO")
         << " | openable: " << descriptionOf(_openable) << ">";
    return text.str();
}

std::shared_ptr<NSObject> OWTransitItem::copy() const {
    auto item = _alloc();
    item->_initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        _primaryText, _secondaryText, _artwork, _artworkHidden, _openable);
    return item;
}

} // namespace orvo
