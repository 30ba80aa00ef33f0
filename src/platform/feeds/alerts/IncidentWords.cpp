#include "platform/feeds/alerts/IncidentWords.h"

#include "platform/feeds/alerts/LanguagePreference.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <fmt/format.h>

namespace orvo {

/// All texts of one language. `{}` stands for a name, a number or another text of the table.
struct IncidentWords::Table {
    struct Count {
        std::string_view one;
        std::string_view many;
    };

    std::string_view language;
    std::array<std::string_view, 12> effects; // by number
    std::array<std::string_view, 13> causes;  // by number; empty where none is told
    std::string_view effectDueToCause;
    std::string_view statusUnknown;
    std::string_view lastKnown;
    std::string_view neverKnown;
    std::string_view systemAndRest;
    std::string_view moment;
    Count minutes, hours, days;
    std::string_view sourceFailed, selectorLost, lineDeparted, scheduleUnread, nothingToAsk;
};

namespace {

constexpr std::array<IncidentWords::Table, 2> Tables = {{
    {"en",
     {"Service notice",
      "No service",
      "Reduced service",
      "Significant delays",
      "Detour",
      "Additional service",
      "Modified service",
      "Service notice",
      "Service notice",
      "Stop moved",
      "No effect on service",
      "Accessibility issue"},
     {"",
      "",
      "",
      "a technical problem",
      "a strike",
      "a demonstration",
      "an accident",
      "a holiday",
      "the weather",
      "maintenance work",
      "construction work",
      "police activity",
      "a medical emergency"},
     "{} due to {}",
     "Status unknown",
     "last known {}",
     "nothing known yet",
     "{}, {}",
     "less than a minute ago",
     {"{} minute ago", "{} minutes ago"},
     {"{} hour ago", "{} hours ago"},
     {"{} day ago", "{} days ago"},
     "The service alerts could not be read.",
     "A service alert could not be read in full. It may concern this line.",
     "This line is not in the current schedule.",
     "The schedule could not be read.",
     "There is no source of service alerts for this line."},
    {"de",
     {"Hinweis zum Betrieb",
      "Kein Betrieb",
      "Eingeschränkter Betrieb",
      "Erhebliche Verspätungen",
      "Umleitung",
      "Zusätzliche Fahrten",
      "Geänderter Betrieb",
      "Hinweis zum Betrieb",
      "Hinweis zum Betrieb",
      "Haltestelle verlegt",
      "Keine Auswirkung auf den Betrieb",
      "Nicht barrierefrei"},
     {"",
      "",
      "",
      "einer technischen Störung",
      "eines Streiks",
      "einer Demonstration",
      "eines Unfalls",
      "eines Feiertags",
      "des Wetters",
      "Wartungsarbeiten",
      "Bauarbeiten",
      "eines Polizeieinsatzes",
      "eines medizinischen Notfalls"},
     "{} wegen {}",
     "Status unbekannt",
     "zuletzt bekannt {}",
     "noch nichts bekannt",
     "{}, {}",
     "vor weniger als einer Minute",
     {"vor {} Minute", "vor {} Minuten"},
     {"vor {} Stunde", "vor {} Stunden"},
     {"vor {} Tag", "vor {} Tagen"},
     "Die Betriebsmeldungen konnten nicht gelesen werden.",
     "Eine Betriebsmeldung konnte nicht ganz gelesen werden. Sie kann diese Linie betreffen.",
     "Diese Linie steht nicht im aktuellen Fahrplan.",
     "Der Fahrplan konnte nicht gelesen werden.",
     "Für diese Linie gibt es keine Quelle von Betriebsmeldungen."},
}};

const IncidentWords::Table& tableFor(std::string_view language) {
    const std::string tag = LanguagePreference::normalisedTag(language);
    const std::string_view wanted = std::string_view(tag).substr(0, tag.find('-'));
    const auto* const found =
        std::find_if(Tables.begin(), Tables.end(), [&](const IncidentWords::Table& table) {
            return table.language == wanted;
        });
    return found == Tables.end() ? Tables.front() : *found;
}

template <std::size_t Size, class Number>
std::string_view at(const std::array<std::string_view, Size>& texts, Number number) {
    const auto index = static_cast<std::size_t>(number);
    return index < Size ? texts[index] : texts[0];
}

/// Some ASCII and no more: only the first letter of a composed text is made a capital.
std::string capitalised(std::string text) {
    if (!text.empty() && text[0] >= 'a' && text[0] <= 'z')
        text[0] = static_cast<char>(text[0] - 'a' + 'A');
    return text;
}

std::string ago(const IncidentWords::Table& table, double age) {
    constexpr double Minute = 60;
    constexpr double Hour = 60 * Minute;
    constexpr double Day = 24 * Hour;
    if (!(age >= Minute))
        return std::string(table.moment);
    const auto counted = [](const IncidentWords::Table::Count& words, double count) {
        const double whole = std::floor(count);
        return fmt::format(fmt::runtime(whole < 2 ? words.one : words.many),
                           fmt::format("{:.0f}", whole));
    };
    if (age < Hour)
        return counted(table.minutes, age / Minute);
    return age < Day ? counted(table.hours, age / Hour) : counted(table.days, age / Day);
}

} // namespace

IncidentWords::IncidentWords(std::string_view language)
    : _table(&tableFor(language)) {}

std::string IncidentWords::effect(IncidentEffect effect) const {
    return std::string(at(_table->effects, effect));
}

std::string IncidentWords::effect_cause(IncidentEffect effect, IncidentCause cause) const {
    const std::string_view words = at(_table->causes, cause);
    if (words.empty())
        return this->effect(effect);
    return fmt::format(fmt::runtime(_table->effectDueToCause), at(_table->effects, effect), words);
}

std::string IncidentWords::statusUnknown() const {
    return std::string(_table->statusUnknown);
}

std::string IncidentWords::lastKnown(std::string_view systemName, std::optional<double> age) const {
    const std::string when = age ? fmt::format(fmt::runtime(_table->lastKnown), ago(*_table, *age))
                                 : std::string(_table->neverKnown);
    if (systemName.empty())
        return capitalised(when);
    return fmt::format(fmt::runtime(_table->systemAndRest), systemName, when);
}

std::string IncidentWords::sourceFailed() const {
    return std::string(_table->sourceFailed);
}

std::string IncidentWords::selectorLost() const {
    return std::string(_table->selectorLost);
}

std::string IncidentWords::lineDeparted() const {
    return std::string(_table->lineDeparted);
}

std::string IncidentWords::scheduleUnread() const {
    return std::string(_table->scheduleUnread);
}

std::string IncidentWords::nothingToAsk() const {
    return std::string(_table->nothingToAsk);
}

} // namespace orvo
