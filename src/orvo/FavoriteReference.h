#pragma once

#include "platform/favorites/FavoritesStore.h"
#include "platform/feeds/schedule/ScheduleStore.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <vector>

/// How a person names one of their favourites: its number in the list from 1, `FEED:ROUTE_ID`, or
/// its name where only one has it. A line has the name that its schedule has for it, in the
/// person's language, and that by which it was kept when it was added. A favourite whose name is a
/// number is named by it only when there is no such number in the list.
namespace orvo::FavoriteReference {

struct Answer {
    std::optional<std::size_t> index; ///< into the entries
    std::string message;              ///< why there is none, without a full stop
    std::string cure;                 ///< what to do, a sentence
};

/// @param schedules may be nil, here and below: then lines have their kept names only
[[nodiscard]] Answer resolve(const std::vector<FavoritesStore::Entry>& entries,
                             const std::string& text,
                             const ScheduleStore* schedules);

/// The line as its schedule has it, in the person's language, present or departed; else the copy
/// that was kept. Nil for what is no line.
[[nodiscard]] std::shared_ptr<TransitLine> lineOf(const NSObject& favorite,
                                                  const ScheduleStore* schedules);
/// What a person calls the favourite: the name of its line as above, or of the place.
[[nodiscard]] std::string nameOf(const NSObject& favorite, const ScheduleStore* schedules);
/// `FEED:ROUTE_ID`; nothing for a place, or a line of no feed.
[[nodiscard]] std::optional<std::string> lineNameOf(const NSObject& favorite);

} // namespace orvo::FavoriteReference
