#include "platform/feeds/schedule/ScheduleQueries.h"

#include "platform/sqlite/SQLiteStatement.h"

#include <utility>

namespace orvo {

namespace {

constexpr const char* SelectLines = R"(
    SELECT line.muid, feed.name, line.route_id, line.agency_id, line.short_name, line.long_name,
           line.color, line.text_color, line.url, line.type, line.position, line.present, line.known_at,
           agency.id, agency.name, agency.url, agency.timezone, agency.language
    FROM line JOIN feed ON feed.number = line.feed JOIN agency ON agency.number = line.agency
)";

constexpr std::int64_t Unread = -1; // no schedule is of this generation

ScheduleLine lineAt(const SQLiteStatement& row) {
    int column = 0;
    ScheduleLine line;
    line.muid = row.unsignedInteger(column++);
    line.feed = row.text(column++);
    line.routeId = row.text(column++);
    line.agencyId = row.text(column++);
    line.shortName = row.text(column++);
    line.longName = row.text(column++);
    line.color = row.text(column++);
    line.textColor = row.text(column++);
    line.url = row.text(column++);
    line.routeType = static_cast<int>(row.integer(column++));
    line.order = row.integer(column++);
    line.present = row.integer(column++) != 0;
    line.knownAt = row.real(column++);
    line.agency.id = row.text(column++);
    line.agency.name = row.text(column++);
    line.agency.url = row.text(column++);
    line.agency.timezone = row.text(column++);
    line.agency.language = row.text(column++);
    return line;
}

std::vector<ScheduleLine> linesOf(SQLiteStatement& statement) {
    std::vector<ScheduleLine> lines;
    while (statement.step())
        lines.push_back(lineAt(statement));
    return lines;
}

} // namespace

/// A question whose failure its owner remembers.
class ScheduleQueries::Select {
public:
    Select(ScheduleQueries& owner, std::string_view sql)
        : rows(owner._database, sql)
        , _owner(owner) {}
    Select(const Select&) = delete;
    Select& operator=(const Select&) = delete;
    ~Select() { _owner._hasFailed |= rows.hasFailed(); }

    SQLiteStatement rows;

private:
    ScheduleQueries& _owner;
};

std::vector<std::string> ScheduleQueries::feeds() {
    std::vector<std::string> names;
    Select select(*this, "SELECT name FROM feed WHERE present = 1 ORDER BY name");
    while (select.rows.step())
        names.push_back(select.rows.text(0));
    return names;
}

std::optional<ScheduleInfo> ScheduleQueries::info(std::string_view feed) {
    Select select(*this, R"(
        SELECT name, publisher, version, language, timezone, start_date, end_date, valid_until,
               imported_at, agencies, lines, stops, knows_stops
        FROM feed WHERE name = ? AND present = 1)");
    if (!select.rows.bind(feed).step())
        return std::nullopt;
    int column = 0;
    ScheduleInfo info;
    info.feed = select.rows.text(column++);
    info.publisher = select.rows.text(column++);
    info.version = select.rows.text(column++);
    info.language = select.rows.text(column++);
    info.timezone = select.rows.text(column++);
    info.startDate = select.rows.text(column++);
    info.endDate = select.rows.text(column++);
    if (!select.rows.isNull(column))
        info.validUntil = select.rows.real(column);
    ++column;
    info.importedAt = select.rows.real(column++);
    info.agencies = select.rows.integer(column++);
    info.lines = select.rows.integer(column++);
    info.stops = select.rows.integer(column++);
    info.knowsStopsOfLines = select.rows.integer(column++) != 0;
    return info;
}

std::vector<ScheduleLine> ScheduleQueries::lines(std::string_view feed) {
    Select select(*this,
                  std::string(SelectLines) +
                      "WHERE feed.name = ? AND line.present = 1 ORDER BY line.position");
    return linesOf(select.rows.bind(feed));
}

std::vector<ScheduleLine> ScheduleQueries::allLines() {
    Select select(*this,
                  std::string(SelectLines) +
                      "WHERE line.present = 1 ORDER BY feed.name, line.position");
    return linesOf(select.rows);
}

std::vector<ScheduleLine> ScheduleQueries::linesWithMuid(std::uint64_t muid) {
    Select select(*this, std::string(SelectLines) + "WHERE line.muid = ?");
    return linesOf(select.rows.bind(muid));
}

std::vector<ScheduleLine> ScheduleQueries::translated(std::vector<ScheduleLine> lines,
                                                      const std::string& language) {
    const LineTranslator* current = nullptr;
    std::string feed;
    for (ScheduleLine& line : lines) {
        if (!current || line.feed != feed) {
            current = &translator(line.feed, language);
            feed = line.feed;
        }
        current->translate(line);
    }
    return lines;
}

std::vector<std::uint64_t> ScheduleQueries::linesServingStop(std::string_view feed,
                                                             std::string_view stopId) {
    Select select(*this, R"(
        SELECT stop_line.line
        FROM feed JOIN stop ON stop.feed = feed.number JOIN stop_line ON stop_line.stop = stop.number
        WHERE feed.name = ? AND stop.id = ?)");
    select.rows.bind(feed).bind(stopId);
    std::vector<std::uint64_t> lines;
    while (select.rows.step())
        lines.push_back(select.rows.unsignedInteger(0));
    return lines;
}

std::optional<std::string> ScheduleQueries::stopName(std::string_view feed,
                                                     std::string_view stopId) {
    Select select(*this, R"(
        SELECT stop.name FROM feed JOIN stop ON stop.feed = feed.number
        WHERE feed.name = ? AND stop.id = ?)");
    if (!select.rows.bind(feed).bind(stopId).step())
        return std::nullopt;
    return select.rows.text(0);
}

const LineTranslator& ScheduleQueries::translator(const std::string& feed,
                                                  const std::string& language) {
    Select select(*this, "SELECT number, generation, language FROM feed WHERE name = ?");
    const bool isKnown = select.rows.bind(std::string_view(feed)).step();
    const std::int64_t generation = isKnown ? select.rows.integer(1) : 0;
    const auto known = _translators.find(feed);
    if (known != _translators.end() && known->second.generation == generation &&
        known->second.language == language)
        return known->second.translator;
    const std::string own = isKnown ? select.rows.text(2) : std::string();
    const auto offered =
        isKnown ? translations(select.rows.integer(0)) : std::vector<ScheduleTranslation>();
    // One that could not be read in full is not taken for that generation's again.
    Translator made{
        _hasFailed ? Unread : generation, language, LineTranslator(offered, own, language)};
    return _translators.insert_or_assign(feed, std::move(made)).first->second.translator;
}

std::vector<ScheduleTranslation> ScheduleQueries::translations(std::int64_t feedNumber) {
    std::vector<ScheduleTranslation> translations;
    Select select(*this, R"(
        SELECT source, field, language, record, value, text FROM translation
        WHERE feed = ? ORDER BY rowid)");
    select.rows.bind(feedNumber);
    while (select.rows.step()) {
        ScheduleTranslation translation;
        translation.table = select.rows.text(0);
        translation.field = select.rows.text(1);
        translation.language = select.rows.text(2);
        translation.recordId = select.rows.text(3);
        translation.fieldValue = select.rows.text(4);
        translation.text = select.rows.text(5);
        translations.push_back(std::move(translation));
    }
    return translations;
}

} // namespace orvo
