#include "platform/feeds/schedule/TripIndex.h"

#include "platform/foundation/Hashing.h"

#include <algorithm>

namespace orvo {

void TripIndex::add(std::string_view tripId, std::uint32_t line) {
    _lines.emplace_back(stableHash(tripId), line);
}

void TripIndex::sort() {
    std::ranges::stable_sort(_lines, {}, &std::pair<std::uint64_t, std::uint32_t>::first);
}

std::optional<std::uint32_t> TripIndex::lineOfTrip(std::string_view tripId) const {
    const std::uint64_t hash = stableHash(tripId);
    const auto found =
        std::ranges::lower_bound(_lines, hash, {}, &std::pair<std::uint64_t, std::uint32_t>::first);
    if (found == _lines.end() || found->first != hash)
        return std::nullopt;
    return found->second;
}

} // namespace orvo
