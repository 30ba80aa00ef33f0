#pragma once

#include "platform/feeds/schedule/ScheduleContents.h"
#include "platform/feeds/schedule/ScheduleImport.h"
#include "platform/sqlite/SQLiteDatabase.h"

#include <cstdint>
#include <map>
#include <string>
#include <unordered_set>

namespace orvo {

class SQLiteStatement;

/// Puts a schedule into the store's tables, in the place of the feed's earlier one. Works inside
/// the caller's transaction, which must not be committed after a failure.
class ScheduleWriter {
public:
    explicit ScheduleWriter(SQLiteDatabase& database)
        : _database(database) {}

    /// `importedAt` in seconds since 1970. Answers what changed.
    [[nodiscard]] ImportReport write(const ScheduleContents& contents, double importedAt);
    /// Takes the feed's schedule away; its lines stay known.
    void remove(const std::string& feed);
    /// Whether something could not be done; the rest was left undone, and the database knows why.
    [[nodiscard]] bool hasFailed() const noexcept { return _hasFailed; }

private:
    void writeFeed(const ScheduleInfo& info, double importedAt);
    void clearFeed();
    void writeLines(const ScheduleContents& contents,
                    double importedAt,
                    const std::unordered_set<std::uint64_t>& before,
                    ImportReport& report);
    void writeStops(const ScheduleContents& contents);
    void writeTranslations(const ScheduleContents& contents);
    void deleteUnusedAgencies();
    std::int64_t rowOfAgency(const ScheduleAgency& agency);
    std::int64_t numberOfFeed(const std::string& name);
    void run(const char* sql);
    template <class... Values>
    void run(SQLiteStatement& statement, const Values&... values);
    std::unordered_set<std::uint64_t> presentLines();

    SQLiteDatabase& _database;
    bool _hasFailed = false;
    std::int64_t _feed = 0;                        // the row's number; 0: none
    std::map<std::string, std::int64_t> _agencies; // the rows written for this schedule, by id
};

} // namespace orvo
