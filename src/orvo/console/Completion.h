#pragma once

#include "orvo/console/HelpText.h"

#include <string>
#include <vector>

namespace orvo {

/// Scripts that let a shell complete the program's words. They know all commands and options, and
/// ask the program itself (`orvo completion words feeds|lines|favorites`) for names that only this
/// machine has.
namespace Completion {

/// `bash`, `zsh`, `fish`.
[[nodiscard]] const std::vector<std::string>& shells();

/// The script for one of the shells.
[[nodiscard]] std::string script(const ProgramSpec& program, const std::string& shell);

} // namespace Completion

} // namespace orvo
