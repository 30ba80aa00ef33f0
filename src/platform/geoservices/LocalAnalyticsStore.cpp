#include "platform/geoservices/LocalAnalyticsStore.h"

#include "platform/foundation/Environment.h"
#include "platform/foundation/Log.h"
#include "platform/sqlite/SQLiteDatabase.h"
#include "platform/sqlite/SQLiteStatement.h"

#include <fmt/format.h>

namespace orvo {

namespace {

constexpr const char* ErrorDomain = "OrvoAnalyticsErrorDomain";

constexpr const char* Schema = R"(
create table if not exists sessions (
    id integer primary key, started_at real not null, duration real not null, type integer not null,
    end_state integer not null, was_locked integer not null, initially_expanded integer not null,
    ever_expanded integer not null, message_type integer not null, tapped_index integer not null);
create table if not exists incidents (
    session integer not null references sessions(id), position integer not null, line_muid text not null,
    title text not null, primary key (session, position)) without rowid;
create table if not exists actions (
    id integer primary key, at real not null, action integer not null, target integer not null, value text);
)";

std::filesystem::path storePath() {
    return Environment::profile().get().state / "analytics.sqlite";
}

void logFailure(const SQLiteFailure& failure) {
    Log::findOrCreate("Analytics")
        ->error("%s: not recorded: %s", storePath().string(), failure.reason);
}

/// Runs `write` in one transaction over the store, made where there is none.
template <class Write>
void change(Write&& write) {
    if (Environment::keepsWritesInMemory().get())
        return;
    std::error_code failed;
    std::filesystem::create_directories(storePath().parent_path(), failed);
    SQLiteFailure failure;
    const auto database = SQLiteDatabase::open(storePath(), SQLiteDatabase::Mode::Write, &failure);
    if (!database) {
        logFailure(failure);
        return;
    }
    SQLiteTransaction transaction(*database);
    if (!transaction.isOpen() || !database->execute(Schema) || !write(*database) ||
        !transaction.commit())
        logFailure(database->failure());
}

bool insertItems(SQLiteDatabase& database,
                 std::int64_t session,
                 const TransitWidgetAnalyticsRecord& record) {
    SQLiteStatement insert(database, "insert into incidents values (?, ?, ?, ?)");
    std::int64_t position = 0;
    for (const auto& item : record.transitIncidentItems()) {
        insert.bind(session)
            .bind(position++)
            .bind(std::string_view(item->transitLineMuid().value_or("")))
            .bind(std::string_view(item->transitIncidentTitle().value_or("")));
        if (!insert.run())
            return false;
    }
    return true;
}

bool prune(SQLiteDatabase& database, const char* sql, std::int64_t newest) {
    SQLiteStatement remove(database, sql);
    remove.bind(newest - LocalAnalyticsStore::MaximumSessions);
    return remove.run();
}

/// Opens the store for reading; `isAbsent` where nothing was ever recorded.
std::unique_ptr<SQLiteDatabase> openForReading(bool& isAbsent, std::shared_ptr<NSError>* error) {
    isAbsent = !std::filesystem::exists(storePath());
    SQLiteFailure failure;
    auto database = isAbsent
                        ? nullptr
                        : SQLiteDatabase::open(storePath(), SQLiteDatabase::Mode::Read, &failure);
    if (!isAbsent && !database && error)
        *error = NSError::errorWithMessage(
            ErrorDomain,
            failure.code,
            fmt::format("{} cannot be read: {}", storePath().string(), failure.reason));
    return database;
}

bool finishedReading(const SQLiteStatement& statement,
                     const SQLiteDatabase& database,
                     std::shared_ptr<NSError>* error) {
    if (!statement.hasFailed())
        return true;
    if (error)
        *error = NSError::errorWithMessage(
            ErrorDomain,
            database.failure().code,
            fmt::format("{} cannot be read: {}", storePath().string(), database.failure().reason));
    return false;
}

} // namespace

