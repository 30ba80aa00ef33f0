#include "platform/feeds/http/RetryPauses.h"

#include "platform/feeds/http/HttpDate.h"

#include <algorithm>
#include <cctype>
#include <charconv>

namespace orvo {

std::optional<double> retryDelay(std::string_view retryAfter, std::string_view date, double now) {
    if (retryAfter.empty())
        return std::nullopt;
    if (std::ranges::all_of(retryAfter, [](unsigned char c) { return std::isdigit(c) != 0; })) {
        unsigned seconds = 0;
        const auto result =
            std::from_chars(retryAfter.data(), retryAfter.data() + retryAfter.size(), seconds);
        return result.ec == std::errc() ? std::min<double>(seconds, RetryPauses::Longest)
                                        : RetryPauses::Longest;
    }
    const auto until = parseHttpDate(retryAfter);
    if (!until)
        return std::nullopt;
    return std::clamp(*until - parseHttpDate(date).value_or(now), 0.0, RetryPauses::Longest);
}

void RetryPauses::note(const std::string& key, double seconds, int status, double monotonicNow) {
    const std::lock_guard lock(_mutex);
    _ends[key] = {monotonicNow + seconds, status};
}

std::optional<RetryPauses::Pause> RetryPauses::pending(const std::string& key,
                                                       double monotonicNow) {
    const std::lock_guard lock(_mutex);
    std::erase_if(_ends, [&](const auto& entry) { return entry.second.at <= monotonicNow; });
    const auto found = _ends.find(key);
    if (found == _ends.end())
        return std::nullopt;
    return Pause{found->second.at - monotonicNow, found->second.status};
}

} // namespace orvo
