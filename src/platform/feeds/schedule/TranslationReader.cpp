#include "platform/feeds/schedule/TranslationReader.h"

#include "platform/feeds/schedule/ScheduleText.h"

#include <utility>

namespace orvo {

namespace {

bool isNameOfLine(std::string_view table, std::string_view field) {
    if (table == "routes")
        return field == "route_short_name" || field == "route_long_name";
    return table == "agency" && field == "agency_name";
}

} // namespace

void TranslationReader::begin(const CsvTable& table) {
    _table = table.column("table_name");
    _field = table.column("field_name");
    _language = table.column("language");
    _translation = table.column("translation");
    _recordId = table.column("record_id");
    _fieldValue = table.column("field_value");
}

void TranslationReader::readRow(const CsvTable& table) {
    if (!isNameOfLine(table.value(_table), table.value(_field)))
        return;
    ScheduleTranslation translation;
    translation.table = table.value(_table);
    translation.field = table.value(_field);
    translation.language = ScheduleText::cleanName(table.value(_language));
    translation.recordId = table.value(_recordId);
    translation.fieldValue = ScheduleText::cleanName(table.value(_fieldValue));
    translation.text = ScheduleText::cleanName(table.value(_translation));
    const bool namesNothing = translation.recordId.empty() && translation.fieldValue.empty();
    if (translation.language.empty() || translation.text.empty() || namesNothing) {
        _contents.notes.add(file(),
                            "no language, no translation or nothing that it is of, left out",
                            table.rowNumber());
        return;
    }
    _contents.translations.push_back(std::move(translation));
}

} // namespace orvo
