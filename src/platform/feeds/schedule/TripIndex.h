#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <utility>
#include <vector>

namespace orvo {

/// Which line each trip belongs to, in 16 bytes a trip: trips are known by the hash of their id.
class TripIndex {
public:
    /// Of two trips with one id the first counts.
    void add(std::string_view tripId, std::uint32_t line);
    /// Called once, after the last trip and before the first question.
    void sort();
    [[nodiscard]] std::optional<std::uint32_t> lineOfTrip(std::string_view tripId) const;

private:
    std::vector<std::pair<std::uint64_t, std::uint32_t>> _lines; // by hash
};

} // namespace orvo
