#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace orvo {

/// What a feed's schedule says about itself. Texts that it does not give are empty.
struct ScheduleInfo {
    std::string feed; ///< the feed's short name
    std::string publisher;
    std::string version;
    std::string language;  ///< of its texts, a BCP-47 tag: feed_info.txt's, else the first agency's
    std::string timezone;  ///< the first agency's, an IANA name
    std::string startDate; ///< the first day that it covers, `2024-07-09`
    std::string endDate;   ///< the last day that it covers, `2024-08-24`
    /// When the last day ends in the schedule's zone, in seconds since 1970; nothing without a last
    /// day.
    std::optional<double> validUntil;
    double importedAt = 0; ///< seconds since 1970
    std::int64_t agencies = 0;
    std::int64_t lines = 0;
    std::int64_t stops = 0;
    bool knowsStopsOfLines = false; ///< whether it tells which lines serve a stop

    /// Whether the last day is over at `now`, in seconds since 1970.
    [[nodiscard]] bool hasRunOut(double now) const noexcept {
        return validUntil && now >= *validUntil;
    }
};

} // namespace orvo
