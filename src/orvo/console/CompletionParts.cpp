#include "orvo/console/CompletionParts.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo::Completion {

const char* machineWords(Completes what) {
    switch (what) {
    case Completes::Feed:
        return "feeds";
    case Completes::Line:
        return "lines";
    case Completes::Favorite:
        return "favorites";
    case Completes::Nothing:
    case Completes::File:
    case Completes::Command:
    case Completes::Word:
    case Completes::Suggestion:
        break;
    }
    return nullptr;
}

std::vector<OptionSpec> optionsOf(const CommandSpec& command) {
    auto options = command.options;
    options.insert(options.end(), globalOptions().begin(), globalOptions().end());
    return options;
}

std::vector<std::pair<std::string, std::string>> wordsAfter(const ProgramSpec& program,
                                                            const std::vector<std::string>& path) {
    std::vector<std::pair<std::string, std::string>> words;
    for (const auto* command : program.commandsBelow(path)) {
        const std::string& word = command->path[path.size()];
        const bool isGroup = command->path.size() > path.size() + 1;
        if (words.empty() || words.back().first != word)
            words.emplace_back(word, isGroup ? word + " …" : command->summary);
    }
    return words;
}

std::set<std::vector<std::string>> groupsOf(const ProgramSpec& program) {
    std::set<std::vector<std::string>> groups;
    for (const auto& command : program.commands) {
        for (auto path = command.path; !path.empty();) {
            path.pop_back();
            groups.insert(path);
        }
    }
    return groups;
}

bool asksForCommands(const CommandSpec& command) {
    return std::ranges::count(command.operands, Completes::Command, &OperandSpec::completes) > 0;
}

bool asksForNames(const ProgramSpec& program) {
    const auto asks = [](const auto& word) {
        return machineWords(word.completes) != nullptr;
    };
    return std::ranges::any_of(program.commands, [&](const CommandSpec& command) {
        return std::ranges::any_of(command.options, asks) ||
               std::ranges::any_of(command.operands, asks);
    });
}

std::string origin(const ProgramSpec& program, const std::string& shell) {
    return fmt::format(
        "{} {}completion {}", program.name, groupsOf(program).empty() ? "--" : "", shell);
}

std::string functionName(const ProgramSpec& program) {
    std::string name = program.name;
    std::ranges::replace(name, '-', '_');
    return name;
}

std::string quoted(std::string text) {
    for (std::size_t at = 0; (at = text.find('\'', at)) != std::string::npos; at += 4)
        text.replace(at, 1, "'\\''");
    return "'" + text + "'";
}

} // namespace orvo::Completion
