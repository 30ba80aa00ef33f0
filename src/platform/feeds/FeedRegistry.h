#pragma once

#include "platform/feeds/FeedConfiguration.h"
#include "platform/foundation/Environment.h"

#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// The feeds that the person added, in the order of their adding: `feeds.plist` in the profile's
/// data folder, and apart from it `feeds-secrets.plist` with what must not be seen (mode 0600). Any
/// thread, any number of processes: a change replaces the files whole, under a lock, and keeps what
/// others changed; a read sees what was written last.
///
/// A damaged file is an error for readers; the next change sets it aside and begins anew. While
/// `Environment::keepsWritesInMemory()` holds, changes are seen by this process alone, until the
/// first use after it no longer holds.
class FeedRegistry {
public:
    /// Touches no file yet.
    [[nodiscard]] static std::shared_ptr<FeedRegistry>
    open(const ProfileFolders& profile = Environment::profile().get());

    FeedRegistry(const FeedRegistry&) = delete;
    FeedRegistry& operator=(const FeedRegistry&) = delete;

    /// All feeds that could be read. `error` (may be nil) is set when a file cannot be read or is
    /// damaged, and nil otherwise; a missing file is an empty registry.
    [[nodiscard]] std::vector<FeedConfiguration>
    feeds(std::shared_ptr<NSError>* error = nullptr) const;
    /// Nothing when there is no feed of that name.
    [[nodiscard]] std::optional<FeedConfiguration>
    feed(std::string_view name, std::shared_ptr<NSError>* error = nullptr) const;

    /// At the end. Nil, or why nothing was changed: a bad name or source, a name that is taken, a
    /// file that cannot be written. Relative paths become absolute; user, password and known key
    /// parameters in a location are put among the secrets.
    [[nodiscard]] std::shared_ptr<NSError> add(const FeedConfiguration& feed);
    /// In the place of the feed of that name.
    [[nodiscard]] std::shared_ptr<NSError> replace(const FeedConfiguration& feed);
    [[nodiscard]] std::shared_ptr<NSError> remove(std::string_view name);
    /// Notes that a newer schedule was asked for, by the environment's wall clock. Seconds since
    /// 1970.
    [[nodiscard]] std::shared_ptr<NSError> setLastScheduleCheck(std::string_view name,
                                                                double seconds);

private:
    using Feeds = std::vector<FeedConfiguration>;
    using Change = std::function<std::shared_ptr<NSError>(Feeds& feeds)>;

    explicit FeedRegistry(std::filesystem::path folder);
    [[nodiscard]] std::shared_ptr<NSError> change(const Change& change);
    [[nodiscard]] std::shared_ptr<NSError> changeFiles(const Change& change);

    const std::filesystem::path _folder;
};

} // namespace orvo
