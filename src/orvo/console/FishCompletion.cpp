#include "orvo/console/CompletionParts.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>

namespace orvo::Completion {

namespace {

constexpr auto FishWordsFunctions = R"sh(
# Whether the words so far, options left out, begin with exactly these.
function __{0}_at
    set -l given (string match -v -- '-*' (commandline -opc)[2..-1])
    test (count $given) -ge (count $argv); or return 1
    set -l n (count $argv)
    test $n -eq 0; or test "$given[1..$n]" = "$argv"
end
# The same, with exactly that number of words after them; with at least that number.
function __{0}_after -a number
    set -l given (string match -v -- '-*' (commandline -opc)[2..-1])
    test (count $given) -eq (math (count $argv) - 1 + $number); and __{0}_at $argv[2..-1]
end
function __{0}_from -a number
    set -l given (string match -v -- '-*' (commandline -opc)[2..-1])
    test (count $given) -ge (math (count $argv) - 1 + $number); and __{0}_at $argv[2..-1]
end
)sh";

constexpr const char* FishNamesFunction =
    R"sh(# The names that only this machine has, of the demonstration city where the line asks for it.
function __orvo_words -a kind
    orvo completion words $kind (string match -- --demo (commandline -opc))[1] 2>/dev/null
end
)sh";

std::string fishCandidates(Completes what, const std::vector<std::string>& words) {
    if (const char* kind = machineWords(what))
        return fmt::format(" -f -a '(__orvo_words {})'", kind);
    if (what == Completes::File)
        return " -F";
    return words.empty() ? " -f" : fmt::format(" -f -a '{}'", fmt::join(words, " "));
}

/// One word more, or none at the end of a line.
std::string blankBefore(const std::string& words) {
    return words.empty() ? "" : " " + words;
}

/// What may follow the words of each group of commands, where those stand after `before`.
std::string fishCommands(const ProgramSpec& program, const std::string& before) {
    std::string text;
    for (const auto& group : groupsOf(program)) {
        for (const auto& [word, explanation] : wordsAfter(program, group))
            text += fmt::format("complete -c {} -n '__{}_after 0{}{}' -a {} -d {}\n",
                                program.name,
                                functionName(program),
                                before,
                                blankBefore(fmt::format("{}", fmt::join(group, " "))),
                                word,
                                quoted(explanation));
    }
    return text;
}

std::string fishCommand(const ProgramSpec& program, const CommandSpec& command) {
    const std::string complete = fmt::format("complete -c {}", program.name);
    const std::string function = functionName(program);
    const std::string place = blankBefore(command.name());
    // A program that is one command takes its options everywhere.
    const std::string condition =
        place.empty() ? "" : fmt::format(" -n '__{}_at{}'", function, place);
    std::string text;
    for (const auto& option : optionsOf(command)) {
        text += fmt::format(
            "{}{} -l {} -d {}{}\n",
            complete,
            condition,
            option.name,
            quoted(option.help),
            option.value.empty() ? " -f" : " -r" + fishCandidates(option.completes, option.words));
    }
    for (std::size_t i = 0; i < command.operands.size(); ++i) {
        const auto& operand = command.operands[i];
        const bool repeats = operand.count == OperandSpec::Count::OneOrMore ||
                             operand.count == OperandSpec::Count::Any;
        text += fmt::format("{} -n '__{}_{} {}{}'{}\n",
                            complete,
                            function,
                            repeats ? "from" : "after",
                            i,
                            place,
                            fishCandidates(operand.completes, operand.words));
    }
    if (asksForCommands(command))
        text += fishCommands(program, place);
    return text;
}

bool countsWords(const ProgramSpec& program) {
    return std::ranges::any_of(program.commands, [](const CommandSpec& command) {
        return !command.path.empty() || !command.operands.empty();
    });
}

} // namespace

std::string fish(const ProgramSpec& program) {
    const std::string function = functionName(program);
    std::string text = fmt::format(
        "# fish completion for {}, written by `{}`\n", program.name, origin(program, "fish"));
    if (countsWords(program))
        text += fmt::format(FishWordsFunctions, function);
    if (asksForNames(program))
        text += FishNamesFunction;
    text += fmt::format("\ncomplete -c {} -f\n", program.name);
    if (!groupsOf(program).empty())
        text += fmt::format("complete -c {} -n '__{}_after 0' -l version -d 'show the version'\n",
                            program.name,
                            function);
    text += fishCommands(program, "");
    for (const auto& command : program.commands)
        text += fishCommand(program, command);
    return text;
}

} // namespace orvo::Completion