void LocalAnalyticsStore::addUserAction(std::int64_t action,
                                        std::int64_t target,
                                        const std::optional<std::string>& value) {
    change([&](SQLiteDatabase& database) {
        SQLiteStatement insert(
            database, "insert into actions (at, action, target, value) values (?, ?, ?, ?)");
        insert.bind(NSDate::date()->timeIntervalSince1970()).bind(action).bind(target).bind(value);
        return insert.run() &&
               prune(database, "delete from actions where id <= ?", database.lastInsertedRow());
    });
}

void LocalAnalyticsStore::addWidgetInteraction(
    std::int64_t type,
    std::int64_t endState,
    const std::shared_ptr<TransitWidgetAnalyticsRecord>& widgetSpecificObject,
    bool wasLocked,
    const std::shared_ptr<NSDate>& startDate,
    NSTimeInterval duration) {
    const auto record = widgetSpecificObject ? widgetSpecificObject
                                             : std::make_shared<TransitWidgetAnalyticsRecord>();
    change([&](SQLiteDatabase& database) {
        SQLiteStatement insert(
            database,
            "insert into sessions (started_at, duration, type, end_state, was_locked, "
            "initially_expanded, ever_expanded, message_type, tapped_index) "
            "values (?, ?, ?, ?, ?, ?, ?, ?, ?)");
        insert.bind(startDate ? startDate->timeIntervalSince1970() : 0.0)
            .bind(duration)
            .bind(type)
            .bind(endState)
            .bind(std::int64_t{wasLocked})
            .bind(std::int64_t{record->initiallyExpanded()})
            .bind(std::int64_t{record->everExpanded()})
            .bind(record->transitMessageType())
            .bind(record->tappedItemIndex());
        if (!insert.run())
            return false;
        const auto session = database.lastInsertedRow();
        return insertItems(database, session, *record) &&
               prune(database, "delete from incidents where session <= ?", session) &&
               prune(database, "delete from sessions where id <= ?", session);
    });
}

std::optional<std::vector<StoredAnalyticsSession>>
LocalAnalyticsStore::sessions(std::int64_t limit, std::shared_ptr<NSError>* error) {
    bool isAbsent = false;
    const auto database = openForReading(isAbsent, error);
    std::vector<StoredAnalyticsSession> sessions;
    if (!database)
        return isAbsent ? std::optional(sessions) : std::nullopt;
    SQLiteStatement select(*database, "select * from sessions order by id desc limit ?");
    SQLiteStatement items(
        *database, "select line_muid, title from incidents where session = ? order by position");
    select.bind(limit);
    while (select.step()) {
        StoredAnalyticsSession session{.identifier = select.integer(0),
                                       .startedAt = select.real(1),
                                       .duration = select.real(2),
                                       .widgetType = select.integer(3),
                                       .endState = select.integer(4),
                                       .wasLocked = select.integer(5) != 0,
                                       .initiallyExpanded = select.integer(6) != 0,
                                       .everExpanded = select.integer(7) != 0,
                                       .messageType = select.integer(8),
                                       .tappedItemIndex = select.integer(9)};
        items.bind(session.identifier);
        while (items.step())
            session.incidents.push_back({items.text(0), items.text(1)});
        items.reset();
        sessions.push_back(std::move(session));
    }
    if (!finishedReading(select, *database, error) || !finishedReading(items, *database, error))
        return std::nullopt;
    return sessions;
}

std::optional<std::vector<StoredAnalyticsAction>>
LocalAnalyticsStore::actions(std::int64_t limit, std::shared_ptr<NSError>* error) {
    bool isAbsent = false;
    const auto database = openForReading(isAbsent, error);
    std::vector<StoredAnalyticsAction> actions;
    if (!database)
        return isAbsent ? std::optional(actions) : std::nullopt;
    SQLiteStatement select(*database,
                           "select at, action, target from actions order by id desc limit ?");
    select.bind(limit);
    while (select.step())
        actions.push_back({select.real(0), select.integer(1), select.integer(2)});
    if (!finishedReading(select, *database, error))
        return std::nullopt;
    return actions;
}

} // namespace orvo
