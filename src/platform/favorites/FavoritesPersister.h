#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSError.h"

namespace orvo {

/// Where favourites are kept.
class FavoritesPersister : public virtual NSObject {
public:
    /// All favourites in the person's order: `FavoriteTransitLine`s, `FavoritePlace`s and whatever
    /// else is kept. Nil when they cannot be read; `error` then says why. Called on worker threads,
    /// several at a time.
    [[nodiscard]] virtual std::shared_ptr<NSArray>
    favorites(std::shared_ptr<NSError>* error) const = 0;
};

} // namespace orvo
