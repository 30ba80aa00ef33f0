#pragma once

#include "platform/foundation/NSData.h"

#include <filesystem>
#include <memory>
#include <string>

namespace orvo {

/// Where a schedule is read from: a zip file, a folder, or the bytes of a zip file. A value.
class ScheduleSource {
public:
    /// A zip file or a plain folder.
    [[nodiscard]] static ScheduleSource fromPath(std::filesystem::path path);
    /// The bytes of a zip file. `name` stands in messages for where they come from, and must hold
    /// no secret.
    [[nodiscard]] static ScheduleSource fromBytes(std::shared_ptr<NSData> bytes, std::string name);

    /// Empty for bytes.
    [[nodiscard]] const std::filesystem::path& path() const noexcept { return _path; }
    /// Nil for a path.
    [[nodiscard]] const std::shared_ptr<NSData>& bytes() const noexcept { return _bytes; }
    /// What messages call it.
    [[nodiscard]] const std::string& name() const noexcept { return _name; }

private:
    std::filesystem::path _path;
    std::shared_ptr<NSData> _bytes;
    std::string _name;
};

} // namespace orvo
