#include "orvo/DefaultsDeleteCommand.h"

#include "orvo/DefaultsValue.h"
#include "shared/NSUserDefaults_OrvoGroup.h"

#include <fmt/format.h>

namespace orvo {

CommandSpec DefaultsDeleteCommand::spec() const {
    return {.path = {"defaults", "delete"},
            .summary = "Forget one setting",
            .description = "",
            .operands = {{.name = "KEY",
                          .help = "",
                          .completes = Completes::Suggestion,
                          .words = DefaultsValue::knownKeys()}},
            .examples = {{"orvo defaults delete Orvo.TransitWidget.internal.injectFakeIncidents",
                          "back to real incidents"}}};
}

ExitCode DefaultsDeleteCommand::run(const Arguments& arguments, CommandContext& context) {
    const std::string& key = arguments.operands()[0];
    const auto defaults = OrvoGroup::__orvo_groupUserDefaults();
    const auto value = defaults->objectForKey(key);
    if (const auto error = defaults->unreadable())
        return context.fail(*error);
    if (!value)
        return context.fail(fmt::format("{} is not set", key), "See: orvo defaults read");
    const auto error = defaults->removeObjectForKey(key);
    return error ? context.fail(*error) : ExitCode::Answered;
}

} // namespace orvo
