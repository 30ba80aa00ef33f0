#pragma once

#include "platform/feeds/schedule/CsvReader.h"
#include "platform/feeds/schedule/ScheduleBudget.h"

#include <cstddef>
#include <limits>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// A file of rows under named columns, in any order. Short rows are empty in their last columns;
/// what a row has beyond the last column is passed over.
class CsvTable {
public:
    /// Stands for a column that the file does not have: its values are all empty.
    static constexpr std::size_t NoColumn = std::numeric_limits<std::size_t>::max();

    /// `file` stands in messages. Stream and budget must outlive the table.
    CsvTable(ScheduleStream& stream, std::string file, ScheduleBudget& budget);

    /// Reads the names of the columns; a file without any row has none.
    [[nodiscard]] std::shared_ptr<NSError> readHeader();
    /// As `CsvReader::next()`; also fails at a row beyond the budget.
    [[nodiscard]] bool next(std::shared_ptr<NSError>& error);

    /// The first column of that name; case does not count. `NoColumn` where there is none.
    [[nodiscard]] std::size_t column(std::string_view name) const;
    [[nodiscard]] bool hasColumns() const noexcept { return !_columns.empty(); }
    /// The value in the row just read, without blanks at its ends. Valid until the next row.
    [[nodiscard]] std::string_view value(std::size_t column) const noexcept;
    [[nodiscard]] std::uint64_t rowNumber() const noexcept { return _reader.rowNumber(); }
    [[nodiscard]] const std::string& file() const noexcept { return _reader.file(); }

private:
    CsvReader _reader;
    ScheduleBudget& _budget;
    std::vector<std::string> _columns; // small letters
};

} // namespace orvo
