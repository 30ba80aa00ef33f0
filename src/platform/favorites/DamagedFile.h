#pragma once

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>

namespace orvo {

/// Puts a damaged store out of the way, so that a new one can begin in its place. Nothing is
/// deleted.
class DamagedFile {
public:
    /// Remembers which file lies at `path` now.
    explicit DamagedFile(std::filesystem::path path);

    /// Renames the file, with its journal, to `NAME.damaged-N` and says so in the log. Does nothing
    /// where another process did that already, or while writes are kept in memory. Whether it is
    /// worth trying to open the store again.
    [[nodiscard]] bool setAside(const std::string& reason) const;

private:
    [[nodiscard]] std::optional<std::uint64_t> currentFile() const;

    std::filesystem::path _path;
    std::optional<std::uint64_t> _file; // its number in the file system
};

} // namespace orvo
