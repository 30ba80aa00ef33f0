#include "platform/sqlite/SQLiteStatement.h"

#include <sqlite3.h>

#include <bit>

namespace orvo {

SQLiteStatement::SQLiteStatement(SQLiteDatabase& database, std::string_view sql)
    : _database(database) {
    check(sqlite3_prepare_v2(
        database.handle(), sql.data(), static_cast<int>(sql.size()), &_handle, nullptr));
}

SQLiteStatement::~SQLiteStatement() {
    sqlite3_finalize(_handle);
}

SQLiteStatement& SQLiteStatement::check(int code) {
    if (code != SQLITE_OK && !_hasFailed) {
        _hasFailed = true;
        _database.noteFailure(code);
    }
    return *this;
}

SQLiteStatement& SQLiteStatement::bind(std::int64_t value) {
    return check(sqlite3_bind_int64(_handle, ++_bound, value));
}

SQLiteStatement& SQLiteStatement::bind(std::uint64_t value) {
    return bind(std::bit_cast<std::int64_t>(value));
}

SQLiteStatement& SQLiteStatement::bind(double value) {
    return check(sqlite3_bind_double(_handle, ++_bound, value));
}

SQLiteStatement& SQLiteStatement::bind(std::string_view text) {
    return check(sqlite3_bind_text64(_handle,
                                     ++_bound,
                                     text.data() ? text.data() : "",
                                     text.size(),
                                     SQLITE_TRANSIENT,
                                     SQLITE_UTF8));
}

SQLiteStatement& SQLiteStatement::bind(const std::optional<std::string>& text) {
    return text ? bind(std::string_view(*text)) : bindNull();
}

SQLiteStatement& SQLiteStatement::bind(std::span<const std::uint8_t> bytes) {
    // A null pointer would bind NULL, not empty bytes.
    if (bytes.empty())
        return check(sqlite3_bind_zeroblob(_handle, ++_bound, 0));
    return check(
        sqlite3_bind_blob64(_handle, ++_bound, bytes.data(), bytes.size(), SQLITE_TRANSIENT));
}

SQLiteStatement& SQLiteStatement::bindNull() {
    return check(sqlite3_bind_null(_handle, ++_bound));
}

bool SQLiteStatement::step() {
    if (_hasFailed)
        return false;
    const int code = sqlite3_step(_handle);
    if (code == SQLITE_ROW)
        return true;
    if (code != SQLITE_DONE)
        check(code);
    return false;
}

bool SQLiteStatement::run() {
    while (step()) {
    }
    reset();
    return !_hasFailed;
}

void SQLiteStatement::reset() {
    if (!_handle)
        return;
    sqlite3_reset(_handle);
    sqlite3_clear_bindings(_handle);
    _bound = 0;
}

bool SQLiteStatement::isNull(int column) const {
    return sqlite3_column_type(_handle, column) == SQLITE_NULL;
}

std::int64_t SQLiteStatement::integer(int column) const {
    return sqlite3_column_int64(_handle, column);
}

std::uint64_t SQLiteStatement::unsignedInteger(int column) const {
    return std::bit_cast<std::uint64_t>(integer(column));
}

double SQLiteStatement::real(int column) const {
    return sqlite3_column_double(_handle, column);
}

std::string SQLiteStatement::text(int column) const {
    const auto* text = reinterpret_cast<const char*>(sqlite3_column_text(_handle, column));
    if (!text)
        return {};
    return {text, static_cast<std::size_t>(sqlite3_column_bytes(_handle, column))};
}

std::optional<std::string> SQLiteStatement::textOrNil(int column) const {
    return isNull(column) ? std::nullopt : std::optional(text(column));
}

std::span<const std::uint8_t> SQLiteStatement::bytes(int column) const {
    const auto* bytes = static_cast<const std::uint8_t*>(sqlite3_column_blob(_handle, column));
    return {bytes, static_cast<std::size_t>(sqlite3_column_bytes(_handle, column))};
}

} // namespace orvo
