#pragma once

#include <filesystem>
#include <optional>

namespace orvo::FileTime {

/// When a file last changed, or of a folder the latest that lies directly in it or in a folder in
/// it; in seconds since 1970. Nothing where there is no such file.
[[nodiscard]] std::optional<double> lastChange(const std::filesystem::path& path);

} // namespace orvo::FileTime
