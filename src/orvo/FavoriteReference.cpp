#include "orvo/FavoriteReference.h"

#include "orvo/LineReference.h"
#include "platform/favorites/FavoriteTransitLine.h"
#include "platform/favorites/StoredTransitLine.h"
#include "platform/feeds/schedule/LineMaker.h"
#include "platform/feeds/schedule/LineSearch.h"
#include "platform/foundation/Text.h"

#include <algorithm>
#include <charconv>
#include <fmt/format.h>
#include <iterator>
#include <utility>

namespace orvo::FavoriteReference {

namespace {

constexpr const char* SeeList = "See: orvo favorites list";

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

/// As it was kept; nil for what is no line.
std::shared_ptr<TransitLine> keptLine(const NSObject& favorite) {
    const auto* line = dynamic_cast<const FavoriteTransitLine*>(&favorite);
    return line ? line->transitLine() : nullptr;
}

/// The favourite as something to be searched, with both of its names.
ScheduleLine searched(const NSObject& favorite, const ScheduleStore* schedules) {
    ScheduleLine line;
    line.shortName = nameOf(favorite, nullptr);
    line.longName = nameOf(favorite, schedules);
    const auto kept = keptLine(favorite);
    if (const auto origin = kept ? StoredTransitLine::originOf(*kept) : std::nullopt) {
        line.feed = origin->feed;
        line.routeId = origin->routeId;
    }
    return line;
}

Answer notFound(const std::vector<FavoritesStore::Entry>& entries,
                const std::string& text,
                const ScheduleStore* schedules) {
    std::vector<ScheduleLine> lines;
    std::ranges::transform(entries, std::back_inserter(lines), [&](const auto& entry) {
        return searched(*entry.favorite, schedules);
    });
    const auto meant = LineReference::didYouMean(
        LineSearch(Text::locale().get()).near(std::move(lines), text, LineReference::MostMeant));
    return {std::nullopt,
            fmt::format("there is no favourite {}", text),
            meant.empty() ? SeeList : meant};
}

} // namespace

std::shared_ptr<TransitLine> lineOf(const NSObject& favorite, const ScheduleStore* schedules) {
    auto kept = keptLine(favorite);
    if (const auto known = kept && schedules ? schedules->line(kept->muid()) : std::nullopt)
        return makeTransitLine(*known);
    return kept;
}

std::string nameOf(const NSObject& favorite, const ScheduleStore* schedules) {
    if (const auto* place = dynamic_cast<const FavoritePlace*>(&favorite))
        return place->name();
    const auto line = lineOf(favorite, schedules);
    return line ? line->name().value_or("") : std::string();
}

std::optional<std::string> lineNameOf(const NSObject& favorite) {
    const auto line = keptLine(favorite);
    const auto origin = line ? StoredTransitLine::originOf(*line) : std::nullopt;
    if (!origin)
        return std::nullopt;
    return LineReference::nameOf(origin->feed, origin->routeId);
}

Answer resolve(const std::vector<FavoritesStore::Entry>& entries,
               const std::string& text,
               const ScheduleStore* schedules) {
    const auto number = wholeNumber(text);
    if (number && *number >= 1 && *number <= entries.size())
        return {*number - 1, {}, {}};
    std::optional<std::size_t> named;
    for (std::size_t i = 0; i < entries.size(); ++i) {
        const auto& favorite = *entries[i].favorite;
        if (lineNameOf(favorite) == text)
            return {i, {}, {}};
        if (!sameName(nameOf(favorite, nullptr), text) &&
            !sameName(nameOf(favorite, schedules), text))
            continue;
        if (named)
            return {std::nullopt, fmt::format("several favourites are called {}", text), SeeList};
        named = i;
    }
    return named ? Answer{named, {}, {}} : notFound(entries, text, schedules);
}

} // namespace orvo::FavoriteReference
