#pragma once

#include "platform/feeds/schedule/RowReader.h"
#include "platform/feeds/schedule/ScheduleContents.h"

namespace orvo {

/// translations.txt: the names of lines and agencies in other languages.
class TranslationReader final : public RowReader {
public:
    explicit TranslationReader(ScheduleContents& contents)
        : _contents(contents) {}

    [[nodiscard]] std::string file() const override { return "translations.txt"; }
    [[nodiscard]] std::vector<std::string> neededColumns() const override {
        return {"table_name", "field_name", "language", "translation"};
    }
    void begin(const CsvTable& table) override;
    void readRow(const CsvTable& table) override;

private:
    ScheduleContents& _contents;
    std::size_t _table = CsvTable::NoColumn;
    std::size_t _field = CsvTable::NoColumn;
    std::size_t _language = CsvTable::NoColumn;
    std::size_t _translation = CsvTable::NoColumn;
    std::size_t _recordId = CsvTable::NoColumn;
    std::size_t _fieldValue = CsvTable::NoColumn;
};

} // namespace orvo
