#include "orvo/FeedsUpdateCommand.h"

#include "orvo/FeedChoice.h"
#include "orvo/ScheduleImporter.h"
#include "orvo/console/Counted.h"

#include <fmt/format.h>
#include <ostream>

namespace orvo {

CommandSpec FeedsUpdateCommand::spec() const {
    return {.path = {"feeds", "update"},
            .summary = "Import schedules anew",
            .description = "Servers are asked whether there is a newer one. A schedule that cannot "
                           "be had or read leaves the earlier one as it is.",
            .operands = {{.name = "NAME",
                          .help = "feeds; without it all",
                          .count = OperandSpec::Count::Any,
                          .completes = Completes::Feed}},
            .options = {{"force", "", "import in any case"}},
            .examples = {{"orvo feeds update", "all feeds"},
                         {"orvo feeds update city --force", "one, whatever its server says"}}};
}

ExitCode FeedsUpdateCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto choice = FeedChoice::of(arguments.operands(), context);
    if (choice.error)
        return context.fail(*choice.error);
    const auto wish = arguments.has("force") ? ScheduleImporter::Wish::InAnyCase
                                             : ScheduleImporter::Wish::WhenNewer;
    ScheduleImporter importer(context);
    auto code = ExitCode::Answered;
    auto& output = context.terminal().output();
    for (const auto& feed : choice.feeds) {
        const auto answer = importer.run(feed, wish);
        auto error = answer.error;
        if (!error)
            error = context.registry()->setLastScheduleCheck(feed.name, context.now());
        if (error) {
            code = context.fail(fmt::format("{}: {}", feed.name, error->localizedDescription()));
        } else if (answer.outcome == ScheduleUpdate::Outcome::Unchanged) {
            output << fmt::format("{}: nothing newer\n", feed.name) << std::flush;
        } else {
            output << fmt::format("{}: {}, {} new, {} gone\n",
                                  feed.name,
                                  Counted::text(answer.report.lines, "line", "lines"),
                                  answer.report.newLines,
                                  answer.report.departedLines)
                   << std::flush;
            importer.sayNotes(answer.report);
        }
    }
    if (choice.feeds.empty())
        context.terminal().note("No feeds yet. Add one with: orvo feeds add");
    return code;
}

} // namespace orvo
