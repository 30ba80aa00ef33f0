#include "platform/feeds/schedule/CsvTable.h"

#include "platform/feeds/schedule/ScheduleText.h"

#include <algorithm>
#include <utility>

namespace orvo {

CsvTable::CsvTable(ScheduleStream& stream, std::string file, ScheduleBudget& budget)
    : _reader(stream, std::move(file))
    , _budget(budget) {}

std::shared_ptr<NSError> CsvTable::readHeader() {
    std::shared_ptr<NSError> error;
    if (!_reader.next(error))
        return error;
    for (std::size_t index = 0; index < _reader.fieldCount(); ++index)
        _columns.push_back(
            ScheduleText::asciiLowercase(ScheduleText::trimmed(_reader.field(index))));
    return nullptr;
}

bool CsvTable::next(std::shared_ptr<NSError>& error) {
    if (!_reader.next(error))
        return false;
    error = _budget.spendRow(_reader.file());
    return !error;
}

std::size_t CsvTable::column(std::string_view name) const {
    const auto found = std::ranges::find(_columns, ScheduleText::asciiLowercase(name));
    return found == _columns.end() ? NoColumn : static_cast<std::size_t>(found - _columns.begin());
}

std::string_view CsvTable::value(std::size_t column) const noexcept {
    return ScheduleText::trimmed(_reader.field(column));
}

} // namespace orvo
