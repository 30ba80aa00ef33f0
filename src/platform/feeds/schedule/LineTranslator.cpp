#include "platform/feeds/schedule/LineTranslator.h"

#include "platform/feeds/schedule/ScheduleText.h"

#include <unicode/locid.h>

#include <algorithm>
#include <string_view>

namespace orvo {

namespace {

constexpr char Divider = '\0';

std::string
keyOf(char kind, const std::string& table, const std::string& field, const std::string& value) {
    std::string key(1, kind);
    for (const std::string* part : {&table, &field, &value})
        key.append(*part).push_back(Divider);
    return key;
}

constexpr char ByRecord = 'r';
constexpr char ByValue = 'v';

icu::Locale localeOf(const std::string& tag) {
    UErrorCode status = U_ZERO_ERROR;
    return icu::Locale::forLanguageTag(tag, status);
}

/// The script that the tag names, or the one that its language is usually written in.
std::string scriptOf(const std::string& tag) {
    icu::Locale locale = localeOf(tag);
    UErrorCode status = U_ZERO_ERROR;
    locale.addLikelySubtags(status);
    return locale.getScript();
}

std::string normalized(const std::string& tag) {
    std::string result = ScheduleText::asciiLowercase(tag);
    std::ranges::replace(result, '_', '-');
    return result;
}

} // namespace

int languageMatch(const std::string& wanted, const std::string& offered) {
    const std::string a = normalized(wanted);
    const std::string b = normalized(offered);
    if (a.empty() || b.empty())
        return 0;
    if (a == b)
        return 3;
    if (a.substr(0, a.find('-')) != b.substr(0, b.find('-')))
        return 0;
    return scriptOf(a) == scriptOf(b) ? 2 : 1;
}

LineTranslator::LineTranslator(const std::vector<ScheduleTranslation>& translations,
                               const std::string& scheduleLanguage,
                               const std::string& personLanguage) {
    const int own = languageMatch(personLanguage, scheduleLanguage);
    for (const ScheduleTranslation& translation : translations) {
        const int rank = languageMatch(personLanguage, translation.language);
        if (rank <= own)
            continue;
        const bool isByRecord = !translation.recordId.empty();
        Choice& choice =
            _choices[keyOf(isByRecord ? ByRecord : ByValue,
                           translation.table,
                           translation.field,
                           isByRecord ? translation.recordId : translation.fieldValue)];
        if (rank > choice.rank)
            choice = {rank, translation.text};
    }
}

void LineTranslator::translate(ScheduleLine& line) const {
    if (_choices.empty())
        return;
    replace(line.shortName, "routes", "route_short_name", line.routeId);
    replace(line.longName, "routes", "route_long_name", line.routeId);
    replace(line.agency.name, "agency", "agency_name", line.agency.id);
}

void LineTranslator::replace(std::string& text,
                             const std::string& table,
                             const std::string& field,
                             const std::string& recordId) const {
    if (text.empty())
        return;
    auto found = _choices.find(keyOf(ByRecord, table, field, recordId));
    if (found == _choices.end())
        found = _choices.find(keyOf(ByValue, table, field, text));
    if (found != _choices.end())
        text = found->second.text;
}

} // namespace orvo
