#include "orvo/IncidentsCommand.h"

#include "fetching/OWTransitIncidentFetcher.h"
#include "orvo/IncidentReportPrinter.h"
#include "orvo/UnknownLines.h"
#include "platform/feeds/FeedLookup.h"
#include "platform/feeds/ScheduleUpdater.h"
#include "platform/feeds/TravelPreferences.h"
#include "platform/feeds/alerts/AlertReader.h"
#include "platform/feeds/schedule/LineMaker.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/RunLoop.h"
#include "platform/mapuikit/LookupService.h"

#include <algorithm>
#include <atomic>
#include <ostream>

namespace orvo {

CommandSpec IncidentsCommand::spec() const {
    return {.path = {"incidents"},
            .summary = "Show what is known now of the favourite lines",
            .description =
                "Asks the feeds and prints each line with its current incidents and, fainter, "
                "those that begin within a day. A line whose feed could not be read is said to be "
                "unknown, never to be fine.",
            .options = {{"all", "", "every line of every feed instead of the favourites"},
                        {"json", "", "print JSON: times in UTC, incidents with their periods"}},
            .examples = {{"orvo incidents", "your favourite lines"},
                         {"orvo incidents --all --json", "everything, for a script"},
                         {"orvo incidents --at 2024-07-24T01:28:40Z", "as if it were then"},
                         {"orvo incidents --demo", "the demonstration city"}}};
}

namespace {

/// Of the feeds and their alerts another command tells more.
ExitCode fail(const NSError& error, CommandContext& context) {
    if (error.domain() != AlertErrorDomain && error.domain() != FeedLookupErrorDomain)
        return context.fail(error);
    return context.fail(error.localizedDescription(),
                        "See what the sources say with: orvo feeds check");
}

const char* whyEmpty(bool all, CommandContext& context) {
    if (!all)
        return "No favourite lines yet. Add one with: orvo favorites add LINE";
    return context.registry()->feeds().empty()
               ? "There are no feeds yet. Add one with: orvo feeds add"
               : "No feed has a schedule yet. Get them with: orvo feeds update";
}

} // namespace

ExitCode IncidentsCommand::run(const Arguments& arguments, CommandContext& context) {
    // The thread that asks for the main run loop first is the main thread.
    (void)RunLoop::main();
    // Not beside the answer: this program ends with it.
    const auto notYet = ScheduleUpdater::checksDaily().overrideWith(false);
    context.terminal().progress("Asking the feeds …");
    const bool all = arguments.has("all");
    const IncidentReport report = all ? ofAllLines(context) : ofFavorites(context);
    context.terminal().endProgress();
    if (arguments.has("json"))
        context.terminal().output() << report.json();
    if (report.error)
        return fail(*report.error, context);
    if (const auto error = TravelPreferences::unreadable())
        context.terminal().warning("your settings count as never made: " +
                                   error->localizedDescription());
    if (arguments.has("json")) {
        UnknownLines::warn(report, context);
        lookForNewerSchedules(context);
        return ExitCode::Answered;
    }
    IncidentReportPrinter(context.terminal())
        .print(report,
               all ? IncidentReportPrinter::Lines::WithIncidents
                   : IncidentReportPrinter::Lines::Each);
    UnknownLines::warn(report, context);
    if (report.lines.empty())
        context.terminal().note(whyEmpty(all, context));
    lookForNewerSchedules(context);
    return ExitCode::Answered;
}

void IncidentsCommand::lookForNewerSchedules(const CommandContext& context) {
    if (Environment::keepsWritesInMemory().get())
        return;
    context.terminal().output().flush();
    context.terminal().progress("Looking for newer schedules …");
    const auto allowed = ScheduleUpdater::checksDaily().overrideWith(true);
    const auto updater = ScheduleUpdater::make(ScheduleUpdater::profileGround());
    auto ended = std::make_shared<std::atomic<bool>>(false);
    updater->checkSchedules(
        [ended](std::size_t) { DispatchQueue::mainQueue()->async([ended] { *ended = true; }); });
    CommandContext::waitUntil([&] { return ended->load(); });
    context.terminal().endProgress();
}

IncidentReport IncidentsCommand::ofFavorites(CommandContext& context) {
    IncidentReport report;
    report.at = context.now();
    // The container answers with what it read last; favourites that cannot be read at all must not
    // look like none.
    if (const auto favorites =
            CommandContext::favorites(FavoritesStore::Access::Read, report.error))
        (void)favorites->entries(&report.error);
    if (report.error)
        return report;
    std::shared_ptr<NSError> storeError;
    const auto schedules = context.schedules(storeError);
    bool ended = false;
    const auto fetcher = OWTransitIncidentFetcher::init();
    const auto request = fetcher->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
        [&](const std::shared_ptr<Result>& result) {
            result->withValue_orError(
                [&](const Result::Value& value) {
                    report.lines = IncidentReport::linesOf(
                        std::dynamic_pointer_cast<NSArray>(value), schedules.get());
                },
                [&](const Result::Error& error) { report.error = error; });
            ended = true;
        });
    CommandContext::waitUntil([&] { return ended; });
    return report;
}

IncidentReport IncidentsCommand::ofAllLines(CommandContext& context) {
    IncidentReport report;
    report.at = context.now();
    const auto schedules = context.schedules(report.error);
    if (!schedules)
        return report;
    std::vector<std::string> feeds;
    for (const auto& feed : context.registry()->feeds(&report.error))
        feeds.push_back(feed.name);
    if (report.error)
        return report;
    std::ranges::sort(feeds);
    std::vector<std::shared_ptr<MapItemIdentifier>> identifiers;
    for (const auto& feed : feeds) {
        for (const auto& line : schedules->lines(feed, &report.error))
            identifiers.push_back(MapItemIdentifierFromTransitLine(makeTransitLine(line)));
    }
    if (report.error)
        return report;
    if (identifiers.empty())
        return report;
    bool ended = false;
    LookupService::sharedService()
        ->ticketForTransitLines_traits(NSArray::arrayOf(identifiers), nullptr)
        ->submitWithHandler_networkActivity(
            [&](const std::shared_ptr<NSArray>& items, const std::shared_ptr<NSError>& error) {
                report.error = error;
                if (!error)
                    report.lines = IncidentReport::linesOf(items, schedules.get());
                ended = true;
            },
            {});
    CommandContext::waitUntil([&] { return ended; });
    return report;
}

} // namespace orvo
