#include "platform/feeds/schedule/ScheduleWriter.h"

#include "platform/sqlite/SQLiteStatement.h"

#include <map>
#include <unordered_set>
#include <utility>
#include <vector>

namespace orvo {

namespace {

std::string_view valueOf(const std::string& text) {
    return text;
}
std::int64_t valueOf(std::int64_t number) {
    return number;
}
std::uint64_t valueOf(std::uint64_t number) {
    return number;
}
double valueOf(double number) {
    return number;
}

} // namespace

/// Binds the values in order and runs to the end.
template <class... Values>
void ScheduleWriter::run(SQLiteStatement& statement, const Values&... values) {
    if (_hasFailed)
        return;
    (statement.bind(valueOf(values)), ...);
    _hasFailed = !statement.run();
}

/// A statement whose only parameter is the feed.
void ScheduleWriter::run(const char* sql) {
    SQLiteStatement statement(_database, sql);
    run(statement, _feed);
}

ImportReport ScheduleWriter::write(const ScheduleContents& contents, double importedAt) {
    ImportReport report;
    report.agencies = contents.agencies.size();
    report.stops = contents.stops.size();
    report.rows = contents.rows;
    writeFeed(contents.info, importedAt);
    const auto before = presentLines();
    clearFeed();
    writeLines(contents, importedAt, before, report);
    report.departedLines = before.size() + report.newLines - report.lines;
    writeStops(contents);
    writeTranslations(contents);
    deleteUnusedAgencies();
    return report;
}

void ScheduleWriter::remove(const std::string& feed) {
    _feed = numberOfFeed(feed);
    if (_feed == 0)
        return;
    clearFeed();
    run("UPDATE feed SET present = 0, agencies = 0, lines = 0, stops = 0, knows_stops = 0 "
        "WHERE number = ?");
    deleteUnusedAgencies();
}

std::int64_t ScheduleWriter::numberOfFeed(const std::string& name) {
    SQLiteStatement find(_database, "SELECT number FROM feed WHERE name = ?");
    const bool isKnown = find.bind(std::string_view(name)).step();
    _hasFailed |= find.hasFailed();
    return isKnown ? find.integer(0) : 0;
}

void ScheduleWriter::writeFeed(const ScheduleInfo& info, double importedAt) {
    SQLiteStatement insert(_database, R"(
        INSERT INTO feed (name, present, generation, publisher, version, language, timezone,
                          start_date, end_date, imported_at, agencies, lines, stops, knows_stops)
        VALUES (?, 1, 1, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?)
        ON CONFLICT (name) DO UPDATE SET present = 1, generation = generation + 1,
            publisher = excluded.publisher, version = excluded.version,
            language = excluded.language, timezone = excluded.timezone,
            start_date = excluded.start_date, end_date = excluded.end_date, valid_until = NULL,
            imported_at = excluded.imported_at, agencies = excluded.agencies,
            lines = excluded.lines, stops = excluded.stops, knows_stops = excluded.knows_stops)");
    run(insert,
        info.feed,
        info.publisher,
        info.version,
        info.language,
        info.timezone,
        info.startDate,
        info.endDate,
        importedAt,
        info.agencies,
        info.lines,
        info.stops,
        std::int64_t{info.knowsStopsOfLines});
    _feed = numberOfFeed(info.feed);
    if (info.validUntil) {
        SQLiteStatement update(_database, "UPDATE feed SET valid_until = ? WHERE number = ?");
        run(update, *info.validUntil, _feed);
    }
}

std::unordered_set<std::uint64_t> ScheduleWriter::presentLines() {
    std::unordered_set<std::uint64_t> lines;
    SQLiteStatement select(_database, "SELECT muid FROM line WHERE feed = ? AND present = 1");
    select.bind(_feed);
    while (select.step())
        lines.insert(select.unsignedInteger(0));
    _hasFailed |= select.hasFailed();
    return lines;
}

/// All that the feed had is gone or, for its lines, departed.
void ScheduleWriter::clearFeed() {
    for (const char* sql :
         {"DELETE FROM stop_line WHERE stop IN (SELECT number FROM stop WHERE feed = ?)",
          "DELETE FROM stop WHERE feed = ?",
          "DELETE FROM translation WHERE feed = ?",
          "UPDATE line SET present = 0 WHERE feed = ? AND present = 1"})
        run(sql);
}

void ScheduleWriter::writeLines(const ScheduleContents& contents,
                                double importedAt,
                                const std::unordered_set<std::uint64_t>& before,
                                ImportReport& report) {
    ImportNotes notes = contents.notes;
    // The condition keeps a forged route id, whose number is that of another line, from taking that
    // line's place.
    SQLiteStatement insert(_database, R"(
        INSERT INTO line (muid, feed, route_id, agency_id, agency, short_name, long_name, color,
                          text_color, url, type, position, known_at, present)
        VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, 1)
        ON CONFLICT (muid) DO UPDATE SET agency_id = excluded.agency_id, agency = excluded.agency,
            short_name = excluded.short_name, long_name = excluded.long_name,
            color = excluded.color, text_color = excluded.text_color, url = excluded.url,
            type = excluded.type, position = excluded.position, known_at = excluded.known_at,
            present = 1
        WHERE feed = excluded.feed AND route_id = excluded.route_id)");
    for (const ScheduleLine& line : contents.lines) {
        run(insert,
            line.muid,
            _feed,
            line.routeId,
            line.agencyId,
            rowOfAgency(line.agency),
            line.shortName,
            line.longName,
            line.color,
            line.textColor,
            line.url,
            std::int64_t{line.routeType},
            line.order,
            importedAt);
        if (_hasFailed)
            return;
        if (_database.changes() == 0) {
            notes.add("routes.txt", "a route_id with the number of another line, left out", 0);
            continue;
        }
        ++report.lines;
        if (!before.contains(line.muid))
            ++report.newLines;
    }
    report.notes = notes.notes();
}

