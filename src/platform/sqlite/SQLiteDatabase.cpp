#include "platform/sqlite/SQLiteDatabase.h"

#include "platform/sqlite/SQLiteStatement.h"

#include <sqlite3.h>

#include <system_error>

namespace orvo {

namespace {

constexpr const char* MemoryName = ":memory:";

/// SQLite's result code without its extension.
int primaryCode(int code) {
    constexpr int mask = 0xff;
    return code & mask;
}

/// What SQLite says, and the system's own reason where it had one.
std::string reasonOf(sqlite3* handle, int code) {
    std::string reason = handle ? sqlite3_errmsg(handle) : sqlite3_errstr(code);
    if (const int system = handle ? sqlite3_system_errno(handle) : 0; code != 0 && system != 0)
        reason += ": " + std::generic_category().message(system);
    return reason;
}

/// The file as a URI that has SQLite read it without its lock and journal.
std::string immutableName(const std::filesystem::path& path) {
    constexpr const char* Digits = "0123456789ABCDEF";
    std::string name = "file:";
    for (const char c : std::filesystem::absolute(path).string()) {
        if (c != '%' && c != '?' && c != '#') {
            name += c;
            continue;
        }
        constexpr unsigned HighDigit = 4;
        constexpr unsigned LowDigit = 0xf;
        const auto byte = static_cast<unsigned char>(c);
        name += {'%', Digits[byte >> HighDigit], Digits[byte & LowDigit]};
    }
    return name + "?immutable=1";
}

bool hasJournal(const std::filesystem::path& path) {
    std::error_code none;
    return std::filesystem::file_size(path.string() + "-wal", none) > 0 && !none;
}

} // namespace

bool SQLiteFailure::isDamage() const noexcept {
    const int primary = primaryCode(code);
    return primary == SQLITE_CORRUPT || primary == SQLITE_NOTADB;
}

bool SQLiteFailure::isLocked() const noexcept {
    const int primary = primaryCode(code);
    return primary == SQLITE_BUSY || primary == SQLITE_LOCKED;
}

bool SQLiteFailure::isReadOnly() const noexcept {
    return primaryCode(code) == SQLITE_READONLY;
}

std::unique_ptr<SQLiteDatabase>
SQLiteDatabase::connect(const std::string& name, int flags, SQLiteFailure* failure) {
    sqlite3* handle = nullptr;
    const int code = sqlite3_open_v2(name.c_str(), &handle, flags | SQLITE_OPEN_NOMUTEX, nullptr);
    if (code != SQLITE_OK) {
        if (failure)
            *failure = {code, reasonOf(handle, code)};
        sqlite3_close(handle);
        return nullptr;
    }
    sqlite3_extended_result_codes(handle, 1);
    std::unique_ptr<SQLiteDatabase> database(new SQLiteDatabase(handle));
    database->setPatience(Patience);
    return database;
}

void SQLiteDatabase::setPatience(std::chrono::milliseconds patience) {
    sqlite3_busy_timeout(_handle, static_cast<int>(patience.count()));
}

std::unique_ptr<SQLiteDatabase> SQLiteDatabase::open(const std::filesystem::path& path,
                                                     Mode mode,
                                                     SQLiteFailure* failure,
                                                     std::chrono::milliseconds patience) {
    if (mode == Mode::Read)
        return openForReading(path, failure, patience);
    auto database = connect(path.string(), SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE, failure);
    // Full: what was committed outlives a power cut, too, not only the process.
    if (database && !database->setUpJournal(patience)) {
        if (failure)
            *failure = database->failure();
        return nullptr;
    }
    return database;
}

std::unique_ptr<SQLiteDatabase> SQLiteDatabase::openForReading(const std::filesystem::path& path,
                                                               SQLiteFailure* failure,
                                                               std::chrono::milliseconds patience) {
    auto database = connect(path.string(), SQLITE_OPEN_READONLY, failure);
    if (!database)
        return nullptr;
    database->setPatience(patience);
    if (database->userVersion())
        return database;
    if (database->failure().isLocked()) { // whoever asked again would wait as long again
        if (failure)
            *failure = database->failure();
        return nullptr;
    }
    // Who reads a write-ahead log needs files beside it. Where none can be made, nobody else
    // writes either, and the file itself has all when no journal lies beside it.
    const int code = primaryCode(database->failure().code);
    if ((code != SQLITE_CANTOPEN && code != SQLITE_READONLY) || hasJournal(path))
        return database;
    return connect(immutableName(path), SQLITE_OPEN_READONLY | SQLITE_OPEN_URI, failure);
}

bool SQLiteDatabase::setUpJournal(std::chrono::milliseconds patience) {
    // Who changes the journal's mode needs the file alone, and is mostly told at once that it is
    // not; but whoever holds the file exclusively makes each try take the whole busy time. So the
    // tries do not wait, and what lies between them does.
    using Clock = std::chrono::steady_clock;
    constexpr int pause = 10; // milliseconds
    setPatience({});
    const auto deadline = Clock::now() + patience;
    bool isSetUp = false;
    while (!(isSetUp = execute("PRAGMA journal_mode = WAL; PRAGMA synchronous = FULL")) &&
           _failure.isLocked() && Clock::now() < deadline)
        sqlite3_sleep(pause);
    setPatience(patience);
    return isSetUp;
}

std::unique_ptr<SQLiteDatabase>
SQLiteDatabase::openInMemory(const std::optional<std::filesystem::path>& copied,
                             SQLiteFailure* failure) {
    auto memory = connect(MemoryName, SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE, failure);
    if (!memory || !copied)
        return memory;
    const auto file = open(*copied, Mode::Read, failure);
    if (!file)
        return nullptr;
    auto* backup = sqlite3_backup_init(memory->_handle, "main", file->_handle, "main");
    if (backup)
        sqlite3_backup_step(backup, -1);
    const int code =
        backup ? sqlite3_backup_finish(backup) : sqlite3_extended_errcode(memory->_handle);
    if (code == SQLITE_OK)
        return memory;
    if (failure)
        *failure = {code, sqlite3_errmsg(memory->_handle)};
    return nullptr;
}

SQLiteDatabase::SQLiteDatabase(sqlite3* handle)
    : _handle(handle) {}

SQLiteDatabase::~SQLiteDatabase() {
    sqlite3_close(_handle);
}

bool SQLiteDatabase::execute(const char* sql) {
    const int code = sqlite3_exec(_handle, sql, nullptr, nullptr, nullptr);
    if (code != SQLITE_OK)
        noteFailure(code);
    return code == SQLITE_OK;
}

bool SQLiteDatabase::isSound() {
    SQLiteStatement check(*this, "PRAGMA quick_check(1)");
    if (!check.step())
        return false;
    const auto finding = check.text(0);
    if (finding == "ok")
        return true;
    _failure = {SQLITE_CORRUPT, finding};
    return false;
}

std::optional<std::int64_t> SQLiteDatabase::userVersion() {
    SQLiteStatement query(*this, "PRAGMA user_version");
    if (!query.step())
        return std::nullopt;
    return query.integer(0);
}

std::int64_t SQLiteDatabase::lastInsertedRow() const {
    return sqlite3_last_insert_rowid(_handle);
}

std::int64_t SQLiteDatabase::changes() const {
    return sqlite3_changes64(_handle);
}

void SQLiteDatabase::noteFailure(int code) {
    _failure = {code, reasonOf(_handle, code)};
}

SQLiteTransaction::SQLiteTransaction(SQLiteDatabase& database)
    : _database(database)
    , _isOpen(database.execute("BEGIN IMMEDIATE")) {}

SQLiteTransaction::~SQLiteTransaction() {
    // A failure may have ended the transaction already; what made it fail is what counts.
    if (_isOpen && !sqlite3_get_autocommit(_database.handle()))
        sqlite3_exec(_database.handle(), "ROLLBACK", nullptr, nullptr, nullptr);
}

bool SQLiteTransaction::commit() {
    if (!_isOpen || !_database.execute("COMMIT"))
        return false;
    _isOpen = false;
    return true;
}

} // namespace orvo
