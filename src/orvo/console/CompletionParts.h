#pragma once

#include "orvo/console/HelpText.h"

#include <set>
#include <string>
#include <utility>
#include <vector>

namespace orvo::Completion {

/// What the scripts of all shells are made of.

/// The word after `orvo completion words` that lists such names, or nil.
[[nodiscard]] const char* machineWords(Completes what);
/// The command's own options, then those of every command.
[[nodiscard]] std::vector<OptionSpec> optionsOf(const CommandSpec& command);
/// The words that may follow the path: each with a line of explanation.
[[nodiscard]] std::vector<std::pair<std::string, std::string>>
wordsAfter(const ProgramSpec& program, const std::vector<std::string>& path);
/// Paths below which there are commands, the program's own (empty) one first. None for a program
/// that is one command.
[[nodiscard]] std::set<std::vector<std::string>> groupsOf(const ProgramSpec& program);
/// Whether an operand is the words of a command.
[[nodiscard]] bool asksForCommands(const CommandSpec& command);
/// Whether some word is a name that only this machine has.
[[nodiscard]] bool asksForNames(const ProgramSpec& program);
/// What to type for the script: `orvo completion bash`; a program that is one command has an
/// option.
[[nodiscard]] std::string origin(const ProgramSpec& program, const std::string& shell);
/// The program's name as shells take it for a function: `orvo_transit_widget`.
[[nodiscard]] std::string functionName(const ProgramSpec& program);
/// In single quotes, as POSIX shells read them.
[[nodiscard]] std::string quoted(std::string text);

[[nodiscard]] std::string bash(const ProgramSpec& program);
[[nodiscard]] std::string zsh(const ProgramSpec& program);
[[nodiscard]] std::string fish(const ProgramSpec& program);

} // namespace orvo::Completion
