#pragma once

#include "platform/favorites/FavoritesPersister.h"

namespace orvo {

/// The favourites that the map application keeps on this machine: the `FavoritesStore` of the
/// profile in use, found and opened anew at each access, so that other processes' changes show.
class RemoteFavoritesPersister final : public virtual FavoritesPersister {
public:
    [[nodiscard]] static std::shared_ptr<RemoteFavoritesPersister> init();

    /// No store yet reads as no favourites.
    [[nodiscard]] std::shared_ptr<NSArray>
    favorites(std::shared_ptr<NSError>* error) const override;
};

} // namespace orvo
