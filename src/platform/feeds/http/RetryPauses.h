#pragma once

#include "platform/foundation/NSError.h"

#include <filesystem>
#include <map>
#include <memory>
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

/// The pauses that servers asked for, by the key of the request: kept in a folder that several
/// processes share, so that a program that is started anew does not ask again. `KEY.plist` says
/// when a pause ends, by the machine's own clock: the environment's may stand in another year.
/// Nobody else writes to the folder. While `Environment::keepsWritesInMemory()` holds, it is only
/// read. Any thread.
class RetryPauses {
public:
    static constexpr double Longest = 24 * 3600; ///< seconds

    struct Pause {
        double seconds; ///< that are left, above 0
        int status;     ///< with which the server asked for it
    };

    /// The folder need not exist yet.
    explicit RetryPauses(std::filesystem::path folder);
    RetryPauses(const RetryPauses&) = delete;
    RetryPauses& operator=(const RetryPauses&) = delete;

    /// The last word holds. `monotonicNow` is the environment's.
    /// @return nil, or why other processes will not know
    std::shared_ptr<NSError>
    note(const std::string& key, double seconds, int status, double monotonicNow);
    /// Ends the pause, of which the server wants no more.
    void forget(const std::string& key);
    /// Nothing when no pause is under way. What another process noted is heard once and then
    /// counted down here; not when it would last longer than the server wanted, as it would after
    /// the machine's clock was set back.
    [[nodiscard]] std::optional<Pause> pending(const std::string& key, double monotonicNow);

private:
    /// As the file has it.
    struct Kept {
        double until = 0; ///< seconds since 1970
        double seconds = 0;
        int status = 0;
    };
    struct End {
        double at = 0; ///< monotonic
        int status = 0;
        double until = 0; ///< as in the file by which it is known
    };

    [[nodiscard]] std::filesystem::path path(const std::string& key) const;
    [[nodiscard]] std::shared_ptr<NSError> write(const std::string& key, const Kept& pause) const;
    [[nodiscard]] std::optional<Kept> kept(const std::string& key) const;

    std::filesystem::path _folder;
    std::mutex _mutex;
    std::map<std::string, End> _ends;
};

} // namespace orvo
