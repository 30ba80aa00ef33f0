#pragma once

#include "platform/foundation/NSDate.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>

namespace orvo {

/// Makes the dates of a feed's incidents. Most begin and end with the same few days: like dates
/// that are asked for one soon after the other are one object. One thread.
class IncidentDates {
public:
    /// @param seconds since 1970
    [[nodiscard]] const std::shared_ptr<NSDate>& date(std::int64_t seconds);

private:
    static constexpr std::size_t Slots = 64;

    std::array<std::shared_ptr<NSDate>, Slots> _recent; // each in the slot of its seconds
    std::array<std::int64_t, Slots> _seconds{};
};

} // namespace orvo
