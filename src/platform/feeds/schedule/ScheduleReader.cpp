#include "platform/feeds/schedule/ScheduleReader.h"

#include "platform/feeds/schedule/AgencyReader.h"
#include "platform/feeds/schedule/FeedInfoReader.h"
#include "platform/feeds/schedule/RouteReader.h"
#include "platform/feeds/schedule/ScheduleError.h"
#include "platform/feeds/schedule/StopReader.h"
#include "platform/feeds/schedule/StopTimeReader.h"
#include "platform/feeds/schedule/TranslationReader.h"
#include "platform/feeds/schedule/TripReader.h"

#include <algorithm>
#include <array>
#include <fmt/format.h>
#include <utility>

namespace orvo {

namespace {

constexpr std::array FilesRead = {"agency.txt",
                                  "routes.txt",
                                  "feed_info.txt",
                                  "translations.txt",
                                  "stops.txt",
                                  "trips.txt",
                                  "stop_times.txt"};
constexpr double ProgressStep = 0.01;

/// Counts what is read of a file, and tells of each piece.
class CountedStream final : public ScheduleStream {
public:
    CountedStream(ScheduleStream& stream,
                  ScheduleBudget& budget,
                  std::string name,
                  std::function<void()> onPiece)
        : _stream(stream)
        , _budget(budget)
        , _name(std::move(name))
        , _onPiece(std::move(onPiece)) {}

    std::size_t read(std::span<char> buffer, std::shared_ptr<NSError>& error) override {
        const std::size_t read = _stream.read(buffer, error);
        if (error)
            return 0;
        error = _budget.spendBytes(read, _name);
        if (error)
            return 0;
        _onPiece();
        return read;
    }

private:
    ScheduleStream& _stream;
    ScheduleBudget& _budget;
    std::string _name;
    std::function<void()> _onPiece;
};

std::string labelOf(const ScheduleSource& source, const std::string& file) {
    return source.name() + ": " + file;
}

} // namespace

ScheduleReader::ScheduleReader(std::string feed, const ImportOptions& options)
    : _feed(std::move(feed))
    , _options(options)
    , _budget(options.limits) {}

std::optional<ScheduleContents> ScheduleReader::read(const ScheduleSource& source,
                                                     std::shared_ptr<NSError>& error) {
    _archive = ScheduleArchive::open(source, error);
    if (!_archive)
        return std::nullopt;
    error = checkStatedSizes(source);
    if (error)
        return std::nullopt;
    TripIndex trips;
    AgencyReader agencies(_contents);
    RouteReader routes(_contents, _feed);
    FeedInfoReader feedInfo(_contents);
    TranslationReader translations(_contents);
    StopReader stops(_contents);
    TripReader tripRows(_contents, trips);
    StopTimeReader stopTimes(_contents, trips);
    // Each builds on what those before it have read.
    const std::array<RowReader*, FilesRead.size()> readers = {
        &agencies, &routes, &feedInfo, &translations, &stops, &tripRows, &stopTimes};
    for (RowReader* reader : readers) {
        error = readFile(*reader, source);
        if (error)
            return std::nullopt;
    }
    if (_contents.lines.empty()) {
        error = scheduleError(ScheduleErrorCode::NoSchedule,
                              labelOf(source, routes.file()) + ": names no line");
        return std::nullopt;
    }
    ScheduleInfo& info = _contents.info;
    info.feed = _feed;
    info.agencies = static_cast<std::int64_t>(_contents.agencies.size());
    info.lines = static_cast<std::int64_t>(_contents.lines.size());
    info.stops = static_cast<std::int64_t>(_contents.stops.size());
    _contents.rows = _budget.rows();
    return std::move(_contents);
}

/// Refuses at once what says itself that it is too large; what does not is counted while read.
std::shared_ptr<NSError> ScheduleReader::checkStatedSizes(const ScheduleSource& source) {
    for (const char* file : FilesRead) {
        const std::uint64_t size = _archive->statedSize(file);
        ScheduleBudget whole(_options.limits);
        if (auto error = whole.spendBytes(_statedBytes, labelOf(source, file)))
            return error;
        if (auto error = whole.spendBytes(size, labelOf(source, file)))
            return error;
        _statedBytes += size;
    }
    return nullptr;
}

std::shared_ptr<NSError> ScheduleReader::readFile(RowReader& reader, const ScheduleSource& source) {
    const std::string file = reader.file();
    const std::string label = labelOf(source, file);
    if (!_archive->has(file)) {
        reader.end();
        return nullptr;
    }
    std::shared_ptr<NSError> error;
    const auto bytes = _archive->openFile(file, error);
    if (!bytes)
        return error;
    CountedStream counted(*bytes, _budget, label, [this, &file] { tellProgress(file); });
    CsvTable table(counted, label, _budget);
    error = table.readHeader();
    if (!error)
        error = readRows(reader, table, source);
    return error;
}

std::shared_ptr<NSError>
ScheduleReader::readRows(RowReader& reader, CsvTable& table, const ScheduleSource& source) {
    const std::string file = reader.file();
    const auto needed = reader.neededColumns();
    const auto missing = std::ranges::find_if(needed, [&table](const std::string& column) {
        return table.column(column) == CsvTable::NoColumn;
    });
    if (missing != needed.end()) {
        const std::string reason =
            table.hasColumns() ? "no column " + *missing : std::string("is empty");
        if (reader.isNeeded())
            return scheduleError(ScheduleErrorCode::NoSchedule,
                                 labelOf(source, file) + ": " + reason);
        _contents.notes.add(file, reason + ", left out", 0);
        reader.end();
        return nullptr;
    }
    reader.begin(table);
    std::shared_ptr<NSError> error;
    while (table.next(error))
        reader.readRow(table);
    if (!error)
        reader.end();
    return error;
}

void ScheduleReader::tellProgress(const std::string& file) {
    if (!_options.progress)
        return;
    const auto stated = static_cast<double>(std::max(_statedBytes, std::uint64_t{1}));
    const double done = std::min(1.0, static_cast<double>(_budget.bytes()) / stated);
    const double fraction = done * ShareOfImport;
    const bool isFirst = _toldFraction == 0;
    if (!isFirst && fraction - _toldFraction < ProgressStep)
        return;
    _toldFraction = fraction;
    _options.progress({file, fraction});
}

} // namespace orvo
