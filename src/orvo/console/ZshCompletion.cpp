#include "orvo/console/CompletionParts.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>

namespace orvo::Completion {

namespace {

std::string zshAction(Completes what, const std::vector<std::string>& words) {
    if (const char* kind = machineWords(what))
        return fmt::format("->{}", kind);
    if (what == Completes::Command)
        return "->commands";
    if (what == Completes::File)
        return "_files";
    return words.empty() ? " " : fmt::format("({})", fmt::join(words, " "));
}

/// Brackets and colons have a meaning in what `_arguments` is told.
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

/// Offers what may follow the words of a group of commands.
std::string zshCommandsFunction(const ProgramSpec& program) {
    std::string text = fmt::format("_{}_commands() {{\n    local -a names\n    case $1 in\n",
                                   functionName(program));
    for (const auto& group : groupsOf(program)) {
        text += fmt::format("    {})\n        names=(",
                            quoted(fmt::format("{}", fmt::join(group, " "))));
        for (const auto& [word, explanation] : wordsAfter(program, group))
            text += fmt::format("\n            {}", quoted(zshText(word) + ":" + explanation));
        text += "\n        ) ;;\n";
    }
    return text + "    *) return 1 ;;\n    esac\n    _describe command names\n}\n\n";
}

/// How many words say the command, and what may follow where they do not yet.
std::string zshCommandChoice(const ProgramSpec& program) {
    const auto groups = groupsOf(program);
    if (groups.empty())
        return "";
    std::string text = R"sh(    integer taken=0
    for word in ${words[2,CURRENT-1]}; do
        case "$place/$word" in
)sh";
    for (const auto& group : groups) {
        const std::string before = fmt::format("{}", fmt::join(group, " "));
        for (const auto& [word, explanation] : wordsAfter(program, group))
            text += fmt::format("        {}) place={}; ((taken++)) ;;\n",
                                quoted(fmt::format("{}/{}", before, word)),
                                quoted(before.empty() ? word : fmt::format("{} {}", before, word)));
    }
    text += "        esac\n    done\n    case $place in\n    ";
    const char* bar = "";
    for (const auto& group : groups) {
        text += bar + quoted(fmt::format("{}", fmt::join(group, " ")));
        bar = " | ";
    }
    text += fmt::format(")\n        _{}_commands \"$place\"\n        return ;;\n",
                        functionName(program));
    return text + "    esac\n    shift $taken words\n    ((CURRENT -= taken))\n";
}

} // namespace

std::string zsh(const ProgramSpec& program) {
    const bool asks = asksForNames(program);
    std::string text = fmt::format("#compdef {0}\n# zsh completion for {0}, written by `{1}`\n\n",
                                   program.name,
                                   origin(program, "zsh"));
    if (!groupsOf(program).empty())
        text += zshCommandsFunction(program);
    text += fmt::format("_{}() {{\n", program.name);
    text += "    local -a state line names\n    local place= word context\n";
    if (asks)
        text += "    local -a demo=(${(M)words[2,CURRENT-1]:#--demo})\n";
    text += zshCommandChoice(program) + "    case $place in\n";
    for (const auto& command : program.commands)
        text += zshCommand(command);
    text += "    esac\n";
    if (std::ranges::any_of(program.commands, asksForCommands))
        text += fmt::format(R"sh(    if [[ $state == commands ]]; then
        _{}_commands "${{(j: :)${{(@)words[2,CURRENT-1]:#-*}}}}"
        return
    fi
)sh",
                            functionName(program));
    if (asks)
        text += R"sh(    if [[ -n $state ]]; then
        names=(${(f)"$(orvo completion words $state $demo[1] 2>/dev/null)"})
        compadd -a names
    fi
)sh";
    return text + fmt::format("}}\n\n_{} \"$@\"\n", program.name);
}

} // namespace orvo::Completion
