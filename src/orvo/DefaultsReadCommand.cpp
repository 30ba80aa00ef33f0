#include "orvo/DefaultsReadCommand.h"

#include "orvo/DefaultsValue.h"
#include "orvo/console/TextTable.h"
#include "platform/foundation/NSString.h"
#include "shared/NSUserDefaults_OrvoGroup.h"

#include <fmt/format.h>
#include <map>
#include <ostream>

namespace orvo {

namespace {

using Values = std::map<std::string, std::shared_ptr<NSObject>>;

std::string json(const Values& values) {
    JsonWriter json;
    json.beginObject();
    for (const auto& [key, value] : values) {
        json.key(key);
        DefaultsValue::add(json, *value);
    }
    return json.endObject().text();
}

} // namespace

CommandSpec DefaultsReadCommand::spec() const {
    return {.path = {"defaults", "read"},
            .summary = "Show settings as they are kept",
            .description = "",
            .operands = {{.name = "KEY",
                          .help = "one key; without it all",
                          .count = OperandSpec::Count::Optional,
                          .completes = Completes::Suggestion,
                          .words = DefaultsValue::knownKeys()}},
            .options = {{"json", "", "print JSON"}},
            .examples = {{"orvo defaults read", "everything"}}};
}

ExitCode DefaultsReadCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto defaults = OrvoGroup::__orvo_groupUserDefaults();
    const auto key = arguments.operand(0);
    Values values;
    if (key) {
        const auto value = defaults->objectForKey(*key);
        if (const auto error = defaults->unreadable())
            return context.fail(*error);
        if (!value)
            return context.fail(fmt::format("{} is not set", *key), "See: orvo defaults read");
        values[*key] = value;
    } else {
        const auto all = defaults->dictionaryRepresentation();
        if (const auto error = defaults->unreadable())
            return context.fail(*error);
        for (const auto& [name, value] : all->entries()) {
            if (const auto text = stringValue(name.get()))
                values[*text] = value;
        }
    }
    auto& output = context.terminal().output();
    if (arguments.has("json")) {
        output << json(values);
    } else if (key) {
        output << DefaultsValue::text(*values[*key]) << '\n';
    } else {
        TextTable table({{"Key", TextTable::Column::Alignment::Left, false}, {"Value"}});
        for (const auto& [name, value] : values)
            table.addRow({name, DefaultsValue::text(*value)});
        if (table.isEmpty())
            context.terminal().note("No setting is kept.");
        else
            table.print(context.terminal());
    }
    return ExitCode::Answered;
}

} // namespace orvo
