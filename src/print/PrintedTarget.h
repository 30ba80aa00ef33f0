#pragma once

#include "handoff/OWOpenable.h"
#include "platform/foundation/NSDictionary.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// What a tap on a row opens, read from the openable itself: an activity's numbers come from the
/// bytes that the map application will get.
struct PrintedTarget {
    std::optional<std::string> url; ///< nothing for an activity
    std::string activityType;
    /// The incidents of an incident list, in order; nothing where it holds no readable list.
    std::optional<std::vector<std::uint64_t>> incidentMuids = {};
    /// The line of an incident; nothing where it holds no readable line.
    std::optional<std::uint64_t> lineMuid = {};
    std::shared_ptr<NSDictionary> userInfo = {}; ///< nil for a URL

    /// Nothing for nil, a row that cannot be tapped. `before`, which may be nil: the target of the
    /// row before, whose bytes are not read again where they are the very same; rows of one line
    /// share them, and they hold all of its incidents.
    [[nodiscard]] static std::optional<PrintedTarget>
    of(const std::shared_ptr<OWOpenable>& openable, const PrintedTarget* before = nullptr);

    /// For people, in one line.
    [[nodiscard]] std::string text() const;
};

} // namespace orvo
