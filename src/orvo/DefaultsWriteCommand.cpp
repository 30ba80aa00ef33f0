#include "orvo/DefaultsWriteCommand.h"

#include "orvo/DefaultsValue.h"
#include "shared/NSUserDefaults_OrvoGroup.h"

#include <fmt/format.h>

namespace orvo {

CommandSpec DefaultsWriteCommand::spec() const {
    return {
        .path = {"defaults", "write"},
        .summary = "Set one setting",
        .description = "Two settings are for tests of the widget: "
                       "Orvo.TransitWidget.internal.injectFakeIncidents makes up incidents for "
                       "lines without any, and Orvo.TransitWidget.internal.randomNumberIncidents "
                       "makes up none, one or two of them.",
        .operands = {{.name = "KEY",
                      .help = "",
                      .completes = Completes::Suggestion,
                      .words = DefaultsValue::knownKeys()},
                     {.name = "VALUE",
                      .help = "true, false, yes and no are truth values, numbers are numbers, all "
                              "else text"}},
        .options = {{.name = "type",
                     .value = "KIND",
                     .help = "read VALUE as bool, integer, real or string",
                     .completes = Completes::Word,
                     .words = DefaultsValue::kinds()}},
        .examples = {{"orvo defaults write Orvo.TransitWidget.internal.injectFakeIncidents true",
                      "make up incidents"}}};
}

ExitCode DefaultsWriteCommand::run(const Arguments& arguments, CommandContext& context) {
    const std::string& key = arguments.operands()[0];
    const std::string kind = arguments.value("type").value_or("");
    const auto value = DefaultsValue::parse(arguments.operands()[1], kind);
    if (!value)
        return context.wrongUsage(
            fmt::format("VALUE cannot be {}: it is no {}", arguments.operands()[1], kind));
    const auto error = OrvoGroup::__orvo_groupUserDefaults()->setObject_forKey(value, key);
    return error ? context.fail(*error) : ExitCode::Answered;
}

} // namespace orvo
