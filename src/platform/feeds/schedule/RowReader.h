#pragma once

#include "platform/feeds/schedule/CsvTable.h"
#include "platform/foundation/NSError.h"

#include <memory>
#include <string>
#include <vector>

namespace orvo {

/// Takes up the rows of one file of a schedule.
class RowReader {
public:
    RowReader() = default;
    RowReader(const RowReader&) = delete;
    RowReader& operator=(const RowReader&) = delete;
    virtual ~RowReader() = default;

    /// `stops.txt`.
    [[nodiscard]] virtual std::string file() const = 0;
    /// Without these columns the file tells nothing.
    [[nodiscard]] virtual std::vector<std::string> neededColumns() const = 0;
    /// Whether there is no schedule without this file.
    [[nodiscard]] virtual bool isNeeded() const { return false; }

    /// Finds its columns. Called once, before the first row.
    virtual void begin(const CsvTable& table) = 0;
    /// Takes up the row that the table stands at.
    virtual void readRow(const CsvTable& table) = 0;
    /// Called once after the last row, also where the file is missing.
    virtual void end() {}
};

} // namespace orvo
