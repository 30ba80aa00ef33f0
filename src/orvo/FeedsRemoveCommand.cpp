#include "orvo/FeedsRemoveCommand.h"

#include "orvo/FeedChoice.h"

#include <fmt/format.h>
#include <ostream>

namespace orvo {

CommandSpec FeedsRemoveCommand::spec() const {
    return {.path = {"feeds", "remove"},
            .summary = "Forget feeds",
            .description = "Their lines stay among the favourites, with their status unknown, "
                           "until you remove them there.",
            .operands = {{.name = "NAME",
                          .help = "",
                          .count = OperandSpec::Count::OneOrMore,
                          .completes = Completes::Feed}},
            .examples = {{"orvo feeds remove city", "forget one"}}};
}

ExitCode FeedsRemoveCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto choice = FeedChoice::of(arguments.operands(), context);
    if (choice.error)
        return context.fail(*choice.error);
    std::shared_ptr<NSError> error;
    const auto schedules = context.schedules(error);
    if (!schedules)
        return context.fail(*error);
    for (const auto& feed : choice.feeds) {
        // The schedule first: it is what another program may hold, and then all is as it was.
        if ((error = schedules->removeSchedule(feed.name)) ||
            (error = context.registry()->remove(feed.name)))
            return context.fail(*error);
        context.terminal().output() << fmt::format("Removed {}\n", feed.name);
    }
    return ExitCode::Answered;
}

} // namespace orvo
