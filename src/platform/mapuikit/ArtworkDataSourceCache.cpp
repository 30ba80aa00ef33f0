#include "platform/mapuikit/ArtworkDataSourceCache.h"

#include <algorithm>

namespace orvo {

namespace {

/// What keeping a picture costs. Artwork that shows nothing is kept too, and costs as well: else a
/// stream of it would know no bounds.
std::size_t bytesOf(const std::shared_ptr<UIImage>& image) {
    constexpr std::size_t Overhead = 256;
    return Overhead + (image ? image->pixels().size_bytes() : 0);
}

} // namespace

std::shared_ptr<ArtworkDataSourceCache> ArtworkDataSourceCache::initWithArtworkManager(
    std::shared_ptr<TransitArtworkManager> artworkManager) {
    auto cache = std::make_shared<ArtworkDataSourceCache>();
    cache->_artworkManager = std::move(artworkManager);
    return cache;
}

std::shared_ptr<UIImage> ArtworkDataSourceCache::imageForArtwork_shieldSize_scale_nightMode(
    const std::shared_ptr<TransitArtworkDataSource>& artwork,
    std::int64_t shieldSize,
    double scale,
    bool nightMode) {
    const auto iconManager = _artworkManager ? _artworkManager->iconManager() : nullptr;
    if (!artwork || !iconManager)
        return nullptr;
    const auto known = std::ranges::find_if(_entries, [&](const Entry& entry) {
        return entry.shieldSize == shieldSize && entry.scale == scale &&
               entry.nightMode == nightMode && equal(entry.artwork, artwork);
    });
    if (known != _entries.end()) {
        _entries.splice(_entries.begin(), _entries, known);
        return known->image;
    }
    auto image = iconManager->drawnImageForArtwork_shieldSize_scale_nightMode(
        *artwork, shieldSize, scale, nightMode);
    ++_renderCount;
    keep({artwork, shieldSize, scale, nightMode, image});
    return image;
}

void ArtworkDataSourceCache::keep(Entry entry) {
    _bytes += bytesOf(entry.image);
    _entries.push_front(std::move(entry));
    while (_bytes > MaximumBytes) {
        _bytes -= bytesOf(_entries.back().image);
        _entries.pop_back();
    }
}

void ArtworkDataSourceCache::purge() {
    _entries.clear();
    _bytes = 0;
}

} // namespace orvo
