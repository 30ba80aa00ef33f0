#include "orvo/FavoritesAddCommand.h"

#include "orvo/LineReference.h"
#include "platform/feeds/schedule/LineMaker.h"

#include <charconv>
#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

std::optional<double> degrees(std::string_view text, double limit) {
    while (!text.empty() && text.front() == ' ')
        text.remove_prefix(1);
    double value = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
    const bool isNumber = result.ec == std::errc() && result.ptr == text.data() + text.size();
    return isNumber && value >= -limit && value <= limit ? std::optional(value) : std::nullopt;
}

/// Latitude and longitude.
std::optional<std::pair<double, double>> parseLocation(const std::string& text) {
    const std::size_t comma = text.find(',');
    if (comma == std::string::npos)
        return std::nullopt;
    const auto latitude = degrees(std::string_view(text).substr(0, comma), 90);
    const auto longitude = degrees(std::string_view(text).substr(comma + 1), 180);
    if (!latitude || !longitude)
        return std::nullopt;
    return std::pair(*latitude, *longitude);
}

void say(const CommandContext& context,
         const std::string& name,
         FavoritesStore::Addition addition) {
    const bool isNew = addition == FavoritesStore::Addition::Added;
    context.terminal().output() << (isNew ? "Added " : "Already a favourite: ") << name << '\n';
}

} // namespace

CommandSpec FavoritesAddCommand::spec() const {
    return {
        .path = {"favorites", "add"},
        .summary = "Add lines, or a place, to the favourites",
        .description = "They are added at the end. Either all lines are added or none.",
        .operands = {{.name = "LINE",
                      .help = "FEED:ROUTE_ID, or a name that only one line has",
                      .count = OperandSpec::Count::Any,
                      .completes = Completes::Line}},
        .options = {{"place", "NAME", "add a place of that name instead"},
                    {"location", "LAT,LON", "where the place is, in degrees"}},
        .examples = {{"orvo favorites add M1 city:T4", "two lines"},
                     {"orvo favorites add --place Home --location 54.3821,10.1401", "a place"}}};
}

ExitCode FavoritesAddCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto place = arguments.value("place");
    if (!place && arguments.has("location"))
        return context.wrongUsage("--location belongs to a place", "Add --place NAME.");
    if (place && !arguments.operands().empty())
        return context.wrongUsage("lines and a place cannot be added together",
                                  "Use the command twice.");
    if (place)
        return addPlace(*place, arguments.value("location"), context);
    if (arguments.operands().empty())
        return context.wrongUsage("LINE is missing", fmt::format("Usage: orvo {}", spec().usage()));
    return addLines(arguments.operands(), context);
}

ExitCode FavoritesAddCommand::addPlace(const std::string& name,
                                       const std::optional<std::string>& location,
                                       const CommandContext& context) {
    if (name.empty())
        return context.wrongUsage("a place needs a name", "Write --place NAME.");
    const auto where = location ? parseLocation(*location) : std::nullopt;
    if (!where)
        return context.wrongUsage(
            location ? fmt::format("--location: {} is no latitude and longitude", *location)
                     : "a place needs its location",
            "Write it in degrees, as --location 54.3821,10.1401.");
    std::shared_ptr<NSError> error;
    const auto store = CommandContext::favorites(FavoritesStore::Access::Write, error);
    if (!store)
        return context.fail(*error);
    auto addition = FavoritesStore::Addition::Added;
    error = store->addPlace(
        *FavoritePlace::initWithName_latitude_longitude(name, where->first, where->second),
        &addition);
    if (error)
        return context.fail(*error);
    say(context, name, addition);
    return ExitCode::Answered;
}

ExitCode FavoritesAddCommand::addLines(const std::vector<std::string>& names,
                                       CommandContext& context) {
    std::shared_ptr<NSError> error;
    const auto schedules = context.schedules(error);
    if (!schedules)
        return context.fail(*error);
    std::vector<ScheduleLine> lines;
    for (const auto& name : names) {
        const auto answer = LineReference::resolve(*schedules, name);
        if (!answer.line)
            return context.fail(answer.message, answer.cure);
        lines.push_back(*answer.line);
    }
    const auto store = CommandContext::favorites(FavoritesStore::Access::Write, error);
    if (!store)
        return context.fail(*error);
    for (const auto& line : lines) {
        auto addition = FavoritesStore::Addition::Added;
        if ((error = store->addLine(*makeTransitLine(line), &addition)))
            return context.fail(*error);
        say(context,
            fmt::format("{} ({}, {})",
                        LineReference::nameOf(line.feed, line.routeId),
                        line.name(),
                        line.agency.name),
            addition);
    }
    return ExitCode::Answered;
}

} // namespace orvo
