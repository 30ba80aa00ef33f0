#include "platform/mapuikit/SizedTransitArtwork.h"

#include "platform/foundation/Hashing.h"
#include "platform/mapuikit/IconManager.h"

namespace orvo {

std::shared_ptr<SizedTransitArtwork> SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(
    std::shared_ptr<TransitArtworkDataSource> artwork,
    std::int64_t shieldSize,
    std::shared_ptr<ArtworkDataSourceCache> artworkCache) {
    auto sized = std::make_shared<SizedTransitArtwork>();
    sized->_artwork = std::move(artwork);
    sized->_shieldSize = shieldSize;
    sized->_artworkCache = std::move(artworkCache);
    return sized;
}

std::shared_ptr<UIImage>
SizedTransitArtwork::imageToDisplayWithScreenScale_nightMode(double scale, bool nightMode) {
    if (!_artworkCache)
        return nullptr;
    return _artworkCache->imageForArtwork_shieldSize_scale_nightMode(
        _artwork, _shieldSize, scale, nightMode);
}

std::string SizedTransitArtwork::_dumpedName() const {
    return _artwork ? IconManager::_nameOfArtwork(*_artwork) : "";
}

bool SizedTransitArtwork::isEqual(const NSObject* other) const {
    const auto* sized = dynamic_cast<const SizedTransitArtwork*>(other);
    return sized && equal(_artwork, sized->_artwork) && _shieldSize == sized->_shieldSize &&
           _artworkCache == sized->_artworkCache; // the same cache, not an equal one
}

std::uint64_t SizedTransitArtwork::hash() const {
    return hashOf(_artwork) ^ static_cast<std::uint64_t>(_shieldSize) * HashMultiplier;
}

std::string SizedTransitArtwork::description() const {
    const auto shield = _artwork ? _artwork->shieldDataSource() : nullptr;
    return rootDescription() +
           " shield: " + (shield ? shield->shieldText().value_or("(null)") : "(null)") +
           " size: " + std::to_string(_shieldSize);
}

} // namespace orvo
