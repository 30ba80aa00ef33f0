#include "orvo/console/CommandSpec.h"

#include <fmt/ranges.h>

namespace orvo {

std::string CommandSpec::name() const {
    return fmt::format("{}", fmt::join(path, " "));
}

std::string CommandSpec::usage() const {
    if (!synopsis.empty())
        return name() + " " + synopsis;
    std::string text = name();
    for (const auto& operand : operands) {
        const std::string shown = operand.completes == Completes::Word && !operand.words.empty()
                                      ? fmt::format("{}", fmt::join(operand.words, "|"))
                                      : operand.name;
        switch (operand.count) {
        case OperandSpec::Count::One:
            text += " " + shown;
            break;
        case OperandSpec::Count::Optional:
            text += " [" + shown + "]";
            break;
        case OperandSpec::Count::OneOrMore:
            text += " " + shown + "…";
            break;
        case OperandSpec::Count::Any:
            text += " [" + shown + "…]";
            break;
        }
    }
    bool mayTakeMore = false;
    for (const auto& option : options) {
        mayTakeMore = mayTakeMore || !option.isRequired;
        if (option.isRequired)
            text += fmt::format(
                " --{} {}{}", option.name, option.value, option.takesSeveral ? "…" : "");
    }
    return mayTakeMore ? text + " [OPTION]…" : text;
}

const std::vector<OptionSpec>& globalOptions() {
    static const std::vector<OptionSpec> options = {
        {"demo", "", "use the demonstration city's profile instead of your own"},
        {"at", "TIME", "answer for that moment, as 2024-07-24T01:28:40Z; nothing is written"},
        {"language", "TAG", "the language to prefer in texts, as de or pt-BR"},
        {"help", "", "show this text"},
    };
    return options;
}

} // namespace orvo
