#pragma once

#include "platform/favorites/FavoritesPersister.h"

#include <functional>
#include <mutex>

namespace orvo {

/// The person's favourites, for reading. Any thread.
class FavoritesContainer final : public virtual NSObject {
public:
    /// @throws NSInvalidArgumentException for a nil persister
    [[nodiscard]] static std::shared_ptr<FavoritesContainer>
    initWithPersister(std::shared_ptr<FavoritesPersister> persister);

    /// Calls the block once, on a worker queue and never inside this call, with all favourites in
    /// the person's order. Where they cannot be read the log says why, and the block is given what
    /// was read last, or an empty array. Keeps the container alive until then.
    void accessContentsUsingConcurrentBlock(
        std::function<void(const std::shared_ptr<NSArray>& favorites)> block) const;

    /// Why the latest access could not read them; nil when it could, and before the first.
    [[nodiscard]] std::shared_ptr<NSError> unreadable() const;

private:
    [[nodiscard]] std::shared_ptr<NSArray> contents() const;

    std::shared_ptr<FavoritesPersister> _persister;
    mutable std::mutex _mutex;
    mutable std::shared_ptr<NSArray> _lastRead;
    mutable std::shared_ptr<NSError> _unreadable;
};

} // namespace orvo
