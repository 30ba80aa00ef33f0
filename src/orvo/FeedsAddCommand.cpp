#include "orvo/FeedsAddCommand.h"

#include "orvo/FeedInspection.h"
#include "orvo/ScheduleImporter.h"
#include "orvo/console/Counted.h"

#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

/// Name and value on the two sides of a separator.
std::optional<std::pair<std::string, std::string>> split(const std::string& text, char separator) {
    const std::size_t at = text.find(separator);
    if (at == 0 || at == std::string::npos)
        return std::nullopt;
    std::string value = text.substr(at + 1);
    if (separator == ':')
        value.erase(0, value.find_first_not_of(' '));
    return std::pair(text.substr(0, at), std::move(value));
}

} // namespace

CommandSpec FeedsAddCommand::spec() const {
    return {
        .path = {"feeds", "add"},
        .summary = "Add a feed: a schedule and its alerts",
        .description =
            "Imports the GTFS schedule, which may be a zip file or a folder, and tries the "
            "GTFS-Realtime alerts. Alerts that cannot be read now are a warning: the feed is added "
            "all the same.\n"
            "Headers, query parameters and the user are sent with every request of this feed. They "
            "are kept in a file that only you can read, and are never shown.",
        .operands = {{.name = "NAME", .help = "a short name of your choice"}},
        .options = {{.name = "static",
                     .value = "PATH|URL",
                     .help = "the schedule",
                     .completes = Completes::File,
                     .isRequired = true},
                    {.name = "alerts",
                     .value = "PATH|URL",
                     .help = "where its alerts are",
                     .takesSeveral = true,
                     .completes = Completes::File,
                     .isRequired = true},
                    {.name = "header",
                     .value = "NAME:VALUE",
                     .help = "an HTTP header to send",
                     .takesSeveral = true},
                    {.name = "query",
                     .value = "NAME=VALUE",
                     .help = "a query parameter to send",
                     .takesSeveral = true},
                    {.name = "user", .value = "NAME:PASSWORD", .help = "for basic authorization"},
                    {.name = "replace",
                     .value = "",
                     .help = "take the place of a feed of that name"}},
        .examples = {
            {"orvo feeds add city --static city.zip --alerts https://city.example/alerts.pb",
             "a schedule from a file, alerts from a server"},
            {"orvo feeds add bay --static https://bay.example/gtfs.zip --alerts "
             "https://bay.example/a.pb --header \"X-Api-Key: 1234\"",
             "with a key"}}};
}

std::variant<FeedConfiguration, UsageError>
FeedsAddCommand::configurationFrom(const Arguments& arguments) {
    SourceRequest request;
    for (const auto& text : arguments.values("header")) {
        auto header = split(text, ':');
        if (!header)
            return UsageError{"--header needs a name and a value", "Write --header NAME:VALUE."};
        request.headers.push_back(std::move(*header));
    }
    for (const auto& text : arguments.values("query")) {
        auto parameter = split(text, '=');
        if (!parameter)
            return UsageError{"--query needs a name and a value", "Write --query NAME=VALUE."};
        request.query.push_back(std::move(*parameter));
    }
    request.userPassword = arguments.value("user");
    if (request.userPassword && !split(*request.userPassword, ':'))
        return UsageError{"--user needs a name and a password", "Write --user NAME:PASSWORD."};
    const auto source = [&](const std::string& location) {
        // What a server must know is no business of a file.
        SourceRequest plain;
        plain.location = location;
        if (!plain.isRemote())
            return plain;
        SourceRequest whole = request;
        whole.location = location;
        return whole;
    };
    FeedConfiguration feed;
    feed.name = arguments.operands().front();
    feed.schedule = source(arguments.value("static").value_or(""));
    for (const auto& location : arguments.values("alerts"))
        feed.alerts.push_back(source(location));
    return feed;
}

ExitCode FeedsAddCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto parsed = configurationFrom(arguments);
    if (const auto* error = std::get_if<UsageError>(&parsed))
        return context.wrongUsage(error->message, error->cure);
    auto feed = std::get<FeedConfiguration>(parsed);
    if (const auto problem = feed.problem())
        return context.wrongUsage(problem->localizedDescription());
    auto& registry = *context.registry();
    std::shared_ptr<NSError> unread;
    const bool exists = registry.feed(feed.name, &unread).has_value();
    // A damaged file is set aside when the feed is added. One that is only hidden may have a feed
    // of that name, whose schedule must stay.
    if (unread && unread->domain() != FeedErrorDomain)
        return context.fail(*unread);
    if (exists && !arguments.has("replace"))
        return context.fail(fmt::format("there is a feed {} already", feed.name),
                            "Choose another name, or say --replace.");
    ScheduleImporter importer(context);
    const auto imported = importer.run(feed, ScheduleImporter::Wish::InAnyCase);
    if (imported.error)
        return context.fail(*imported.error);
    feed.lastScheduleCheck = context.now();
    if (const auto error = exists ? registry.replace(feed) : registry.add(feed))
        return context.fail(*error);
    context.terminal().output()
        << fmt::format("{} {}: {} of {}\n",
                       exists ? "Replaced" : "Added",
                       feed.name,
                       Counted::text(imported.report.lines, "line", "lines"),
                       Counted::text(imported.report.agencies, "agency", "agencies"))
        << std::flush;
    importer.sayNotes(imported.report);
    tryAlerts(feed, context);
    return ExitCode::Answered;
}

void FeedsAddCommand::tryAlerts(const FeedConfiguration& feed, CommandContext& context) {
    const auto answer = FeedInspection::of({feed}, context);
    for (const auto& statistics : answer.feeds) {
        for (std::size_t i = 0; i < statistics.sources.size(); ++i) {
            const auto& error = statistics.sources[i].error;
            if (!error)
                continue;
            const auto location = feed.alerts[i].displayLocation();
            auto reason = feed.alerts[i].withoutSecrets(error->localizedDescription());
            if (reason.starts_with(location + ": ")) // once is enough
                reason.erase(0, location.size() + 2);
            context.terminal().warning(
                fmt::format("the alerts {} cannot be read now: {}", location, reason),
                fmt::format("Try again later with: orvo feeds check {}", feed.name));
        }
        const auto others = statistics.alerts.count(AlertCount::OtherEntities);
        if (others > 0 && statistics.alerts.count(AlertCount::Alerts) == 0)
            context.terminal().warning(
                fmt::format("the alerts of {} have {} and no alert",
                            feed.name,
                            Counted::text(others, "other entry", "other entries")),
                "Where they are trip updates or vehicles, its lines would always look fine: give "
                "the address of the service alerts, with --replace.");
    }
}

} // namespace orvo
