#pragma once

#include "platform/favorites/FavoritesStore.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

/// How a person names one of their favourites: its number in the list from 1, `FEED:ROUTE_ID`, or
/// its name where only one has it. A favourite whose name is a number is named by it only when
/// there is no such number in the list.
namespace orvo::FavoriteReference {

struct Answer {
    std::optional<std::size_t> index; ///< into the entries
    std::string message;              ///< why there is none, without a full stop
};

[[nodiscard]] Answer resolve(const std::vector<FavoritesStore::Entry>& entries,
                             const std::string& text);

/// What a person calls the favourite.
[[nodiscard]] std::string nameOf(const NSObject& favorite);
/// `FEED:ROUTE_ID`; nothing for a place, or a line of no feed.
[[nodiscard]] std::optional<std::string> lineNameOf(const NSObject& favorite);

} // namespace orvo::FavoriteReference
