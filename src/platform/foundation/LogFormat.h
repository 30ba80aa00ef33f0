#pragma once

#include "platform/foundation/Log.h"

#include <span>
#include <string>
#include <string_view>

namespace orvo {

/// The text of a log line.
struct LogText {
    std::string message;  ///< with every value
    std::string redacted; ///< with `<private>` for each value that the format marks so
};

/// Fills in the values. What is amiss with the format or the number of values never fails: it shows
/// in the text.
[[nodiscard]] LogText formatLog(std::string_view format, std::span<const LogArgument> arguments);

} // namespace orvo
