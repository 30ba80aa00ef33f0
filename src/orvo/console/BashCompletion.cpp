#include "orvo/console/CompletionParts.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

namespace orvo::Completion {

namespace {

std::vector<std::string> namesAfter(const ProgramSpec& program,
                                    const std::vector<std::string>& group) {
    std::vector<std::string> names;
    for (const auto& [name, explanation] : wordsAfter(program, group))
        names.push_back(name);
    return names;
}

std::string bashReply(Completes what, const std::vector<std::string>& words) {
    if (const char* kind = machineWords(what))
        return fmt::format("_orvo_words {}", kind);
    if (what == Completes::File)
        // Names of files hold blanks and stars; readline quotes them.
        return "mapfile -t COMPREPLY < <(compgen -f -- \"$current\"); "
               "compopt -o filenames 2>/dev/null";
    return fmt::format("COMPREPLY=($(compgen -W {} -- \"$current\"))",
                       quoted(fmt::format("{}", fmt::join(words, " "))));
}

/// What stands in the place of a command's words, by those before it.
std::string bashGroups(const ProgramSpec& program, const char* indent) {
    std::string text;
    for (const auto& group : groupsOf(program))
        text += fmt::format("{}{}) {} ;;\n",
                            indent,
                            quoted(fmt::format("{}", fmt::join(group, " "))),
                            bashReply(Completes::Word, namesAfter(program, group)));
    return text;
}

std::string bashOperands(const ProgramSpec& program, const CommandSpec& command) {
    if (asksForCommands(command))
        return "        *) case \"${operands[*]}\" in\n" + bashGroups(program, "            ") +
               "            esac ;;\n";
    std::string text = "        *) case ${#operands[@]} in\n";
    for (std::size_t i = 0; i < command.operands.size(); ++i) {
        const auto& operand = command.operands[i];
        const bool repeats = operand.count == OperandSpec::Count::OneOrMore ||
                             operand.count == OperandSpec::Count::Any;
        text += fmt::format("            {}) {} ;;\n",
                            repeats ? "*" : fmt::format("{}", i),
                            bashReply(operand.completes, operand.words));
    }
    return text + "            esac ;;\n";
}

/// Asks for names: the words come from schedules of strangers, and are never expanded.
constexpr const char* BashNamesFunction = R"sh(
_orvo_words() {
    # The words come from schedules of strangers: they are compared and quoted, never expanded (as `compgen -W` would).
    local word
    while IFS= read -r word; do
        [[ $word == "$current"* ]] || continue
        # A colon begins a new word for readline: take away what stands before it.
        if [[ $current == *:* && $COMP_WORDBREAKS == *:* ]]; then
            word=${word#"${current%"${current##*:}"}"}
        fi
        printf -v word %q "$word"
        COMPREPLY+=("$word")
    done < <(orvo completion words "$1" $demo 2>/dev/null)
}
)sh";

/// What stands before the cursor, without the options that have a value.
constexpr const char* BashBeginning = R"sh(() {
    local line=${COMP_LINE:0:COMP_POINT} previous=$3 place= word skip= demo=
    local current=${line##* }
    local -a operands=()
    COMPREPLY=()
    for word in "${COMP_WORDS[@]:1:COMP_CWORD-1}"; do
        [[ $skip ]] && { skip=; continue; }
        [[ $word == --demo ]] && demo=--demo
        case $word in
        # Where readline broke a word in two.
        : | =) skip=1; continue ;;
)sh";

/// `--at | --language`: all options, of any command, after which a value stands.
std::string optionsWithValues(const ProgramSpec& program) {
    std::set<std::string> names;
    for (const auto& command : program.commands) {
        for (const auto& option : optionsOf(command)) {
            if (!option.value.empty())
                names.insert("--" + option.name);
        }
    }
    return fmt::format("{}", fmt::join(names, " | "));
}

std::string bashCommand(const ProgramSpec& program, const CommandSpec& command) {
    std::string text = fmt::format("    {})\n        case $previous in\n", quoted(command.name()));
    std::vector<std::string> names;
    for (const auto& option : optionsOf(command)) {
        names.push_back("--" + option.name);
        if (!option.value.empty())
            text += fmt::format("        --{}) {}; return ;;\n",
                                option.name,
                                bashReply(option.completes, option.words));
    }
    text += "        esac\n        case $current in\n";
    text += fmt::format("        -*) {} ;;\n", bashReply(Completes::Word, names));
    if (!command.operands.empty())
        text += bashOperands(program, command);
    return text + "        esac ;;\n";
}

} // namespace

std::string bash(const ProgramSpec& program) {
    const std::string function = functionName(program);
    std::string text = fmt::format(
        "# bash completion for {}, written by `{}`\n", program.name, origin(program, "bash"));
    if (asksForNames(program))
        text += BashNamesFunction;
    text += fmt::format("\n_{}{}", function, BashBeginning);
    text += fmt::format("        {}) skip=1; continue ;;\n        -*) continue ;;\n        esac\n",
                        optionsWithValues(program));
    const auto groups = groupsOf(program);
    if (!groups.empty())
        text += "        case $place in\n";
    for (const auto& group : groups)
        text += fmt::format("        {}) case $word in {}) place=\"${{place:+$place }}$word\"; "
                            "continue ;; esac ;;\n",
                            quoted(fmt::format("{}", fmt::join(group, " "))),
                            fmt::join(namesAfter(program, group), "|"));
    if (!groups.empty())
        text += "        esac\n";
    text += "        operands+=(\"$word\")\n    done\n    case $place in\n";
    for (const auto& group : groups) {
        auto names = namesAfter(program, group);
        if (group.empty())
            names.insert(names.end(), {"--help", "--version"});
        text += fmt::format("    {}) {} ;;\n",
                            quoted(fmt::format("{}", fmt::join(group, " "))),
                            bashReply(Completes::Word, names));
    }
    for (const auto& command : program.commands)
        text += bashCommand(program, command);
    return text + fmt::format("    esac\n}}\n\ncomplete -F _{} {}\n", function, program.name);
}

} // namespace orvo::Completion
