#include "platform/feeds/alerts/HeaderTime.h"

namespace orvo {

namespace {
constexpr double StaleAfter = 24.0 * 60 * 60;
} // namespace

std::optional<double> headerTime(std::uint64_t timestamp, double fetchedAt, double now) noexcept {
    const auto made = static_cast<double>(wholeSeconds(timestamp));
    if (timestamp == 0 || made > now)
        return fetchedAt;
    if (now - made > StaleAfter)
        return std::nullopt;
    return made;
}

} // namespace orvo
