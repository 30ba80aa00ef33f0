#pragma once

#include "platform/feeds/alerts/Alert.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace orvo {

/// One alert of an incident, and the source that it came from.
struct IncidentMember {
    const Alert* alert = nullptr;
    std::size_t source = 0; ///< its place among the feed's sources
};

/// The alerts that are one incident, with all their translations.
struct Incident {
    std::uint64_t muid = 0; ///< the same at every fetch; never 0
    std::int32_t effect = 0;
    std::vector<IncidentMember> members; ///< in the order of the feed; at least one
    std::vector<AlertText> header;
    std::vector<AlertText> description;
    std::vector<AlertText> spokenHeader;
    std::vector<AlertText> link;
};

} // namespace orvo
