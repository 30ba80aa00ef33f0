#include "fetching/FavoritesContainer_OWFavorites.h"

#include "platform/favorites/RemoteFavoritesPersister.h"

namespace orvo::OWFavorites {

std::shared_ptr<FavoritesContainer> defaultContainer() {
    // On the heap for good: a fetch may still ask while the process ends.
    static const auto& container = *new std::shared_ptr<FavoritesContainer>(
        FavoritesContainer::initWithPersister(RemoteFavoritesPersister::init()));
    return container;
}

} // namespace orvo::OWFavorites
