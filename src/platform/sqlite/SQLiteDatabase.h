#pragma once

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>

struct sqlite3;

namespace orvo {

/// What SQLite said of the call that failed last.
struct SQLiteFailure {
    int code = 0; ///< SQLite's extended result code; 0: nothing failed
    std::string reason;

    /// Whether the file itself is no good: no database, or a damaged one.
    [[nodiscard]] bool isDamage() const noexcept;
    /// Whether another connection, mostly another program's, held the file all the while.
    [[nodiscard]] bool isLocked() const noexcept;
    /// Whether the file, or its folder, must not be written to.
    [[nodiscard]] bool isReadOnly() const noexcept;
};

/// One connection to an SQLite file. One thread at a time. Each call waits for a lock that another
/// connection holds, as long as the connection was told to when it was opened.
class SQLiteDatabase final {
public:
    static constexpr std::chrono::milliseconds Patience = std::chrono::seconds(5);

    enum class Mode {
        Read,  ///< the file must be there; its folder may be one that nobody can write to
        Write, ///< made where it is not there; its folder must be. Journal: write-ahead log
    };

    /// Nil, and why, where the file cannot be opened or stays locked. A file that is no database is
    /// often found out only by the first statement.
    [[nodiscard]] static std::unique_ptr<SQLiteDatabase>
    open(const std::filesystem::path& path,
         Mode mode,
         SQLiteFailure* failure,
         std::chrono::milliseconds patience = Patience);
    /// An empty database in memory, or with a path, a copy of what the file holds; the file must be
    /// there and is not changed.
    [[nodiscard]] static std::unique_ptr<SQLiteDatabase>
    openInMemory(const std::optional<std::filesystem::path>& copied, SQLiteFailure* failure);

    ~SQLiteDatabase();
    SQLiteDatabase(const SQLiteDatabase&) = delete;
    SQLiteDatabase& operator=(const SQLiteDatabase&) = delete;

    /// Runs one or more statements that answer nothing. False: `failure()` tells why.
    bool execute(const char* sql);
    /// SQLite's own examination of the file, page by page. False: `failure()` tells what is wrong.
    [[nodiscard]] bool isSound();
    /// The number that the user of the file keeps in it to tell its layout; nothing on failure.
    [[nodiscard]] std::optional<std::int64_t> userVersion();

    [[nodiscard]] std::int64_t lastInsertedRow() const;
    /// Rows that the last statement changed.
    [[nodiscard]] std::int64_t changes() const;
    /// Of the call that failed last, whatever succeeded since.
    [[nodiscard]] const SQLiteFailure& failure() const noexcept { return _failure; }

    /// For `SQLiteStatement`.
    [[nodiscard]] sqlite3* handle() const noexcept { return _handle; }
    void noteFailure(int code);

private:
    explicit SQLiteDatabase(sqlite3* handle);
    void setPatience(std::chrono::milliseconds patience);
    [[nodiscard]] bool setUpJournal(std::chrono::milliseconds patience);
    [[nodiscard]] static std::unique_ptr<SQLiteDatabase>
    openForReading(const std::filesystem::path& path,
                   SQLiteFailure* failure,
                   std::chrono::milliseconds patience);
    [[nodiscard]] static std::unique_ptr<SQLiteDatabase>
    connect(const std::string& name, int flags, SQLiteFailure* failure);

    sqlite3* _handle;
    SQLiteFailure _failure;
};

/// A change of several statements: all of them, or, when it ends without `commit`, none. It takes
/// the lock for writing at its beginning.
class SQLiteTransaction final {
public:
    explicit SQLiteTransaction(SQLiteDatabase& database);
    SQLiteTransaction(const SQLiteTransaction&) = delete;
    SQLiteTransaction& operator=(const SQLiteTransaction&) = delete;
    ~SQLiteTransaction();

    /// Whether it could begin and was not yet committed.
    [[nodiscard]] bool isOpen() const noexcept { return _isOpen; }
    /// False: nothing was changed, and the database's `failure()` tells why.
    [[nodiscard]] bool commit();

private:
    SQLiteDatabase& _database;
    bool _isOpen;
};

} // namespace orvo
