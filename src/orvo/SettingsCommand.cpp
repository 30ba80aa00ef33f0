#include "orvo/SettingsCommand.h"

#include "orvo/console/JsonWriter.h"
#include "orvo/console/TextTable.h"
#include "platform/feeds/TravelPreferences.h"

#include <ostream>

namespace orvo {

namespace {

constexpr const char* StepFree = "step-free";

const char* shown(bool value) {
    return value ? "on" : "off";
}

} // namespace

CommandSpec SettingsCommand::spec() const {
    return {.path = {"settings"},
            .summary = "Show or change what you prefer",
            .description = "step-free: whether broken lifts and ramps count as incidents.",
            .operands = {{.name = "NAME",
                          .help = "the setting; without it all are shown",
                          .count = OperandSpec::Count::Optional,
                          .completes = Completes::Word,
                          .words = {StepFree}},
                         {.name = "VALUE",
                          .help = "on or off; without it the setting is shown",
                          .count = OperandSpec::Count::Optional,
                          .completes = Completes::Word,
                          .words = {"on", "off"}}},
            .options = {{"json", "", "print JSON"}},
            .examples = {{"orvo settings step-free on", "lifts matter to me"},
                         {"orvo settings", "show all"}}};
}

ExitCode SettingsCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto name = arguments.operand(0);
    if (const auto value = arguments.operand(1)) {
        const auto error = TravelPreferences::setAsksForStepFree(*value == "on");
        return error ? context.fail(*error) : ExitCode::Answered;
    }
    const bool stepFree = TravelPreferences::asksForStepFree();
    if (const auto error = TravelPreferences::unreadable())
        return context.fail(*error);
    auto& output = context.terminal().output();
    if (arguments.has("json")) {
        JsonWriter json;
        output << json.beginObject().key(StepFree).value(stepFree).endObject().text();
    } else if (name) {
        output << shown(stepFree) << '\n';
    } else {
        TextTable table({{"Setting"}, {"Value"}});
        table.addRow({StepFree, shown(stepFree)});
        table.print(context.terminal());
    }
    return ExitCode::Answered;
}

} // namespace orvo
