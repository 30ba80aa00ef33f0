#pragma once

#include "platform/foundation/NSError.h"

#include <cstdint>
#include <memory>
#include <string>

namespace orvo {

inline constexpr const char* ScheduleErrorDomain = "ScheduleErrorDomain";

/// Codes of `ScheduleErrorDomain`. Every message names the file, where there is one the row, and
/// the reason.
enum class ScheduleErrorCode : std::int64_t {
    CannotRead = 1,   ///< the file, the folder or a part of the archive cannot be read
    NotAnArchive = 2, ///< neither a zip file nor a folder
    NoSchedule = 3,   ///< no routes.txt, or one without lines
    SeveralSchedules = 4,
    TooLarge = 5,   ///< more than the limits
    NotText = 6,    ///< not UTF-8, or a table that cannot be told apart
    Store = 7,      ///< the store on disk cannot be read or written
    NewerStore = 8, ///< the store was written by a later version of this program
};

[[nodiscard]] std::shared_ptr<NSError> scheduleError(ScheduleErrorCode code, std::string message);

} // namespace orvo
