#include "platform/favorites/FavoritesError.h"

namespace orvo {

std::shared_ptr<NSError> favoritesError(FavoritesError code, std::string message) {
    return NSError::errorWithMessage(
        FavoritesErrorDomain, static_cast<std::int64_t>(code), std::move(message));
}

} // namespace orvo
