#pragma once

#include "platform/sqlite/SQLiteDatabase.h"

#include <span>
#include <string_view>

struct sqlite3_stmt;

namespace orvo {

/// One SQL statement, compiled. Parameters are bound in order; rows are read column by column, from
/// 0, until the next step.
///
/// A failure stays: the steps after it do nothing and answer false; the database's `failure()`
/// tells why. One that could not be compiled is failed from the start.
class SQLiteStatement final {
public:
    /// The database must outlive the statement.
    SQLiteStatement(SQLiteDatabase& database, std::string_view sql);
    SQLiteStatement(const SQLiteStatement&) = delete;
    SQLiteStatement& operator=(const SQLiteStatement&) = delete;
    ~SQLiteStatement();

    /// Texts and bytes are copied.
    SQLiteStatement& bind(std::int64_t value);
    /// Kept as the signed number of the same bits.
    SQLiteStatement& bind(std::uint64_t value);
    SQLiteStatement& bind(double value);
    SQLiteStatement& bind(std::string_view text);
    SQLiteStatement& bind(const std::optional<std::string>& text);
    SQLiteStatement& bind(std::span<const std::uint8_t> bytes);
    SQLiteStatement& bindNull();

    /// To the next row. False at the end and on failure.
    [[nodiscard]] bool step();
    /// Steps to the end and resets. Whether nothing failed.
    bool run();
    /// Back to before the first row, without parameters.
    void reset();
    [[nodiscard]] bool hasFailed() const noexcept { return _hasFailed; }

    [[nodiscard]] bool isNull(int column) const;
    [[nodiscard]] std::int64_t integer(int column) const;
    [[nodiscard]] std::uint64_t unsignedInteger(int column) const;
    [[nodiscard]] double real(int column) const;
    [[nodiscard]] std::string text(int column) const;
    [[nodiscard]] std::optional<std::string> textOrNil(int column) const;
    /// Valid until the next step.
    [[nodiscard]] std::span<const std::uint8_t> bytes(int column) const;

private:
    SQLiteStatement& check(int code);

    SQLiteDatabase& _database;
    sqlite3_stmt* _handle = nullptr;
    int _bound = 0;
    bool _hasFailed = false;
};

} // namespace orvo
