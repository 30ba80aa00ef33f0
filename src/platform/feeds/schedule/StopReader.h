#pragma once

#include "platform/feeds/schedule/RowReader.h"
#include "platform/feeds/schedule/ScheduleContents.h"
#include "platform/foundation/SeededStringHash.h"

#include <string>
#include <string_view>

namespace orvo {

/// stops.txt. Where two rows have one stop_id, the first counts.
class StopReader final : public RowReader {
public:
    explicit StopReader(ScheduleContents& contents)
        : _contents(contents) {}

    [[nodiscard]] std::string file() const override { return "stops.txt"; }
    [[nodiscard]] std::vector<std::string> neededColumns() const override { return {"stop_id"}; }
    void begin(const CsvTable& table) override;
    void readRow(const CsvTable& table) override;
    void end() override { _ids.clear(); }

private:
    ScheduleContents& _contents;
    std::size_t _id = CsvTable::NoColumn;
    std::size_t _name = CsvTable::NoColumn;
    std::size_t _parent = CsvTable::NoColumn;
    std::size_t _locationType = CsvTable::NoColumn;
    SeededTextSet<std::string_view> _ids; // views into the contents
};

} // namespace orvo
