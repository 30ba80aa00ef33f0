#pragma once

#include "support/TemporaryProfile.h"

#include <fstream>
#include <iterator>
#include <sys/stat.h>

namespace orvo::testing {

/// A program that reports how it was started: its arguments, `|`, and its standard input.
class ScriptedProgram {
public:
    ScriptedProgram() {
        if (mkfifo(reportPath().c_str(), 0600) != 0)
            throw std::runtime_error("cannot make a pipe");
        std::ofstream(path()) << "#!/bin/sh\n{ printf '%s|' \"$*\"; cat; } > " << reportPath()
                              << "\n";
        std::filesystem::permissions(path(), std::filesystem::perms::owner_all);
    }

    std::filesystem::path path() const { return _folder.path() / "program"; }
    /// Waits for the next start.
    std::string report() const {
        std::ifstream pipe(reportPath(), std::ios::binary);
        return {std::istreambuf_iterator<char>(pipe), {}};
    }

private:
    std::filesystem::path reportPath() const { return _folder.path() / "report"; }

    TemporaryFolder _folder;
};

} // namespace orvo::testing
