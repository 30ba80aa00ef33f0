#pragma once

#include "platform/foundation/NSDate.h"

namespace orvo::OrvoSharedExtras {

/// The interval in whole minutes, as seconds; half a minute is rounded away from zero. Minutes stop
/// at the limits of a signed 32-bit number; not-a-number gives 0.
[[nodiscard]] NSTimeInterval
_orvo_timeIntervalRoundedToMinutesFromTimeInterval(NSTimeInterval interval);

} // namespace orvo::OrvoSharedExtras
