#include "platform/favorites/FavoritesContainer.h"

#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/Log.h"

namespace orvo {

std::shared_ptr<FavoritesContainer>
FavoritesContainer::initWithPersister(std::shared_ptr<FavoritesPersister> persister) {
    if (!persister)
        throw NSInvalidArgumentException("A favorites container needs a persister.");
    auto container = std::make_shared<FavoritesContainer>();
    container->_persister = std::move(persister);
    return container;
}

void FavoritesContainer::accessContentsUsingConcurrentBlock(
    std::function<void(const std::shared_ptr<NSArray>&)> block) const {
    DispatchQueue::globalQueue()->async(
        [self = strong(this), block = std::move(block)] { block(self->contents()); });
}

std::shared_ptr<NSError> FavoritesContainer::unreadable() const {
    const std::lock_guard lock(_mutex);
    return _unreadable;
}

std::shared_ptr<NSArray> FavoritesContainer::contents() const {
    std::shared_ptr<NSError> error;
    auto favorites = _persister->favorites(&error);
    if (!favorites)
        Log::findOrCreate("Favorites")->error("%@", descriptionOf(error));
    const std::lock_guard lock(_mutex);
    _unreadable = favorites ? nullptr : error;
    if (favorites)
        return _lastRead = favorites;
    return _lastRead ? _lastRead : NSArray::array();
}

} // namespace orvo
