#pragma once

#include "platform/feeds/schedule/RowReader.h"
#include "platform/feeds/schedule/ScheduleArchive.h"
#include "platform/feeds/schedule/ScheduleBudget.h"
#include "platform/feeds/schedule/ScheduleContents.h"
#include "platform/feeds/schedule/ScheduleImport.h"
#include "platform/feeds/schedule/ScheduleSource.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace orvo {

/// Reads one schedule from first to last: which files, in which order, within which limits.
class ScheduleReader {
public:
    /// How much of an import the reading is; the rest is writing.
    static constexpr double ShareOfImport = 0.9;

    /// `feed` is the short name of the feed that the lines belong to. The options must outlive the
    /// reader.
    ScheduleReader(std::string feed, const ImportOptions& options);

    /// @return nothing, with the reason in `error`, when the schedule is refused
    [[nodiscard]] std::optional<ScheduleContents> read(const ScheduleSource& source,
                                                       std::shared_ptr<NSError>& error);

private:
    std::shared_ptr<NSError> checkStatedSizes(const ScheduleSource& source);
    std::shared_ptr<NSError> readFile(RowReader& reader, const ScheduleSource& source);
    std::shared_ptr<NSError>
    readRows(RowReader& reader, CsvTable& table, const ScheduleSource& source);
    void tellProgress(const std::string& file);

    std::string _feed;
    const ImportOptions& _options;
    ScheduleBudget _budget;
    ScheduleContents _contents;
    std::unique_ptr<ScheduleArchive> _archive;
    std::uint64_t _statedBytes = 0; // of all files that are read
    double _toldFraction = 0;
};

} // namespace orvo
