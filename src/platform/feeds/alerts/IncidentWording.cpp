#include "platform/feeds/alerts/IncidentWording.h"

#include "platform/feeds/alerts/LineName.h"
#include "platform/feeds/alerts/TextCleaner.h"

#include <algorithm>
#include <array>
#include <utility>

namespace orvo {

namespace {

/// `text` without `beginning` and what separates the two. A text that only begins with the same
/// words, and goes on in the same sentence, stays whole.
std::string_view withoutBeginning(std::string_view text, std::string_view beginning) {
    if (beginning.empty() || !text.starts_with(beginning))
        return text;
    constexpr std::string_view Ends = ".:;!?\n";
    constexpr std::array<std::string_view, 3> Dashes = {" - ", " – ", " — "};
    const std::string_view rest = text.substr(beginning.size());
    const auto* const dash = std::find_if(
        Dashes.begin(), Dashes.end(), [&](std::string_view d) { return rest.starts_with(d); });
    if (dash != Dashes.end())
        return rest.substr(dash->size());
    const bool isSentence = Ends.find(beginning.back()) != std::string_view::npos;
    if (!rest.empty() && !isSentence && Ends.find(rest.front()) == std::string_view::npos)
        return text;
    return rest.substr(std::min(rest.size(), rest.find_first_not_of(".:;!? \n")));
}

/// What the description tells, whose first paragraph may be all of it.
void takeDescription(std::string whole, std::string_view header, IncidentTexts& texts) {
    if (whole.empty())
        return;
    std::string room;
    const std::string_view summary = IncidentWording::summaryOf(whole, header, room);
    texts.isSummaryWhole = summary == whole;
    if (!summary.empty() && !texts.isSummaryWhole)
        texts.summary = TextCleaner::capped(std::string(summary), TextCleaner::LongestText);
    (texts.isSummaryWhole ? texts.summary : texts.fullDescription) =
        TextCleaner::capped(std::move(whole), TextCleaner::LongestText);
}

std::optional<std::string> webAddress(const AlertText* link) {
    if (!link)
        return std::nullopt;
    const std::string address = TextCleaner::clean(link->text);
    const bool isWeb = address.starts_with("https://") || address.starts_with("http://");
    const bool isWhole = address.find_first_of(" \n\"<>") == std::string::npos;
    if (!isWeb || !isWhole || address.size() > TextCleaner::LongestText)
        return std::nullopt;
    return address;
}

} // namespace

IncidentWording::IncidentWording(std::string_view person, std::string_view agency)
    : _preference(LanguagePreference::forPerson(person, agency))
    , _words(person) {}

IncidentTexts IncidentWording::textsOf(const Incident& incident,
                                       const ConcernedLines& lines,
                                       IncidentCause cause) const {
    const auto effect = static_cast<IncidentEffect>(incident.effect);
    const auto [header, description] = _preference.bestPair(incident.header, incident.description);
    IncidentTexts texts;
    std::string title = header ? TextCleaner::cleanLine(header->text) : std::string();
    const bool isOnlyName = std::any_of(
        lines.lines().begin(), lines.lines().end(), [&](const ConcernedLines::Line& line) {
            return !isLongerThanName(title.size(), line.entry->nameLength) &&
                   isOnlyNameOfLine(title, *line.line);
        });
    const bool isTold = !title.empty() && !isOnlyName;
    takeDescription(
        description ? TextCleaner::clean(description->text) : std::string(), title, texts);
    texts.title = isTold ? TextCleaner::capped(std::move(title), TextCleaner::LongestTitle)
                         : _words.effect(effect);
    if (!texts.summary)
        texts.summary = _words.effect_cause(effect, cause);
    if (texts.summary == texts.title) {
        if (std::exchange(texts.isSummaryWhole, false))
            texts.fullDescription = texts.summary;
        texts.summary.reset();
    }

    const AlertText* const spoken =
        isTold ? _preference.like(*header, incident.spokenHeader) : nullptr;
    if (spoken) {
        std::string words =
            TextCleaner::capped(TextCleaner::cleanLine(spoken->text), TextCleaner::LongestTitle);
        if (!words.empty() && words != texts.title)
            texts.spokenTitle = std::move(words);
    }
    texts.link = webAddress(_preference.best(incident.link));
    return texts;
}

bool IncidentWording::mayBeOnlyName(const Incident& incident, std::size_t nameLength) const {
    std::string room;
    const AlertText* const header =
        _preference.bestPair(incident.header, incident.description).header;
    return header &&
           !isLongerThanName(TextCleaner::cleanLine(header->text, room).size(), nameLength);
}

std::string_view IncidentWording::summaryOf(std::string_view description,
                                            std::string_view header,
                                            std::string& room) {
    while (!description.empty()) {
        const std::string_view paragraph = TextCleaner::firstParagraph(description);
        const std::string_view rest =
            TextCleaner::onOneLine(withoutBeginning(paragraph, header), room);
        if (!rest.empty())
            return rest;
        description.remove_prefix(std::min(paragraph.size() + 2, description.size()));
    }
    return {};
}

} // namespace orvo
