#include "platform/favorites/RemoteFavoritesPersister.h"

#include "platform/favorites/FavoritesStore.h"

namespace orvo {

std::shared_ptr<RemoteFavoritesPersister> RemoteFavoritesPersister::init() {
    return std::make_shared<RemoteFavoritesPersister>();
}

std::shared_ptr<NSArray>
RemoteFavoritesPersister::favorites(std::shared_ptr<NSError>* error) const {
    const auto store =
        FavoritesStore::open(FavoritesStore::standardPath(), FavoritesStore::Access::Read, error);
    return store ? store->favorites(error) : nullptr;
}

} // namespace orvo
