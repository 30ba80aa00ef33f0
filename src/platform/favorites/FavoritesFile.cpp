#include "platform/favorites/FavoritesFile.h"

#include "platform/favorites/DamagedFile.h"
#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/Environment.h"

#include <fmt/format.h>

namespace orvo {

namespace {

// Positions lie far apart, so that a favourite moves between two others without touching them.
constexpr const char* Layout = R"(
CREATE TABLE favorite (
    number INTEGER PRIMARY KEY AUTOINCREMENT,
    position INTEGER NOT NULL,
    kind TEXT NOT NULL,
    name TEXT,
    muid INTEGER,
    feed TEXT,
    route_id TEXT,
    system_name TEXT,
    record BLOB,
    latitude REAL,
    longitude REAL
);
CREATE INDEX favorite_position ON favorite (position, number);
CREATE UNIQUE INDEX favorite_line ON favorite (muid) WHERE kind = 'line';
CREATE UNIQUE INDEX favorite_place ON favorite (name, latitude, longitude) WHERE kind = 'place';
PRAGMA user_version = 1;
)";

} // namespace

std::unique_ptr<SQLiteDatabase> FavoritesFile::open(const std::filesystem::path& path,
                                                    FavoritesStore::Access access,
                                                    std::shared_ptr<NSError>* error) {
    FavoritesFile file(path);
    const auto attempt = [&] {
        if (Environment::keepsWritesInMemory().get())
            return file.openCopy();
        return access == FavoritesStore::Access::Read ? file.openForReading()
                                                      : file.openForWriting();
    };
    const DamagedFile damaged(path);
    auto database = attempt();
    if (!database && file._failure.isDamage() && damaged.setAside(file._failure.reason))
        database = attempt();
    if (!database && error)
        *error = favoritesError(file.errorCode(),
                                fmt::format("{}: the favorites cannot be opened: {}",
                                            path.string(),
                                            file._failure.reason));
    return database;
}

FavoritesError FavoritesFile::errorCode() const {
    if (_failure.isLocked())
        return FavoritesError::Locked;
    return _failure.isReadOnly() ? FavoritesError::CannotWrite : FavoritesError::CannotOpen;
}

std::optional<bool> FavoritesFile::isThere() {
    std::error_code reason;
    const auto size = std::filesystem::file_size(_path, reason);
    // A file without a byte is one that another process is about to lay out.
    if (!reason || reason == std::errc::no_such_file_or_directory)
        return !reason && size > 0;
    _failure = {-1, reason.message()};
    return std::nullopt;
}

std::unique_ptr<SQLiteDatabase> FavoritesFile::openForReading() {
    const auto isFile = isThere();
    if (!isFile.value_or(false))
        return isFile ? openEmpty() : nullptr;
    auto database = SQLiteDatabase::open(_path, SQLiteDatabase::Mode::Read, &_failure);
    if (!database || !isUsable(*database))
        return nullptr;
    return database->userVersion() == 0 ? openEmpty() : std::move(database);
}

std::unique_ptr<SQLiteDatabase> FavoritesFile::openForWriting() {
    if (const auto error = AtomicFile::makeFolder(_path.parent_path())) {
        _failure = {-1, error->localizedDescription()};
        return nullptr;
    }
    auto database = SQLiteDatabase::open(_path, SQLiteDatabase::Mode::Write, &_failure);
    return database && isUsable(*database) && layOut(*database) ? std::move(database) : nullptr;
}

std::unique_ptr<SQLiteDatabase> FavoritesFile::openCopy() {
    const auto isFile = isThere();
    if (!isFile.value_or(false))
        return isFile ? openEmpty() : nullptr;
    auto database = SQLiteDatabase::openInMemory(_path, &_failure);
    return database && isUsable(*database) && layOut(*database) ? std::move(database) : nullptr;
}

std::unique_ptr<SQLiteDatabase> FavoritesFile::openEmpty() {
    auto database = SQLiteDatabase::openInMemory(std::nullopt, &_failure);
    return database && layOut(*database) ? std::move(database) : nullptr;
}

bool FavoritesFile::isUsable(SQLiteDatabase& database) {
    const auto version = database.userVersion();
    if (!version || !database.isSound()) {
        _failure = database.failure();
        return false;
    }
    if (*version <= Version)
        return true;
    _failure = {-1, fmt::format("it has layout {}, and this program knows {}", *version, Version)};
    return false;
}

bool FavoritesFile::layOut(SQLiteDatabase& database) {
    if (database.userVersion() == Version)
        return true;
    SQLiteTransaction transaction(database);
    // Another process may have laid it out while this one waited for the lock.
    if (transaction.isOpen() && database.userVersion() == Version)
        return true;
    if (transaction.isOpen() && database.execute(Layout) && transaction.commit())
        return true;
    _failure = database.failure();
    return false;
}

} // namespace orvo
