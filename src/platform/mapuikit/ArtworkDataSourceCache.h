#pragma once

#include "platform/geoservices/TransitArtworkDataSource.h"
#include "platform/mapuikit/TransitArtworkManager.h"
#include "platform/uikit/UIImage.h"

#include <cstddef>
#include <list>
#include <map>
#include <tuple>

namespace orvo {

/// Keeps the pictures of artworks, the most recently used ones, within `MaximumBytes`. Main thread.
class ArtworkDataSourceCache : public virtual NSObject {
public:
    static constexpr std::size_t MaximumBytes = 4U << 20U;

    /// `artworkManager` may be nil.
    [[nodiscard]] static std::shared_ptr<ArtworkDataSourceCache>
    initWithArtworkManager(std::shared_ptr<TransitArtworkManager> artworkManager);

    [[nodiscard]] const std::shared_ptr<TransitArtworkManager>& artworkManager() const noexcept {
        return _artworkManager;
    }

    /// The artwork's picture at a shield size (0 to 7; others count as the nearest) for a screen of
    /// `scale` pixels a point. Drawn when it is not kept. Nil for a nil artwork, or one that shows
    /// nothing.
    [[nodiscard]] virtual std::shared_ptr<UIImage> imageForArtwork_shieldSize_scale_nightMode(
        const std::shared_ptr<TransitArtworkDataSource>& artwork,
        std::int64_t shieldSize,
        double scale,
        bool nightMode);
    /// Lets every picture go; the cache stays usable.
    virtual void purge();

    /// How many pictures were drawn in this cache's life.
    [[nodiscard]] std::size_t renderCount() const noexcept { return _renderCount; }
    [[nodiscard]] std::size_t bytes() const noexcept { return _bytes; }

private:
    struct Entry {
        std::shared_ptr<TransitArtworkDataSource> artwork;
        std::int64_t shieldSize;
        double scale;
        bool nightMode;
        std::shared_ptr<UIImage> image;
    };
    void keep(Entry entry);

    std::shared_ptr<TransitArtworkManager> _artworkManager;
    std::list<Entry> _entries; // most recently used first; a widget has some dozens
    std::size_t _bytes = 0;
    std::size_t _renderCount = 0;
};

} // namespace orvo
