#pragma once

#include "platform/foundation/NSData.h"

#include <cstddef>
#include <span>

namespace orvo {

/// How large what was handed over becomes once it is read, told without reading it: an empty
/// incident takes two bytes in a message and hundreds in memory, and in an archive many incidents
/// can share the same bytes.
struct HandOffSize {
    std::size_t messageBytes = 0; ///< of all incidents' messages, shared ones counted each time
    std::size_t records = 0;      ///< incidents, and what each concerns

    /// Of an `OrvoActivity` as a message.
    [[nodiscard]] static HandOffSize ofActivity(std::span<const std::uint8_t> message);
    /// Of an archive of incidents, counted until one of the two is past its limit. Nothing is
    /// counted in bytes that are no archive.
    [[nodiscard]] static HandOffSize ofArchive(const NSData& archive, const HandOffSize& limit);

    [[nodiscard]] bool isWithin(const HandOffSize& limit) const noexcept {
        return messageBytes <= limit.messageBytes && records <= limit.records;
    }
};

} // namespace orvo
