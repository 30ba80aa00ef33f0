#include "orvo/LinesCommand.h"

#include "orvo/JsonParts.h"
#include "orvo/LineReference.h"
#include "orvo/console/Counted.h"
#include "orvo/console/DisplayText.h"
#include "orvo/console/TextTable.h"

#include <algorithm>
#include <charconv>
#include <fmt/format.h>
#include <limits>
#include <ostream>

namespace orvo {

namespace {

constexpr std::size_t StandardLimit = 200;

const char* modeOf(const ScheduleLine& line) {
    switch (basicRouteType(line.routeType)) {
    case 0:
        return "tram";
    case 1:
        return "metro";
    case 2:
        return "rail";
    case 3:
        return "bus";
    case 4:
        return "ferry";
    case 5:
        return "cable tram";
    case 6:
        return "cable car";
    case 7:
        return "funicular";
    case 11:
        return "trolleybus";
    case 12:
        return "monorail";
    default:
        return "other";
    }
}

/// Nothing for what is no number of lines.
std::optional<std::size_t> limitFrom(const std::string& text) {
    std::size_t limit = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, limit);
    if (result.ec != std::errc() || result.ptr != end)
        return std::nullopt;
    return limit == 0 ? std::numeric_limits<std::size_t>::max() : limit;
}

/// What was found, and how much of it is shown.
struct Found {
    std::vector<ScheduleLine> lines;
    std::size_t total = 0;
};

/// All lines of the feed of that name, else what the search finds.
Found find(const ScheduleStore& schedules,
           const std::string& search,
           std::optional<std::size_t> limit,
           std::shared_ptr<NSError>& error) {
    Found found;
    found.lines = schedules.lines(search, &error);
    if (error)
        return found;
    const bool isFeed = !found.lines.empty();
    if (!isFeed)
        found.lines = schedules.search(search, std::numeric_limits<std::size_t>::max(), &error);
    found.total = found.lines.size();
    if (!isFeed || limit)
        found.lines.resize(std::min(found.total, limit.value_or(StandardLimit)));
    return found;
}

std::string json(const Found& found, const std::shared_ptr<NSError>& error) {
    JsonWriter json;
    json.beginObject().key("lines").beginArray();
    for (const auto& line : found.lines) {
        json.beginObject();
        json.key("feed").value(line.feed);
        json.key("route_id").value(line.routeId);
        json.key("muid").value(fmt::format("{}", line.muid));
        json.key("name").value(line.name());
        json.key("short_name").value(line.shortName);
        json.key("long_name").value(line.longName);
        json.key("system").value(line.agency.name);
        json.key("mode").value(modeOf(line));
        json.endObject();
    }
    json.endArray();
    json.key("total").value(static_cast<std::int64_t>(found.total));
    JsonParts::addError(json, error);
    return json.endObject().text();
}

/// With the lines that may have been meant.
std::string noMatch(const std::string& search, const ScheduleStore& schedules) {
    const auto meant =
        LineReference::didYouMean(schedules.linesNear(search, LineReference::MostMeant));
    return fmt::format("No line matches {}.{}{}", search, meant.empty() ? "" : " ", meant);
}

} // namespace

CommandSpec LinesCommand::spec() const {
    return {
        .path = {"lines"},
        .summary = "Find lines in the schedules",
        .description = fmt::format(
            "Looks for the words in short names, long names and the names of agencies, best "
            "match first. Case and accents do not count. The first column is what favorites "
            "add takes. Of a search the best {} are shown, of a feed all lines. Where nothing is "
            "found, also for want of a schedule, that is the answer: the exit code is 0, and "
            "the list of --json is empty.",
            StandardLimit),
        .operands = {{.name = "SEARCH",
                      .help = "words, or the name of a feed for all its lines",
                      .count = OperandSpec::Count::OneOrMore,
                      .completes = Completes::Feed}},
        .options = {{"limit", "N", "show at most so many lines; 0 for all"},
                    {"json", "", "print JSON: the lines, and in total how many there are"}},
        .examples = {{"orvo lines harbour", "lines whose names speak of a harbour"},
                     {"orvo lines city", "all lines of the feed city"}}};
}

ExitCode LinesCommand::run(const Arguments& arguments, CommandContext& context) {
    std::string search;
    for (const auto& word : arguments.operands())
        search += (search.empty() ? "" : " ") + word;
    if (DisplayText::oneLine(search).empty())
        return context.wrongUsage("SEARCH is empty",
                                  "Write a part of a name, or the name of a feed for all its "
                                  "lines.");
    const auto wish = arguments.value("limit");
    const auto limit = wish ? limitFrom(*wish) : std::nullopt;
    if (wish && !limit)
        return context.wrongUsage(fmt::format("--limit cannot be \"{}\"", *wish),
                                  "Write a number, or 0 for all lines.");
    std::shared_ptr<NSError> error;
    const auto schedules = context.schedules(error);
    const Found found = schedules ? find(*schedules, search, limit, error) : Found{};
    if (arguments.has("json"))
        context.terminal().output() << json(found, error);
    if (error)
        return context.fail(*error);
    if (arguments.has("json"))
        return ExitCode::Answered;
    const bool hasFeeds = !schedules->feeds(&error).empty();
    if (error)
        return context.fail(*error);
    if (!hasFeeds) {
        context.terminal().note(
            fmt::format("There is no schedule yet. {}", LineReference::NoScheduleCure));
        return ExitCode::Answered;
    }
    TextTable table({{"Line", TextTable::Column::Alignment::Left, false},
                     {"Short", TextTable::Column::Alignment::Left, false},
                     {"Name"},
                     {"System"},
                     {"Mode", TextTable::Column::Alignment::Left, false}});
    for (const auto& line : found.lines)
        table.addRow({LineReference::nameOf(line.feed, line.routeId),
                      line.shortName,
                      line.longName,
                      line.agency.name,
                      modeOf(line)});
    if (found.lines.empty())
        context.terminal().note(noMatch(search, *schedules));
    else
        table.print(context.terminal());
    context.terminal().output().flush();
    if (found.lines.size() < found.total)
        context.terminal().note(
            fmt::format("{} of {}. Narrow the search, or show all with --limit 0.",
                        Counted::grouped(found.lines.size()),
                        Counted::text(found.total, "line", "lines")));
    return ExitCode::Answered;
}

} // namespace orvo
