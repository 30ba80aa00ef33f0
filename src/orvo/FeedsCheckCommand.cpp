#include "orvo/FeedsCheckCommand.h"

#include "orvo/FeedChoice.h"
#include "orvo/FeedInspection.h"
#include "orvo/JsonParts.h"

#include <algorithm>
#include <ostream>

namespace orvo {

namespace {

void addSource(JsonWriter& json, const SourceRequest& request, const AlertSourceReport& source) {
    json.beginObject();
    json.key("location").value(request.displayLocation());
    JsonParts::addTime(
        json, "fetched", source.fetchedAt > 0 ? std::optional(source.fetchedAt) : std::nullopt);
    JsonParts::addTime(json, "header_time", source.headerTime);
    JsonParts::addError(json, source.error);
    json.endObject();
}

void addFeed(JsonWriter& json, const FeedConfiguration& feed, const FeedStatistics& statistics) {
    json.beginObject();
    json.key("feed").value(feed.name);
    json.key("lines").value(static_cast<std::int64_t>(statistics.lines));
    json.key("lines_with_incidents")
        .value(static_cast<std::int64_t>(statistics.linesWithIncidents));
    json.key("unknown_lines").value(static_cast<std::int64_t>(statistics.unknownLines));
    json.key("sources").beginArray();
    for (std::size_t i = 0; i < std::min(feed.alerts.size(), statistics.sources.size()); ++i)
        addSource(json, feed.alerts[i], statistics.sources[i]);
    json.endArray();
    json.key("counts").beginObject();
    for (std::size_t i = 0; i < static_cast<std::size_t>(AlertCount::Count_); ++i) {
        const auto reason = static_cast<AlertCount>(i);
        if (const auto count = statistics.alerts.count(reason); count > 0)
            json.key(AlertStatistics::nameOf(reason)).value(static_cast<std::int64_t>(count));
    }
    json.endObject().key("unresolved").beginObject();
    for (const auto& [what, count] : statistics.alerts.unresolved())
        json.key(what).value(static_cast<std::int64_t>(count));
    json.endObject();
    JsonParts::addError(json, statistics.error);
    json.endObject();
}

std::string json(const FeedChoice& choice, const FeedLookup::Answer& answer) {
    JsonWriter json;
    json.beginObject();
    JsonParts::addTime(json, "at", answer.at);
    json.key("feeds").beginArray();
    for (const auto& statistics : answer.feeds) {
        const auto feed =
            std::ranges::find(choice.feeds, statistics.feed, &FeedConfiguration::name);
        if (feed != choice.feeds.end())
            addFeed(json, *feed, statistics);
    }
    json.endArray();
    JsonParts::addError(json, answer.error);
    return json.endObject().text();
}

bool hasFailed(const FeedStatistics& statistics) {
    return statistics.error || std::ranges::any_of(statistics.sources, [](const auto& source) {
               return source.error != nullptr;
           });
}

} // namespace

CommandSpec FeedsCheckCommand::spec() const {
    return {.path = {"feeds", "check"},
            .summary = "Read the alerts now and say what they hold",
            .description =
                "Counts what was read, what was left out and why, and names what the "
                "schedule does not know. A server is asked also where it wanted a pause. "
                "Ends with 1 when a source could not be read.",
            .operands = {{.name = "NAME",
                          .help = "feeds; without it all",
                          .count = OperandSpec::Count::Any,
                          .completes = Completes::Feed}},
            .options = {{"json", "", "print JSON"}},
            .examples = {{"orvo feeds check city", "one feed"}}};
}

ExitCode FeedsCheckCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto choice = FeedChoice::of(arguments.operands(), context);
    FeedLookup::Answer answer;
    answer.at = context.now();
    answer.error = choice.error;
    if (!choice.error && !choice.feeds.empty())
        answer = FeedInspection::of(choice.feeds, context);
    auto& output = context.terminal().output();
    if (arguments.has("json"))
        output << json(choice, answer);
    else if (!choice.error && choice.feeds.empty())
        context.terminal().note("No feeds yet. Add one with: orvo feeds add");
    else
        for (const auto& statistics : answer.feeds)
            output << statistics.description();
    output << std::flush;
    if (choice.error)
        return context.fail(*choice.error);
    if (answer.error)
        return context.fail(*answer.error);
    return std::ranges::any_of(answer.feeds, hasFailed)
               ? context.fail("not every source could be read")
               : ExitCode::Answered;
}

} // namespace orvo
