#pragma once

#include <map>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>

namespace orvo {

/// How long a server wants to be left alone, in seconds from 0 to a day, by its Retry-After header
/// (seconds or a date). A date counts from the server's own Date header, so that no clock here
/// matters; without one from `now` (since 1970). Nothing for a header that is neither.
[[nodiscard]] std::optional<double>
retryDelay(std::string_view retryAfter, std::string_view date, double now);

/// The pauses that servers asked for, by request. Any thread.
class RetryPauses {
public:
    static constexpr double Longest = 24 * 3600; ///< seconds

    struct Pause {
        double seconds; ///< that are left, above 0
        int status;     ///< with which the server asked for it
    };

    /// `monotonicNow` is the environment's.
    void note(const std::string& key, double seconds, int status, double monotonicNow);
    /// Nothing when no pause is under way.
    [[nodiscard]] std::optional<Pause> pending(const std::string& key, double monotonicNow);

private:
    struct End {
        double at;
        int status;
    };
    std::mutex _mutex;
    std::map<std::string, End> _ends;
};

} // namespace orvo
