#include "orvo/FavoriteReference.h"

#include "orvo/LineReference.h"
#include "platform/favorites/FavoriteTransitLine.h"
#include "platform/favorites/StoredTransitLine.h"
#include "platform/foundation/Text.h"

#include <charconv>
#include <fmt/format.h>

namespace orvo::FavoriteReference {

namespace {

std::optional<std::size_t> wholeNumber(const std::string& text) {
    std::size_t number = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number);
    return result.ec == std::errc() && result.ptr == end ? std::optional(number) : std::nullopt;
}

/// Case and accents do not count.
bool sameName(const std::string& a, const std::string& b) {
    const auto range = Text::localizedStandardRange(a, b);
    return range && range->location == 0 && range->length == Text::utf16Length(a);
}

} // namespace

std::string nameOf(const NSObject& favorite) {
    if (const auto* place = dynamic_cast<const FavoritePlace*>(&favorite))
        return place->name();
    const auto* line = dynamic_cast<const FavoriteTransitLine*>(&favorite);
    return line && line->transitLine() ? line->transitLine()->name().value_or("") : std::string();
}

std::optional<std::string> lineNameOf(const NSObject& favorite) {
    const auto* line = dynamic_cast<const FavoriteTransitLine*>(&favorite);
    if (!line || !line->transitLine())
        return std::nullopt;
    const auto origin = StoredTransitLine::originOf(*line->transitLine());
    if (!origin)
        return std::nullopt;
    return LineReference::nameOf(origin->feed, origin->routeId);
}

Answer resolve(const std::vector<FavoritesStore::Entry>& entries, const std::string& text) {
    const auto number = wholeNumber(text);
    if (number && *number >= 1 && *number <= entries.size())
        return {*number - 1, {}};
    std::optional<std::size_t> named;
    for (std::size_t i = 0; i < entries.size(); ++i) {
        const auto& favorite = *entries[i].favorite;
        if (lineNameOf(favorite) == text)
            return {i, {}};
        if (!sameName(nameOf(favorite), text))
            continue;
        if (named)
            return {std::nullopt, fmt::format("several favourites are called {}", text)};
        named = i;
    }
    if (named)
        return {named, {}};
    return {std::nullopt, fmt::format("there is no favourite {}", text)};
}

} // namespace orvo::FavoriteReference
