#pragma once

#include "platform/foundation/Environment.h"

#include <cstdlib>
#include <filesystem>
#include <stdexcept>
#include <string>

namespace orvo::testing {

/// A folder of its own, deleted with everything in it at the end.
class TemporaryFolder {
public:
    TemporaryFolder() {
        std::string pattern =
            (std::filesystem::temp_directory_path() / "orvo-test-XXXXXX").string();
        if (!mkdtemp(pattern.data()))
            throw std::runtime_error("cannot make a temporary folder");
        _path = pattern;
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;
    ~TemporaryFolder() {
        std::error_code ignored;
        std::filesystem::remove_all(_path, ignored);
    }

    const std::filesystem::path& path() const { return _path; }

private:
    std::filesystem::path _path;
};

/// A profile of its own for the scope of a test: nothing of the machine's is read or written.
class TemporaryProfile {
public:
    TemporaryProfile()
        : _override(Environment::profile().overrideWith(
              {_folder.path() / "data", _folder.path() / "cache", _folder.path() / "state"})) {}

    const std::filesystem::path& path() const { return _folder.path(); }

private:
    TemporaryFolder _folder;
    EnvironmentSlot<ProfileFolders>::Override _override;
};

} // namespace orvo::testing
