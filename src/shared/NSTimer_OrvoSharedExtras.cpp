#include "shared/NSTimer_OrvoSharedExtras.h"

#include "platform/foundation/Exceptions.h"

#include <limits>
#include <utility>

namespace orvo::OrvoSharedExtras {

std::shared_ptr<NSTimer> _orvo_scheduledTimerWithFireDate_block(const std::shared_ptr<NSDate>& date,
                                                                NSTimer::Block block) {
    if (!date)
        throw NSInvalidArgumentException("a timer needs a fire date"); // before one is scheduled
    // The interval is never waited for: it only must not end before the date is set.
    auto timer = NSTimer::scheduledTimerWithTimeInterval_repeats_block(
        std::numeric_limits<NSTimeInterval>::max(), false, std::move(block));
    timer->setFireDate(date);
    return timer;
}

} // namespace orvo::OrvoSharedExtras
