#include "orvo/console/CompletionParts.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

namespace orvo::Completion {

namespace {

std::string fishCandidates(Completes what, const std::vector<std::string>& words) {
    if (const char* kind = machineWords(what))
        return fmt::format(" -f -a '(__orvo_words {})'", kind);
    if (what == Completes::File)
        return " -F";
    return words.empty() ? " -f" : fmt::format(" -f -a '{}'", fmt::join(words, " "));
}

std::string fishCommand(const CommandSpec& command) {
    const std::string condition = fmt::format("__orvo_at {}", command.name());
    std::string text;
    for (const auto& option : optionsOf(command)) {
        text += fmt::format(
            "complete -c orvo -n '{}' -l {} -d {}{}\n",
            condition,
            option.name,
            quoted(option.help),
            option.value.empty() ? " -f" : " -r" + fishCandidates(option.completes, option.words));
    }
    for (std::size_t i = 0; i < command.operands.size(); ++i) {
        const auto& operand = command.operands[i];
        const bool repeats = operand.count == OperandSpec::Count::OneOrMore ||
                             operand.count == OperandSpec::Count::Any;
        text += fmt::format("complete -c orvo -n '{} {} {}'{}\n",
                            repeats ? "__orvo_from" : "__orvo_after",
                            i,
                            command.name(),
                            fishCandidates(operand.completes, operand.words));
    }
    return text;
}

} // namespace

std::string fish(const ProgramSpec& program) {
    std::string text = R"sh(# fish completion for orvo, written by `orvo completion fish`

# Whether the words so far, options left out, begin with exactly these.
function __orvo_at
    set -l given (string match -v -- '-*' (commandline -opc)[2..-1])
    test (count $given) -ge (count $argv); or return 1
    set -l n (count $argv)
    test $n -eq 0; or test "$given[1..$n]" = "$argv"
end
# The same, with exactly that number of words after them; with at least that number.
function __orvo_after -a number
    set -l given (string match -v -- '-*' (commandline -opc)[2..-1])
    test (count $given) -eq (math (count $argv) - 1 + $number); and __orvo_at $argv[2..-1]
end
function __orvo_from -a number
    set -l given (string match -v -- '-*' (commandline -opc)[2..-1])
    test (count $given) -ge (math (count $argv) - 1 + $number); and __orvo_at $argv[2..-1]
end
# The names that only this machine has, of the demonstration city where the line asks for it.
function __orvo_words -a kind
    orvo completion words $kind (string match -- --demo (commandline -opc))[1] 2>/dev/null
end

complete -c orvo -f
complete -c orvo -n '__orvo_after 0' -l version -d 'show the version'
)sh";
    for (const auto& group : groupsOf(program)) {
        for (const auto& [word, explanation] : wordsAfter(program, group))
            text += fmt::format("complete -c orvo -n '__orvo_after 0{}{}' -a {} -d {}\n",
                                group.empty() ? "" : " ",
                                fmt::join(group, " "),
                                word,
                                quoted(explanation));
    }
    for (const auto& command : program.commands)
        text += fishCommand(command);
    return text;
}

} // namespace orvo::Completion
