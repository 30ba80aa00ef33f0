#pragma once

#include <filesystem>
#include <set>
#include <string>
#include <vector>

namespace orvo {

/// Finds out which of the person's own files (feeds, settings) were damaged and set aside while it
/// lived, by whatever part of the program. It looks at the profile in use when it is made.
class DamageWatch {
public:
    struct Damage {
        std::string message; ///< the file, what is wrong with it, and where it lies now
        std::string cure;
    };

    DamageWatch();

    /// In order of name.
    [[nodiscard]] std::vector<Damage> found() const;

private:
    using Files = std::set<std::filesystem::path>;
    /// The lists that were renamed in the folder by now.
    [[nodiscard]] Files setAside() const;

    std::filesystem::path _folder;
    Files _before;
};

} // namespace orvo
