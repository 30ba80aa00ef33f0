#include "platform/feeds/FeedRegistry.h"

#include "platform/feeds/_FeedFile.h"
#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/Log.h"
#include "platform/foundation/PropertyList.h"

#include <algorithm>
#include <fmt/format.h>
#include <map>
#include <mutex>

namespace orvo {

namespace {

constexpr const char* FeedsName = "feeds.plist";
constexpr const char* SecretsName = "feeds-secrets.plist";
constexpr const char* LockName = "feeds.plist.lock";

std::shared_ptr<NSError> feedError(FeedErrorCode code, std::string message) {
    return NSError::errorWithMessage(
        FeedErrorDomain, static_cast<std::int64_t>(code), std::move(message));
}

std::shared_ptr<NSError> damage(const std::filesystem::path& path, const std::string& reason) {
    return feedError(FeedErrorCode::Damaged,
                     fmt::format("{} is damaged: {}", path.string(), reason));
}

/// What the two files hold.
struct Stored {
    std::vector<FeedConfiguration> feeds;
    std::shared_ptr<NSError> unreadable; ///< the system does not give a file out
    std::vector<std::filesystem::path> damaged;
    std::shared_ptr<NSError> damage; ///< of the first of these

    [[nodiscard]] std::shared_ptr<NSError> error() const {
        return unreadable ? unreadable : damage;
    }
    void add(const std::filesystem::path& path, const std::string& reason) {
        if (!damage)
            damage = orvo::damage(path, reason);
        damaged.push_back(path);
    }
};

/// Nil when there is no such file or it is no property list.
std::shared_ptr<NSObject> readList(const std::filesystem::path& path, Stored& stored) {
    std::shared_ptr<NSError> error;
    const auto bytes = AtomicFile::read(path, &error);
    if (error && !stored.unreadable)
        stored.unreadable = error;
    if (!bytes)
        return nullptr;
    auto list = PropertyList::read(bytes->bytes(), &error);
    if (!list)
        stored.add(path, error->localizedDescription());
    return list;
}

Stored read(const std::filesystem::path& folder) {
    Stored stored;
    const auto feedsPath = folder / FeedsName;
    if (const auto list = readList(feedsPath, stored)) {
        if (auto feeds = _FeedFile::readFeeds(list.get()))
            stored.feeds = std::move(*feeds);
        else
            stored.add(feedsPath, "it holds no feeds");
    }
    const auto secretsPath = folder / SecretsName;
    if (const auto list = readList(secretsPath, stored);
        list && !_FeedFile::addSecrets(list.get(), stored.feeds))
        stored.add(secretsPath, "it holds no secrets");
    return stored;
}

std::shared_ptr<NSError>
write(const FileLock& lock, const std::filesystem::path& path, const NSDictionary& content) {
    std::shared_ptr<NSError> error;
    const auto bytes = PropertyList::write(content, &error);
    return bytes ? AtomicFile::write(lock, path, bytes->bytes()) : error;
}

/// The secrets of before and after lie there while the feeds change, so that whoever is killed, or
/// reads in between, finds feeds that have theirs.
std::shared_ptr<NSError> writeFiles(const FileLock& lock,
                                    const std::filesystem::path& folder,
                                    const std::vector<FeedConfiguration>& before,
                                    const std::vector<FeedConfiguration>& after) {
    const auto secretsBefore = _FeedFile::secrets(before);
    const auto secretsAfter = _FeedFile::secrets(after);
    const bool changesSecrets = !secretsBefore->isEqual(secretsAfter.get());
    if (changesSecrets) {
        auto both = before;
        both.insert(both.end(), after.begin(), after.end());
        if (auto error = write(lock, folder / SecretsName, *_FeedFile::secrets(both)))
            return error;
    }
    if (auto error = write(lock, folder / FeedsName, *_FeedFile::feeds(after)))
        return error;
    return changesSecrets ? write(lock, folder / SecretsName, *secretsAfter) : nullptr;
}

/// What is not to reach the disk, by the registry's folder.
class FeedsInMemory {
public:
    static FeedsInMemory& shared() {
        static FeedsInMemory feeds;
        return feeds;
    }

