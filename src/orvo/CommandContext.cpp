#include "orvo/CommandContext.h"

#include "platform/foundation/NSDate.h"
#include "platform/foundation/RunLoop.h"

#include <fmt/format.h>
#include <set>

namespace orvo {

namespace {

/// The damaged files that were renamed to make room at `path`.
std::set<std::filesystem::path> setAside(const std::filesystem::path& path) {
    std::set<std::filesystem::path> files;
    const std::string beginning = path.filename().string() + ".damaged-";
    std::error_code ignored;
    for (const auto& entry : std::filesystem::directory_iterator(path.parent_path(), ignored)) {
        const std::string name = entry.path().filename().string();
        const bool isJournal = name.ends_with("-wal") || name.ends_with("-shm");
        if (name.starts_with(beginning) && !isJournal)
            files.insert(entry.path());
    }
    return files;
}

/// What a person can do about it, or nothing.
std::string cureOf(const NSError& error) {
    if (error.domain() == FeedErrorDomain &&
        error.code() == static_cast<std::int64_t>(FeedErrorCode::Damaged))
        return "Put a good copy in its place, or add your feeds anew with orvo feeds add, which "
               "sets it aside.";
    if (error.domain() != FavoritesErrorDomain)
        return {};
    switch (static_cast<FavoritesError>(error.code())) {
    case FavoritesError::CannotRead:
        return "Put a good copy in its place, or add your favourites anew with: orvo favorites "
               "add";
    case FavoritesError::CannotOpen:
        return "Make it readable or put a good copy in its place; to begin anew, move it away.";
    case FavoritesError::CannotWrite:
        return "Make the file and its folder writable.";
    case FavoritesError::Locked:
        return "Another program uses the file. Try again when that is done.";
    default:
        return {};
    }
}

} // namespace

// A command asks its context for whatever is outside of it, as an object.
// NOLINTNEXTLINE(readability-convert-member-functions-to-static)
double CommandContext::now() const {
    return NSDate::date()->timeIntervalSince1970();
}

std::shared_ptr<ScheduleStore> CommandContext::schedules(std::shared_ptr<NSError>& error) {
    if (!_schedules)
        _schedules = ScheduleStore::open(ScheduleStore::defaultPath(), &error);
    return _schedules;
}

std::shared_ptr<ScheduleStore> CommandContext::schedulesIfReadable() {
    std::shared_ptr<NSError> ignored;
    return schedules(ignored);
}

const std::shared_ptr<FeedRegistry>& CommandContext::registry() {
    if (!_registry)
        _registry = FeedRegistry::open();
    return _registry;
}

std::shared_ptr<FavoritesStore> CommandContext::favorites(FavoritesStore::Access access,
                                                          std::shared_ptr<NSError>& error) {
    const auto path = FavoritesStore::standardPath();
    const auto before = setAside(path);
    auto store = FavoritesStore::open(path, access, &error);
    for (const auto& aside : setAside(path)) {
        if (before.contains(aside)) // of an earlier time
            continue;
        error = favoritesError(
            FavoritesError::CannotRead,
            fmt::format("{} is damaged and was set aside as {}", path.string(), aside.string()));
        return nullptr;
    }
    return store;
}

void CommandContext::waitUntil(const std::function<bool()>& done) {
    constexpr NSTimeInterval Patience = 3600;
    while (!done())
        RunLoop::main().runUntil(done, Patience);
}

ExitCode CommandContext::fail(const NSError& error) const {
    return fail(error.localizedDescription(), cureOf(error));
}

ExitCode CommandContext::fail(std::string_view message, std::string_view cure) const {
    _terminal.error(message, cure);
    return ExitCode::Failed;
}

ExitCode CommandContext::wrongUsage(std::string_view message, std::string_view cure) const {
    _terminal.error(message, cure);
    return ExitCode::WrongUsage;
}

} // namespace orvo
