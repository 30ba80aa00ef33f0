#pragma once

#include "platform/feeds/alerts/Alert.h"

#include <cstddef>
#include <cstdint>
#include <memory_resource>
#include <vector>

namespace orvo {

/// One alert of an incident, and the source that it came from.
struct IncidentMember {
    const Alert* alert = nullptr;
    std::size_t source = 0; ///< its place among the feed's sources
};

/// The alerts that are one incident, with all their translations. It is valid as long as they are.
struct Incident {
    explicit Incident(AlertRoom room = {})
        : members(room)
        , header(room)
        , description(room)
        , spokenHeader(room)
        , link(room) {}

    std::uint64_t muid = 0; ///< the same at every fetch; never 0
    std::int32_t effect = 0;
    std::pmr::vector<IncidentMember> members; ///< in the order of the feed; at least one
    AlertTexts header;
    AlertTexts description;
    AlertTexts spokenHeader;
    AlertTexts link;
};

} // namespace orvo
