#include "platform/feeds/alerts/IncidentDates.h"

#include "platform/foundation/SeededStringHash.h"

namespace orvo {

const std::shared_ptr<NSDate>& IncidentDates::date(std::int64_t seconds) {
    const std::size_t slot = scattered(static_cast<std::uint64_t>(seconds)) % Slots;
    std::shared_ptr<NSDate>& recent = _recent[slot];
    if (!recent || _seconds[slot] != seconds) {
        recent = NSDate::dateWithTimeIntervalSince1970(static_cast<double>(seconds));
        _seconds[slot] = seconds;
    }
    return recent;
}

} // namespace orvo
