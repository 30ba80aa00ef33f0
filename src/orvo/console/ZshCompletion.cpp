#include "orvo/console/CompletionParts.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

namespace orvo::Completion {

namespace {

std::string zshAction(Completes what, const std::vector<std::string>& words) {
    if (const char* kind = machineWords(what))
        return fmt::format("->{}", kind);
    if (what == Completes::File)
        return "_files";
    return words.empty() ? " " : fmt::format("({})", fmt::join(words, " "));
}

/// Brackets and colons have a meaning inside an `_arguments` specification.
std::string zshText(const std::string& text) {
    std::string result;
    for (const char c : text) {
        if (c == '[' || c == ']' || c == ':' || c == '\\')
            result += '\\';
        result += c;
    }
    return result;
}

std::string zshCommand(const CommandSpec& command) {
    std::string text = fmt::format("    {})\n        _arguments -S", quoted(command.name()));
    for (const auto& option : optionsOf(command)) {
        std::string spec = option.takesSeveral ? "*" : "";
        spec += fmt::format("--{}[{}]", option.name, zshText(option.help));
        if (!option.value.empty())
            spec += fmt::format(
                ":{}:{}", zshText(option.value), zshAction(option.completes, option.words));
        text += fmt::format(" \\\n            {}", quoted(spec));
    }
    for (const auto& operand : command.operands) {
        const char* where = operand.count == OperandSpec::Count::One        ? ":"
                            : operand.count == OperandSpec::Count::Optional ? "::"
                                                                            : "*:";
        text += fmt::format(" \\\n            {}",
                            quoted(where + zshText(operand.name) + ":" +
                                   zshAction(operand.completes, operand.words)));
    }
    return text + " ;;\n";
}

} // namespace

std::string zsh(const ProgramSpec& program) {
    std::string text = R"sh(#compdef orvo
# zsh completion for orvo, written by `orvo completion zsh`

_orvo() {
    local -a state line names
    local place= word context
    local -a demo=(${(M)words[2,CURRENT-1]:#--demo})
    integer taken=0
    for word in ${words[2,CURRENT-1]}; do
        case "$place/$word" in
)sh";
    for (const auto& group : groupsOf(program)) {
        const std::string before = fmt::format("{}", fmt::join(group, " "));
        for (const auto& [word, explanation] : wordsAfter(program, group))
            text += fmt::format("        {}) place={}; ((taken++)) ;;\n",
                                quoted(before + "/" + word),
                                quoted(before.empty() ? word : before + " " + word));
    }
    text += "        esac\n    done\n    case $place in\n";
    for (const auto& group : groupsOf(program)) {
        text += fmt::format("    {})\n        names=(",
                            quoted(fmt::format("{}", fmt::join(group, " "))));
        for (const auto& [word, explanation] : wordsAfter(program, group))
            text += fmt::format("\n            {}", quoted(zshText(word) + ":" + explanation));
        text += "\n        )\n        _describe command names\n        return ;;\n";
    }
    text += "    esac\n    shift $taken words\n    ((CURRENT -= taken))\n    case $place in\n";
    for (const auto& command : program.commands)
        text += zshCommand(command);
    return text + R"sh(    esac
    if [[ -n $state ]]; then
        names=(${(f)"$(orvo completion words $state $demo[1] 2>/dev/null)"})
        compadd -a names
    fi
}

_orvo "$@"
)sh";
}

} // namespace orvo::Completion
