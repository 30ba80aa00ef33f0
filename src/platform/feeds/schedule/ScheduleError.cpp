#include "platform/feeds/schedule/ScheduleError.h"

#include <utility>

namespace orvo {

std::shared_ptr<NSError> scheduleError(ScheduleErrorCode code, std::string message) {
    return NSError::errorWithMessage(
        ScheduleErrorDomain, static_cast<std::int64_t>(code), std::move(message));
}

} // namespace orvo
