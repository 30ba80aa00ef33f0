#pragma once

#include "platform/foundation/NSError.h"

#include <cstddef>
#include <memory>
#include <span>

namespace orvo {

/// The bytes of one file of a schedule, from the first to the last.
class ScheduleStream {
public:
    ScheduleStream() = default;
    ScheduleStream(const ScheduleStream&) = delete;
    ScheduleStream& operator=(const ScheduleStream&) = delete;
    virtual ~ScheduleStream() = default;

    /// Fills the beginning of `buffer`.
    /// @return how many bytes were read; 0 at the end, and on failure, which sets `error`
    [[nodiscard]] virtual std::size_t read(std::span<char> buffer,
                                           std::shared_ptr<NSError>& error) = 0;
};

} // namespace orvo