    [[nodiscard]] std::optional<std::vector<FeedConfiguration>>
    feeds(const std::filesystem::path& folder) const {
        const std::lock_guard lock(_mutex);
        const auto found = _feeds.find(folder);
        return found == _feeds.end() ? std::nullopt : std::optional(found->second);
    }
    void set(const std::filesystem::path& folder, std::vector<FeedConfiguration> feeds) {
        const std::lock_guard lock(_mutex);
        _feeds[folder] = std::move(feeds);
    }
    void forget() {
        const std::lock_guard lock(_mutex);
        _feeds.clear();
    }

private:
    mutable std::mutex _mutex;
    std::map<std::filesystem::path, std::vector<FeedConfiguration>> _feeds;
};

SourceRequest normalized(const SourceRequest& source) {
    auto request = source.withSecretsApart();
    // A `file://` URL is absolute already, and stays as the person wrote it.
    if (const auto path = request.localPath(); path && path->string() == request.location)
        request.location = std::filesystem::absolute(*path).lexically_normal().string();
    return request;
}

FeedConfiguration normalized(FeedConfiguration feed) {
    feed.schedule = normalized(feed.schedule);
    for (auto& source : feed.alerts)
        source = normalized(source);
    return feed;
}

auto feedNamed(std::vector<FeedConfiguration>& feeds, std::string_view name) {
    return std::ranges::find(feeds, name, &FeedConfiguration::name);
}

std::shared_ptr<NSError> unknownFeed(std::string_view name) {
    return feedError(FeedErrorCode::UnknownFeed, fmt::format("there is no feed \"{}\"", name));
}

} // namespace

std::shared_ptr<FeedRegistry> FeedRegistry::open(const ProfileFolders& profile) {
    return std::shared_ptr<FeedRegistry>(new FeedRegistry(profile.data));
}

FeedRegistry::FeedRegistry(std::filesystem::path folder)
    : _folder(std::move(folder)) {}

std::vector<FeedConfiguration> FeedRegistry::feeds(std::shared_ptr<NSError>* error) const {
    if (error)
        error->reset();
    if (!Environment::keepsWritesInMemory().get())
        FeedsInMemory::shared().forget();
    else if (auto feeds = FeedsInMemory::shared().feeds(_folder))
        return std::move(*feeds);
    auto stored = read(_folder);
    if (error)
        *error = stored.error();
    return std::move(stored.feeds);
}

std::optional<FeedConfiguration> FeedRegistry::feed(std::string_view name,
                                                    std::shared_ptr<NSError>* error) const {
    auto all = feeds(error);
    const auto found = feedNamed(all, name);
    return found == all.end() ? std::nullopt : std::optional(std::move(*found));
}

std::shared_ptr<NSError> FeedRegistry::add(const FeedConfiguration& feed) {
    if (auto problem = feed.problem())
        return problem;
    return change([&](Feeds& feeds) -> std::shared_ptr<NSError> {
        if (feedNamed(feeds, feed.name) != feeds.end())
            return feedError(FeedErrorCode::NameTaken,
                             fmt::format("there is a feed \"{}\" already", feed.name));
        feeds.push_back(normalized(feed));
        return nullptr;
    });
}

std::shared_ptr<NSError> FeedRegistry::replace(const FeedConfiguration& feed) {
    if (auto problem = feed.problem())
        return problem;
    return change([&](Feeds& feeds) -> std::shared_ptr<NSError> {
        const auto found = feedNamed(feeds, feed.name);
        if (found == feeds.end())
            return unknownFeed(feed.name);
        *found = normalized(feed);
        return nullptr;
    });
}

std::shared_ptr<NSError> FeedRegistry::remove(std::string_view name) {
    return change([&](Feeds& feeds) {
        const auto found = feedNamed(feeds, name);
        if (found == feeds.end())
            return unknownFeed(name);
        feeds.erase(found);
        return std::shared_ptr<NSError>();
    });
}

std::shared_ptr<NSError> FeedRegistry::setLastScheduleCheck(std::string_view name, double seconds) {
    return change([&](Feeds& feeds) {
        const auto found = feedNamed(feeds, name);
        if (found == feeds.end())
            return unknownFeed(name);
        found->lastScheduleCheck = seconds;
        return std::shared_ptr<NSError>();
    });
}

std::shared_ptr<NSError> FeedRegistry::change(const Change& change) {
    if (!Environment::keepsWritesInMemory().get()) {
        FeedsInMemory::shared().forget();
        return changeFiles(change);
    }
    std::shared_ptr<NSError> error;
    auto changed = feeds(&error);
    if (error || (error = change(changed)))
        return error;
    FeedsInMemory::shared().set(_folder, std::move(changed));
    return nullptr;
}

std::shared_ptr<NSError> FeedRegistry::changeFiles(const Change& change) {
    std::shared_ptr<NSError> error;
    const auto lock = AtomicFile::lockMakingFolder(_folder / LockName, &error);
    if (!lock)
        return error;
    auto stored = read(_folder);
    if (stored.unreadable)
        return stored.unreadable;
    const Feeds before = stored.feeds;
    if ((error = change(stored.feeds)))
        return error;
    for (const auto& path : stored.damaged) {
        const auto aside = AtomicFile::setAside(*lock, path, &error);
        if (error)
            return error;
        Log::findOrCreate("Feeds")->error(
            "%@ was damaged and now lies at %@", path.string(), aside.string());
    }
    return writeFiles(*lock, _folder, before, stored.feeds);
}

} // namespace orvo
