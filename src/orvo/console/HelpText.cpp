#include "orvo/console/HelpText.h"

#include "orvo/console/DisplayText.h"

#include <algorithm>
#include <fmt/ranges.h>

namespace orvo {

const CommandSpec* ProgramSpec::command(const std::vector<std::string>& path) const {
    const auto found = std::ranges::find(commands, path, &CommandSpec::path);
    return found == commands.end() ? nullptr : &*found;
}

std::vector<const CommandSpec*>
ProgramSpec::commandsBelow(const std::vector<std::string>& path) const {
    std::vector<const CommandSpec*> below;
    for (const auto& command : commands) {
        if (command.path.size() > path.size() &&
            std::equal(path.begin(), path.end(), command.path.begin()))
            below.push_back(&command);
    }
    return below;
}

UsageError ProgramSpec::noSuchCommand(const std::vector<std::string>& path,
                                      const std::string& word) const {
    std::vector<std::string> known;
    for (const auto* command : commandsBelow(path))
        known.push_back(command->path[path.size()]);
    std::vector<std::string> given = {name};
    given.insert(given.end(), path.begin(), path.end());
    const std::string before = fmt::format("{}", fmt::join(given, " "));
    const auto meant = nearest(word, known);
    return {fmt::format("there is no command {} {}", before, word),
            meant ? fmt::format("Did you mean {} {}?", before, *meant)
                  : fmt::format("See: {} --help", before)};
}

namespace HelpText {

namespace {

constexpr std::size_t Indent = 2;
constexpr std::size_t WidestTerm = 34;
constexpr std::size_t WidestText = 100;

using Entries = std::vector<std::pair<std::string, std::string>>;

std::string paragraph(std::string_view text, std::size_t width) {
    std::string result;
    for (const auto& line : DisplayText::wrap(text, std::min(width, WidestText)))
        result += line + "\n";
    return result;
}

/// Terms on the left, their meanings beside them, or below where a term is long.
std::string definitions(const Entries& entries, std::size_t width) {
    std::size_t column = 0;
    for (const auto& [term, meaning] : entries)
        column = std::max(column, std::min(DisplayText::width(term), WidestTerm));
    column += 2 * Indent;
    const std::size_t textWidth =
        std::max<std::size_t>(20, std::min(width, WidestText) - std::min(width, column));
    std::string result;
    for (const auto& [term, meaning] : entries) {
        std::string line = std::string(Indent, ' ') + term;
        bool first = true;
        for (const auto& part : DisplayText::wrap(meaning, textWidth)) {
            const std::size_t used = DisplayText::width(line);
            if (!first || used + Indent > column) {
                result += line + "\n";
                line.clear();
            }
            line.append(column - DisplayText::width(line), ' ');
            line += part;
            first = false;
        }
        result += line + "\n";
    }
    return result;
}

Entries entriesOf(const std::vector<OptionSpec>& options) {
    Entries entries;
    for (const auto& option : options) {
        std::string term = "--" + option.name;
        if (!option.value.empty())
            term += " " + option.value + (option.takesSeveral ? "…" : "");
        entries.emplace_back(term, option.help);
    }
    return entries;
}

Entries entriesOf(const std::vector<const CommandSpec*>& commands) {
    Entries entries;
    for (const auto* command : commands)
        entries.emplace_back(command->name(), command->summary);
    return entries;
}

} // namespace

std::string program(const ProgramSpec& program, std::size_t width) {
    std::string text = paragraph(program.summary, width);
    text += fmt::format("\nUsage: {} COMMAND [ARGUMENT]… [OPTION]…\n\nCommands:\n", program.name);
    text += definitions(entriesOf(program.commandsBelow({})), width);
    text += "\nOptions of every command:\n" + definitions(entriesOf(globalOptions()), width);
    const std::vector<OptionSpec> alone = {{"version", "", "show the version"}};
    text += "\nOption without a command:\n" + definitions(entriesOf(alone), width);
    text += fmt::format("\n{} COMMAND --help says more, with examples.\n", program.name);
    return text + "Exit status: 0 answered, 1 could not, 2 wrong usage.\n";
}

std::string
group(const ProgramSpec& program, const std::vector<std::string>& path, std::size_t width) {
    const auto commands = program.commandsBelow(path);
    std::string text = "Usage:\n";
    for (const auto* command : commands)
        text += fmt::format("  {} {}\n", program.name, command->usage());
    text += "\nCommands:\n" + definitions(entriesOf(commands), width);
    return text + fmt::format("\n{} {} --help says more, with examples.\n",
                              program.name,
                              commands.front()->name());
}

std::string command(const ProgramSpec& program, const CommandSpec& command, std::size_t width) {
    // A program of one command has no word for it, and no other command's options.
    const bool isOnlyCommand = command.path.empty();
    std::string text =
        fmt::format("Usage: {}{}{}\n\n", program.name, isOnlyCommand ? "" : " ", command.usage());
    text += paragraph(command.summary + ".", width);
    if (!command.description.empty())
        text += "\n" + paragraph(command.description, width);
    Entries operands;
    for (const auto& operand : command.operands) {
        if (!operand.help.empty())
            operands.emplace_back(operand.name, operand.help);
    }
    if (!operands.empty())
        text += "\n" + definitions(operands, width);
    auto options = command.options;
    if (isOnlyCommand)
        options.insert(options.end(), globalOptions().begin(), globalOptions().end());
    if (!options.empty())
        text += "\nOptions:\n" + definitions(entriesOf(options), width);
    if (!isOnlyCommand)
        text += "\nOptions of every command:\n" + definitions(entriesOf(globalOptions()), width);
    if (!command.examples.empty())
        text += "\nExamples:\n";
    for (const auto& example : command.examples)
        text += fmt::format("  {}\n      {}\n", example.command, example.explanation);
    return text;
}

} // namespace HelpText

} // namespace orvo
