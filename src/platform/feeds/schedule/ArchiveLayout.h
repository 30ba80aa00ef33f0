#pragma once

#include "platform/foundation/NSError.h"

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// One file of a folder or archive.
struct ArchiveEntry {
    std::string path;         ///< from the top, parts divided by `/`
    std::uint64_t number = 0; ///< what its archive knows it by
    std::uint64_t size = 0;   ///< as stated, inflated
};

/// Where in a folder or archive the schedule lies: at the top, or in one enclosing folder. The
/// folder with routes.txt in it is the schedule; what systems put beside it (`__MACOSX`, names that
/// begin with a dot) is passed over. Case does not count in names.
class ArchiveLayout {
public:
    /// `name` is what messages call the folder or archive.
    /// @return nothing, with the reason in `error`, when there is no schedule in it, more than one,
    /// or one that lies deeper
    [[nodiscard]] static std::optional<ArchiveLayout> find(std::vector<ArchiveEntry> entries,
                                                           const std::string& name,
                                                           std::shared_ptr<NSError>& error);

    /// The schedule's file of this name, such as `stops.txt`; nil when it has none.
    [[nodiscard]] const ArchiveEntry* entry(std::string_view file) const;

private:
    std::map<std::string, ArchiveEntry, std::less<>> _entries;
};

} // namespace orvo
