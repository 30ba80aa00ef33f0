#pragma once

#include "platform/foundation/NSTimer.h"

namespace orvo::OrvoSharedExtras {

/// A timer on the current run loop that calls the block once, at `date`, with itself. A date that
/// has passed is reached in the next turn of the run loop.
/// @throws NSInvalidArgumentException for a nil date or an empty block
std::shared_ptr<NSTimer> _orvo_scheduledTimerWithFireDate_block(const std::shared_ptr<NSDate>& date,
                                                                NSTimer::Block block);

} // namespace orvo::OrvoSharedExtras
