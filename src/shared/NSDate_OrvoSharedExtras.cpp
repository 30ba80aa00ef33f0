#include "shared/NSDate_OrvoSharedExtras.h"

#include <cmath>
#include <cstdint>
#include <limits>

namespace orvo::OrvoSharedExtras {

namespace {

std::int32_t saturated(double number) {
    using Limits = std::numeric_limits<std::int32_t>;
    if (std::isnan(number))
        return 0;
    if (number <= Limits::min())
        return Limits::min();
    if (number >= Limits::max())
        return Limits::max();
    return static_cast<std::int32_t>(number);
}

} // namespace

NSTimeInterval _orvo_timeIntervalRoundedToMinutesFromTimeInterval(NSTimeInterval interval) {
    return saturated(std::round(interval / 60.0)) * 60.0;
}

} // namespace orvo::OrvoSharedExtras
