#include "orvo/ShowCommand.h"

#include "orvo/HandOffJson.h"
#include "orvo/HandOffPrinter.h"
#include "orvo/HandOffStore.h"
#include "orvo/console/PeriodText.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo {

CommandSpec ShowCommand::spec() const {
    return {.path = {"show"},
            .summary = "Show what was handed over last",
            .description =
                "What a tap in the widget opened, or a URL: a line with its incidents in full, a "
                "list of incidents, or the favourites.",
            .options = {{"json", "", "print JSON: the line and its incidents, or the incidents"}},
            .examples = {{"orvo show", "the last one"},
                         {"orvo show --json", "for a script"},
                         {"orvo show --demo", "of the demonstration city"}}};
}

ExitCode ShowCommand::run(const Arguments& arguments, CommandContext& context) {
    if (arguments.has("json"))
        return printJson(context);
    std::shared_ptr<NSError> error;
    const auto kept = HandOffStore::last(&error);
    if (error)
        return context.fail(*error);
    if (!kept) {
        context.terminal().note(
            "Nothing has been handed over yet. Tap a row of the widget, or: orvo open URL");
        if (!arguments.has("demo"))
            context.terminal().note("What was tapped in the demonstration city: orvo show --demo");
        return ExitCode::Answered;
    }
    const auto content = kept->handOff.content(&error);
    if (!content)
        return context.fail(*error);
    if ((error = HandOffPrinter(context).print(*content)))
        return context.fail(*error);
    context.terminal().note(fmt::format(
        "Handed over {} ago.", PeriodText::age(std::max(0.0, context.now() - kept->receivedAt))));
    return ExitCode::Answered;
}

ExitCode ShowCommand::printJson(CommandContext& context) {
    HandOffJson json;
    if (const auto kept = HandOffStore::last(&json.error)) {
        json.receivedAt = kept->receivedAt;
        json.content = kept->handOff.content(&json.error);
    }
    std::shared_ptr<NSError> unreadable; // a line's origin is a help; the rest is told without it
    const auto schedules = context.schedules(unreadable);
    json.schedules = schedules.get();
    context.terminal().output() << json.text();
    return json.error ? context.fail(*json.error) : ExitCode::Answered;
}

} // namespace orvo
