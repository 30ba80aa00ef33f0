#pragma once

#include "platform/favorites/FavoritesContainer.h"

namespace orvo::OWFavorites {

/// The process's container of the person's favourites, made when first asked for and never
/// released. Any thread.
[[nodiscard]] std::shared_ptr<FavoritesContainer> defaultContainer();

} // namespace orvo::OWFavorites
