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
/// processes share, so that a program that is started anew does not ask again. `KEY.plist` says how
/// long a pause lasts from the time at which the file was written. Nobody else writes to the
/// folder. While `Environment::keepsWritesInMemory()` holds, the folder is only read. Any thread.
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
    /// Nothing when no pause is under way. A pause that was noted here ends by the monotonic clock,
    /// one of another process by the file system's: should that clock have been turned back since,
    /// the pause begins anew.
    [[nodiscard]] std::optional<Pause> pending(const std::string& key, double monotonicNow);

private:
    using FileTime = std::filesystem::file_time_type;

    struct End {
        double at = 0; // monotonic
        int status = 0;
        std::optional<FileTime> written; ///< of its file
    };

    [[nodiscard]] std::filesystem::path path(const std::string& key) const;
    [[nodiscard]] std::shared_ptr<NSError>
    write(const std::string& key, double seconds, int status) const;
    [[nodiscard]] std::optional<FileTime> written(const std::string& key) const;
    [[nodiscard]] std::optional<Pause> pauseOnDisk(const std::string& key, FileTime written) const;

    std::filesystem::path _folder;
    std::mutex _mutex;
    std::map<std::string, End> _ends;
};

} // namespace orvo
