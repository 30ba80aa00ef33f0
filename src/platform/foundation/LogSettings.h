#pragma once

#include "platform/foundation/Log.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// What the variable `ORVO_LOG` says: a list such as `TransitWidget=debug,*=info,private`. A bare
/// level is that of `*`. The levels are debug, info, default, error and fault.
struct LogSettings {
    std::vector<std::pair<std::string, LogLevel>> levels;
    bool showsPrivate = false;
    std::vector<std::string> problems; ///< one sentence for each part that says nothing

    [[nodiscard]] static LogSettings parse(std::string_view text);
    /// Of this process. Read once.
    [[nodiscard]] static const LogSettings& ofProcess();

    /// The least level that `category` writes: what was said last of it, else of `*`, else
    /// `Default`.
    [[nodiscard]] static LogLevel least(const std::vector<std::pair<std::string, LogLevel>>& levels,
                                        std::string_view category);
};

[[nodiscard]] const char* nameOf(LogLevel level);

} // namespace orvo
