#include "orvo/FavoritesListCommand.h"

#include "orvo/FavoriteReference.h"
#include "orvo/JsonParts.h"
#include "orvo/console/TextTable.h"
#include "platform/favorites/StoredTransitLine.h"

#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

std::optional<std::string> systemName(const TransitLine& line) {
    return line.system() ? line.system()->name() : std::nullopt;
}

void addFavorite(JsonWriter& json, const NSObject& favorite, const ScheduleStore* schedules) {
    if (const auto line = FavoriteReference::lineOf(favorite, schedules)) {
        const auto origin = StoredTransitLine::originOf(*line);
        json.key("kind").value("line");
        json.key("feed").value(origin ? std::optional(origin->feed) : std::nullopt);
        json.key("route_id").value(origin ? std::optional(origin->routeId) : std::nullopt);
        json.key("muid").value(fmt::format("{}", line->muid()));
        json.key("name").value(line->name());
        json.key("system").value(systemName(*line));
    } else if (const auto* place = dynamic_cast<const FavoritePlace*>(&favorite)) {
        json.key("kind").value("place");
        json.key("name").value(place->name());
        json.key("latitude").value(place->latitude());
        json.key("longitude").value(place->longitude());
    }
}

std::string json(const std::vector<FavoritesStore::Entry>& entries,
                 const ScheduleStore* schedules,
                 const std::shared_ptr<NSError>& error) {
    JsonWriter json;
    json.beginObject().key("favorites").beginArray();
    for (const auto& entry : entries) {
        json.beginObject();
        addFavorite(json, *entry.favorite, schedules);
        json.endObject();
    }
    json.endArray();
    JsonParts::addError(json, error);
    return json.endObject().text();
}

std::vector<std::string>
row(std::size_t number, const NSObject& favorite, const ScheduleStore* schedules) {
    const auto* place = dynamic_cast<const FavoritePlace*>(&favorite);
    const auto line = FavoriteReference::lineOf(favorite, schedules);
    const std::string where =
        place ? fmt::format("{:.5g}, {:.5g}", place->latitude(), place->longitude()) : "";
    return {fmt::format("{}", number),
            FavoriteReference::lineNameOf(favorite).value_or(place ? "(place)" : ""),
            line ? line->name().value_or("") : FavoriteReference::nameOf(favorite, nullptr),
            line ? systemName(*line).value_or("") : where};
}

} // namespace

CommandSpec FavoritesListCommand::spec() const {
    return {.path = {"favorites", "list"},
            .summary = "List the favourites in their order",
            .description = "Lines have the names that their schedules have for them now, in your "
                           "language; where there is no schedule, those that they had when they "
                           "were added.",
            .options = {{"json", "", "print JSON"}},
            .examples = {{"orvo favorites list", "numbers, lines and places"}}};
}

ExitCode FavoritesListCommand::run(const Arguments& arguments, CommandContext& context) {
    std::shared_ptr<NSError> error;
    std::vector<FavoritesStore::Entry> entries;
    if (const auto store = CommandContext::favorites(FavoritesStore::Access::Read, error))
        entries = store->entries(&error);
    const auto schedules = entries.empty() ? nullptr : context.schedulesIfReadable();
    if (arguments.has("json"))
        context.terminal().output() << json(entries, schedules.get(), error);
    if (error)
        return context.fail(*error);
    if (arguments.has("json"))
        return ExitCode::Answered;
    if (entries.empty()) {
        context.terminal().note("No favourites yet. Add one with: orvo favorites add LINE");
        return ExitCode::Answered;
    }
    TextTable table({{"#", TextTable::Column::Alignment::Right, false},
                     {"Line", TextTable::Column::Alignment::Left, false},
                     {"Name"},
                     {"System"}});
    for (std::size_t i = 0; i < entries.size(); ++i)
        table.addRow(row(i + 1, *entries[i].favorite, schedules.get()));
    table.print(context.terminal());
    return ExitCode::Answered;
}

} // namespace orvo
