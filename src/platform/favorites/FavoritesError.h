#pragma once

#include "platform/foundation/NSError.h"

namespace orvo {

/// Domain of the store's errors.
inline constexpr const char* FavoritesErrorDomain = "FavoritesErrorDomain";

/// Codes of `FavoritesErrorDomain`. Every message names the file and the reason.
enum class FavoritesError : std::int64_t {
    CannotOpen = 1,  ///< not to be opened or made, or written by a later version of this program
    CannotRead = 2,  ///< opened, but not to be read
    CannotWrite = 3, ///< nothing was changed
    NotFound = 4,    ///< no such favourite
    Locked = 5,      ///< another program held the file all the while; nothing was changed
};

[[nodiscard]] std::shared_ptr<NSError> favoritesError(FavoritesError code, std::string message);

} // namespace orvo
