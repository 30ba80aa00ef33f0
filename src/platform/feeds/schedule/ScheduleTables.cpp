#include "platform/feeds/schedule/ScheduleTables.h"

#include "platform/feeds/schedule/ScheduleError.h"

#include <string>
#include <system_error>
#include <utility>

namespace orvo::ScheduleTables {

namespace {

constexpr std::int64_t Version = 2;

// A line keeps the agency row that it was imported with, so that one that left its schedule still
// knows its agency. `muid` is the unsigned number's bits.
constexpr const char* Tables = R"(
CREATE TABLE feed (
    number INTEGER PRIMARY KEY,
    name TEXT NOT NULL UNIQUE,
    present INTEGER NOT NULL,
    generation INTEGER NOT NULL, -- counts its imports
    publisher TEXT NOT NULL,
    version TEXT NOT NULL,
    language TEXT NOT NULL,
    timezone TEXT NOT NULL,
    start_date TEXT NOT NULL,
    end_date TEXT NOT NULL,
    valid_until REAL,
    imported_at REAL NOT NULL,
    agencies INTEGER NOT NULL,
    lines INTEGER NOT NULL,
    stops INTEGER NOT NULL,
    knows_stops INTEGER NOT NULL
);
CREATE TABLE agency (
    number INTEGER PRIMARY KEY,
    feed INTEGER NOT NULL REFERENCES feed,
    id TEXT NOT NULL,
    name TEXT NOT NULL,
    url TEXT NOT NULL,
    timezone TEXT NOT NULL,
    language TEXT NOT NULL
);
CREATE INDEX agency_of_feed ON agency (feed);
CREATE TABLE line (
    muid INTEGER PRIMARY KEY,
    feed INTEGER NOT NULL REFERENCES feed,
    route_id TEXT NOT NULL,
    agency_id TEXT NOT NULL,
    agency INTEGER NOT NULL REFERENCES agency,
    short_name TEXT NOT NULL,
    long_name TEXT NOT NULL,
    color TEXT NOT NULL,
    text_color TEXT NOT NULL,
    url TEXT NOT NULL,
    type INTEGER NOT NULL,
    position INTEGER NOT NULL,
    present INTEGER NOT NULL,
    known_at REAL NOT NULL -- when a schedule that has it was last imported; 0 where unknown
);
CREATE INDEX line_of_feed ON line (feed, present, position);
CREATE INDEX line_of_agency ON line (agency);
CREATE TABLE stop (
    number INTEGER PRIMARY KEY,
    feed INTEGER NOT NULL REFERENCES feed,
    id TEXT NOT NULL,
    name TEXT NOT NULL
);
CREATE UNIQUE INDEX stop_of_feed ON stop (feed, id);
CREATE TABLE stop_line (
    stop INTEGER NOT NULL REFERENCES stop,
    line INTEGER NOT NULL REFERENCES line,
    PRIMARY KEY (stop, line)
) WITHOUT ROWID;
CREATE TABLE translation (
    feed INTEGER NOT NULL REFERENCES feed,
    source TEXT NOT NULL,
    field TEXT NOT NULL,
    language TEXT NOT NULL,
    record TEXT NOT NULL,
    value TEXT NOT NULL,
    text TEXT NOT NULL
);
CREATE INDEX translation_of_feed ON translation (feed);
PRAGMA user_version = 2;
)";

// The first version did not keep how old what it knew of departed lines was.
constexpr const char* FromVersion1 = R"(
ALTER TABLE line ADD COLUMN known_at REAL NOT NULL DEFAULT 0;
UPDATE line SET known_at = (SELECT imported_at FROM feed WHERE feed.number = line.feed)
WHERE present = 1;
PRAGMA user_version = 2;
)";

/// Makes the tables in a new file, brings those of an older one up to date, and refuses a later
/// one.
std::shared_ptr<NSError> prepare(SQLiteDatabase& database, const std::filesystem::path& path) {
    const auto version = database.userVersion();
    if (!version)
        return failureOf(database.failure(), path);
    if (*version > Version)
        return scheduleError(ScheduleErrorCode::NewerStore,
                             path.string() +
                                 ": was written by a later version of this program; update the "
                                 "program");
    if (*version == Version)
        return nullptr;
    SQLiteTransaction transaction(database);
    // Another process may have made them while this one waited.
    const auto found = transaction.isOpen() ? database.userVersion() : std::nullopt;
    if (found == Version)
        return nullptr;
    if (found && database.execute(*found == 0 ? Tables : FromVersion1) && transaction.commit())
        return nullptr;
    return failureOf(database.failure(), path);
}

} // namespace

std::shared_ptr<NSError> failureOf(const SQLiteFailure& failure,
                                   const std::filesystem::path& path) {
    std::string message = path.string() + ": " + failure.reason;
    if (failure.isDamage())
        message += "; move it away and run “orvo feeds update”";
    if (failure.isLocked())
        message += " by another program; try again when that is done";
    return scheduleError(ScheduleErrorCode::Store, std::move(message));
}

std::unique_ptr<SQLiteDatabase> openForWriting(const std::filesystem::path& path,
                                               std::chrono::seconds patience,
                                               std::shared_ptr<NSError>& error) {
    std::error_code unmade;
    std::filesystem::create_directories(path.parent_path(), unmade);
    if (unmade) {
        error = scheduleError(ScheduleErrorCode::Store,
                              path.parent_path().string() + ": " + unmade.message());
        return nullptr;
    }
    SQLiteFailure failure;
    auto database = SQLiteDatabase::open(path, SQLiteDatabase::Mode::Write, &failure, patience);
    error = database ? prepare(*database, path) : failureOf(failure, path);
    return error ? nullptr : std::move(database);
}

std::unique_ptr<SQLiteDatabase> openForReading(const std::filesystem::path& path,
                                               std::chrono::seconds patience,
                                               std::shared_ptr<NSError>& error) {
    std::error_code unknown;
    if (!std::filesystem::exists(path, unknown)) {
        if (unknown) // something hides it, or stands in its way
            error =
                scheduleError(ScheduleErrorCode::Store, path.string() + ": " + unknown.message());
        return nullptr;
    }
    SQLiteFailure failure;
    auto database = SQLiteDatabase::open(path, SQLiteDatabase::Mode::Read, &failure, patience);
    if (!database) {
        error = failureOf(failure, path);
        return nullptr;
    }
    const auto version = database->userVersion();
    if (version == 0)
        return nullptr;
    if (version && *version < Version)
        return openInMemory(path, error);
    error = prepare(*database, path);
    return error ? nullptr : std::move(database);
}

std::unique_ptr<SQLiteDatabase> openInMemory(const std::optional<std::filesystem::path>& copied,
                                             std::shared_ptr<NSError>& error) {
    const std::filesystem::path name = copied.value_or("memory");
    SQLiteFailure failure;
    auto database = SQLiteDatabase::openInMemory(copied, &failure);
    error = database ? prepare(*database, name) : failureOf(failure, name);
    return error ? nullptr : std::move(database);
}

} // namespace orvo::ScheduleTables
