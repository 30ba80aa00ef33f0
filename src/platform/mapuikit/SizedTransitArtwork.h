#pragma once

#include "platform/mapuikit/ArtworkDataSourceCache.h"
#include "platform/uikit/ArtworkImageSource.h"

#include <cstdint>
#include <memory>

namespace orvo {

/// A line's or system's artwork at a size. Immutable.
class SizedTransitArtwork : public ArtworkImageSource {
public:
    /// `artwork` and `artworkCache` may be nil; then there is nothing to show. `shieldSize` 0 to 7,
    /// a smaller one is smaller.
    [[nodiscard]] static std::shared_ptr<SizedTransitArtwork>
    initWithArtwork_shieldSize_artworkCache(std::shared_ptr<TransitArtworkDataSource> artwork,
                                            std::int64_t shieldSize,
                                            std::shared_ptr<ArtworkDataSourceCache> artworkCache);

    [[nodiscard]] const std::shared_ptr<TransitArtworkDataSource>& artwork() const noexcept {
        return _artwork;
    }
    [[nodiscard]] std::int64_t shieldSize() const noexcept { return _shieldSize; }
    [[nodiscard]] const std::shared_ptr<ArtworkDataSourceCache>& artworkCache() const noexcept {
        return _artworkCache;
    }

    [[nodiscard]] std::shared_ptr<UIImage>
    imageToDisplayWithScreenScale_nightMode(double scale, bool nightMode) override;

    [[nodiscard]] std::string _dumpedName() const override;

    /// The artwork by transit artwork equality, the size, and the same cache object.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    std::shared_ptr<TransitArtworkDataSource> _artwork;
    std::int64_t _shieldSize = 0;
    std::shared_ptr<ArtworkDataSourceCache> _artworkCache;
};

} // namespace orvo
