#pragma once

#include <functional>
#include <optional>
#include <string>

namespace orvo {

/// Answers what a variable is set to: nothing, or an empty text, where it is not set.
using VariableLookup = std::function<std::optional<std::string>(const std::string& variable)>;

/// The language of messages that variables name: the first of `LC_ALL`, `LC_MESSAGES` and `LANG`
/// that is set, as a BCP-47 tag; `en` where that is none, `C` or `POSIX`. Any thread.
[[nodiscard]] std::string localeOfVariables(const VariableLookup& valueOf);

} // namespace orvo