void ScheduleWriter::writeStops(const ScheduleContents& contents) {
    std::vector<std::int64_t> numbers;
    numbers.reserve(contents.stops.size());
    SQLiteStatement insertStop(_database, "INSERT INTO stop (feed, id, name) VALUES (?, ?, ?)");
    for (const ScheduleStop& stop : contents.stops) {
        run(insertStop, _feed, stop.id, stop.name);
        numbers.push_back(_database.lastInsertedRow());
    }
    SQLiteStatement insertLine(_database, "INSERT INTO stop_line (stop, line) VALUES (?, ?)");
    for (const StopOfLine& entry : contents.stopsOfLines)
        run(insertLine, numbers[entry.stop], contents.lines[entry.line].muid);
}

void ScheduleWriter::writeTranslations(const ScheduleContents& contents) {
    SQLiteStatement insert(_database, R"(
        INSERT INTO translation (feed, source, field, language, record, value, text)
        VALUES (?, ?, ?, ?, ?, ?, ?))");
    for (const ScheduleTranslation& translation : contents.translations)
        run(insert,
            _feed,
            translation.table,
            translation.field,
            translation.language,
            translation.recordId,
            translation.fieldValue,
            translation.text);
}

/// Each agency is written when a line first needs it.
std::int64_t ScheduleWriter::rowOfAgency(const ScheduleAgency& agency) {
    const auto known = _agencies.find(agency.id);
    if (known != _agencies.end())
        return known->second;
    SQLiteStatement insert(_database, R"(
        INSERT INTO agency (feed, id, name, url, timezone, language) VALUES (?, ?, ?, ?, ?, ?))");
    run(insert, _feed, agency.id, agency.name, agency.url, agency.timezone, agency.language);
    return _agencies[agency.id] = _database.lastInsertedRow();
}

void ScheduleWriter::deleteUnusedAgencies() {
    run("DELETE FROM agency WHERE feed = ? AND NOT EXISTS "
        "(SELECT 1 FROM line WHERE line.agency = agency.number)");
}

} // namespace orvo
