#include "platform/foundation/LocalizedFormat.h"

#include "platform/foundation/StringsTable.h"
#include "platform/foundation/Text.h"

#include <unicode/listformatter.h>
#include <unicode/numberformatter.h>
#include <unicode/plurrule.h>
#include <unicode/unistr.h>

#include <fmt/format.h>

namespace orvo {

namespace {

icu::Locale currentLocale() {
    UErrorCode status = U_ZERO_ERROR;
    auto locale = icu::Locale::forLanguageTag(Text::locale().get(), status);
    return U_SUCCESS(status) ? locale : icu::Locale::getEnglish();
}

std::string utf8(const icu::UnicodeString& text) {
    std::string result;
    text.toUTF8String(result);
    return result;
}

std::string localizedNumber(const FormatArgument& number) {
    const auto formatter = icu::number::NumberFormatter::withLocale(currentLocale());
    UErrorCode status = U_ZERO_ERROR;
    if (const auto* integer = std::get_if<std::int64_t>(&number))
        return utf8(formatter.formatInt(*integer, status).toString(status));
    if (const auto* real = std::get_if<double>(&number))
        return utf8(formatter.formatDouble(*real, status).toString(status));
    // Through decimal digits: the interface has no unsigned numbers.
    return utf8(formatter.formatDecimal(fmt::to_string(std::get<std::uint64_t>(number)), status)
                    .toString(status));
}

std::string shown(const FormatArgument& argument) {
    const auto* text = std::get_if<std::string>(&argument);
    return text ? *text : localizedNumber(argument);
}

std::string pluralCategory(const std::vector<FormatArgument>& arguments) {
    for (const auto& argument : arguments) {
        if (std::holds_alternative<std::string>(argument))
            continue;
        const double number = std::visit(
            [](const auto& value) {
                if constexpr (std::is_same_v<std::decay_t<decltype(value)>, std::string>)
                    return 0.0;
                else
                    return static_cast<double>(value);
            },
            argument);
        UErrorCode status = U_ZERO_ERROR;
        const std::unique_ptr<icu::PluralRules> rules(
            icu::PluralRules::forLocale(currentLocale(), status));
        return U_SUCCESS(status) ? utf8(rules->select(number)) : "other";
    }
    return "other";
}

/// One conversion of a format: where it ends, and which argument it shows.
struct Conversion {
    std::size_t end;
    std::optional<std::size_t> position; ///< from 0; nothing: the next one
};

/// Reads what follows a percent sign: an optional position, then `@` or a whole-number or fraction
/// conversion.
std::optional<Conversion> parseConversion(std::string_view format, std::size_t at) {
    std::optional<std::size_t> position;
    std::size_t digits = at;
    std::size_t number = 0;
    while (digits < format.size() && format[digits] >= '0' && format[digits] <= '9' &&
           number < 1000)
        number = number * 10 + static_cast<std::size_t>(format[digits++] - '0');
    if (digits > at && digits < format.size() && format[digits] == '$' && number > 0) {
        position = number - 1;
        at = digits + 1;
    }
    for (const std::string_view conversion : {"@", "llu", "lld", "lu", "ld", "d", "i", "u", "f"})
        if (format.substr(at, conversion.size()) == conversion)
            return Conversion{at + conversion.size(), position};
    return std::nullopt;
}

std::string filled(std::string_view format, const std::vector<FormatArgument>& arguments) {
    std::string result;
    std::size_t next = 0;
    for (std::size_t i = 0; i < format.size();) {
        if (format[i] != '%') {
            result += format[i++];
            continue;
        }
        if (format.substr(i, 2) == "%%") {
            result += '%';
            i += 2;
            continue;
        }
        const auto conversion = parseConversion(format, i + 1);
        if (!conversion) {
            result += format[i++]; // a lone percent sign is itself
            continue;
        }
        const auto index = conversion->position ? *conversion->position : next++;
        if (index < arguments.size())
            result += shown(arguments[index]);
        i = conversion->end;
    }
    return result;
}

/// What the language puts between two items in the middle of a list, found in a list of four.
std::string middleSeparator() {
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<icu::ListFormatter> formatter(
        icu::ListFormatter::createInstance(currentLocale(), status));
    const icu::UnicodeString items[]{u"\uE001", u"\uE002", u"\uE003", u"\uE004"};
    icu::UnicodeString list;
    if (U_SUCCESS(status))
        formatter->format(items, 4, list, status);
    const auto second = list.indexOf(items[1]);
    const auto third = list.indexOf(items[2]);
    if (U_FAILURE(status) || second < 0 || third <= second)
        return ", ";
    return utf8(icu::UnicodeString(list, second + 1, third - second - 1));
}

std::string joined(const std::vector<std::string>& items) {
    const auto separator = items.size() > 1 ? middleSeparator() : "";
    return fmt::format("{}", fmt::join(items, separator));
}

} // namespace

std::string localizedStringWithFormat(const std::string& format,
                                      const std::vector<FormatArgument>& arguments) {
    const auto forms = PluralForms::unpacked(format);
    if (!forms)
        return filled(format, arguments);
    auto form = forms->find(pluralCategory(arguments));
    if (form == forms->end())
        form = forms->find("other");
    return form == forms->end() ? std::string() : filled(form->second, arguments);
}

std::string localizedCommaDelimitedList(const std::vector<std::string>& items) {
    return commaDelimitedListJoin().get()(items);
}

EnvironmentSlot<CommaDelimitedListJoin>& commaDelimitedListJoin() {
    static EnvironmentSlot<CommaDelimitedListJoin> slot(
        [] { return CommaDelimitedListJoin(joined); });
    return slot;
}

} // namespace orvo
