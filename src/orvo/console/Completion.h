#pragma once

#include "orvo/console/HelpText.h"

#include <string>
#include <vector>

/// Scripts that let a shell complete a program's words. They know all commands and options, and
/// ask `orvo completion words feeds|lines|favorites` for names that only this machine has. A
/// program may be one command, whose path is empty. Scripts of several programs do not get in each
/// other's way.
namespace orvo::Completion {

/// `bash`, `zsh`, `fish`.
[[nodiscard]] const std::vector<std::string>& shells();

/// The script for one of the shells.
[[nodiscard]] std::string script(const ProgramSpec& program, const std::string& shell);

} // namespace orvo::Completion
