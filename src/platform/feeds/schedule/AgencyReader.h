#pragma once

#include "platform/feeds/schedule/RowReader.h"
#include "platform/feeds/schedule/ScheduleContents.h"

namespace orvo {

/// agency.txt. Where two rows have one agency_id, the first counts.
class AgencyReader final : public RowReader {
public:
    explicit AgencyReader(ScheduleContents& contents)
        : _contents(contents) {}

    [[nodiscard]] std::string file() const override { return "agency.txt"; }
    [[nodiscard]] std::vector<std::string> neededColumns() const override {
        return {"agency_name"};
    }
    void begin(const CsvTable& table) override;
    void readRow(const CsvTable& table) override;

private:
    ScheduleContents& _contents;
    std::size_t _id = CsvTable::NoColumn;
    std::size_t _name = CsvTable::NoColumn;
    std::size_t _url = CsvTable::NoColumn;
    std::size_t _timezone = CsvTable::NoColumn;
    std::size_t _language = CsvTable::NoColumn;
};

} // namespace orvo
