#include "platform/feeds/alerts/IncidentMerger.h"

#include "platform/feeds/alerts/ByteScan.h"
#include "platform/feeds/alerts/TextCleaner.h"
#include "platform/foundation/Hashing.h"

#include <algorithm>
#include <tuple>
#include <utility>

namespace orvo {

namespace {

/// A feed that uses one identifier for many alerts does not mean translations.
constexpr std::size_t MostUnderOneId = 16;
/// No incident is told in more; each is compared with each.
constexpr std::size_t MostLanguages = 100;

constexpr std::string_view NoBreakSpace = "\u00A0";
constexpr std::string_view NarrowNoBreakSpace = "\u202F";

bool hasTag(const std::vector<AlertText>& texts, std::string_view tag) {
    return std::any_of(texts.begin(), texts.end(), [&](const AlertText& text) {
        return LanguagePreference::isSameTag(text.language, tag);
    });
}

bool sharesLanguage(const std::vector<AlertText>& a, const std::vector<AlertText>& b) {
    return std::any_of(
        a.begin(), a.end(), [&](const AlertText& text) { return hasTag(b, text.language); });
}

void addMissingLanguages(std::vector<AlertText>& texts, const std::vector<AlertText>& more) {
    const std::size_t known = texts.size();
    for (const AlertText& text : more)
        if (known == 0 || (texts.size() < MostLanguages && !hasTag(texts, text.language)))
            texts.push_back(text);
}

void unite(Incident& incident, const Incident& other) {
    incident.members.insert(incident.members.end(), other.members.begin(), other.members.end());
    addMissingLanguages(incident.header, other.header);
    addMissingLanguages(incident.description, other.description);
    addMissingLanguages(incident.spokenHeader, other.spokenHeader);
    addMissingLanguages(incident.link, other.link);
}

Incident incidentOf(Alert& alert, std::size_t source) {
    return {0,
            alert.effect,
            {{&alert, source}},
            std::move(alert.header),
            std::move(alert.description),
            std::move(alert.spokenHeader),
            std::move(alert.link)};
}

} // namespace

IncidentMerger::IncidentMerger(std::string feed, std::string_view agencyLanguage)
    : _feed(std::move(feed))
    , _preference(LanguagePreference::forAgency(agencyLanguage)) {}

void IncidentMerger::add(Alert& alert, std::size_t source) {
    if (source != std::exchange(_source, source))
        _byId.clear();
    if (Incident* const partner = translationPartner(alert, source)) {
        unite(*partner, incidentOf(alert, source));
        return;
    }
    if (!alert.id.empty())
        _byId[alert.id].push_back(_incidents.size());
    _incidents.push_back(incidentOf(alert, source));
}

Incident* IncidentMerger::translationPartner(const Alert& alert, std::size_t source) {
    if (alert.id.empty())
        return nullptr;
    const auto sameId = _byId.find(alert.id);
    if (sameId == _byId.end())
        return nullptr;
    std::size_t looked = 0;
    for (const std::size_t position : sameId->second) {
        Incident& incident = _incidents[position];
        if (incident.effect == alert.effect && incident.header.size() < MostLanguages &&
            incident.members.front().source == source &&
            !sharesLanguage(incident.header, alert.header) &&
            !sharesLanguage(incident.description, alert.description))
            return &incident;
        if (++looked == MostUnderOneId)
            break;
    }
    return nullptr;
}

std::vector<Incident> IncidentMerger::take() {
    mergeSameContent();
    return std::move(_incidents);
}

void IncidentMerger::mergeSameContent() {
    std::vector<Incident> merged;
    std::vector<std::string> contents;
    SeededNumberMap<std::size_t> positions;
    merged.reserve(_incidents.size());
    contents.reserve(_incidents.size());
    positions.reserve(_incidents.size());
    for (Incident& incident : _incidents) {
        std::string content = contentOf(incident);
        std::uint64_t muid = stableHash(content);
        auto [found, isNew] = positions.try_emplace(muid, merged.size());
        // Two contents of one hash would hide one another: the later takes the next free number.
        while (muid == 0 || (!isNew && contents[found->second] != content))
            std::tie(found, isNew) = positions.try_emplace(++muid, merged.size());
        if (!isNew) {
            unite(merged[found->second], incident);
            continue;
        }
        incident.muid = muid;
        merged.push_back(std::move(incident));
        contents.push_back(std::move(content));
    }
    _incidents = std::move(merged);
}

std::string IncidentMerger::contentOf(const Incident& incident) const {
    const auto [header, description] = _preference.bestPair(incident.header, incident.description);
    constexpr std::size_t Separators = 8;
    std::string content;
    content.reserve(_feed.size() + (header ? header->text.size() : 0) +
                    (description ? description->text.size() : 0) + Separators);
    content += _feed;
    content += '\0';
    if (header)
        content += normalised(header->text);
    content += '\0';
    if (description)
        content += normalised(description->text);
    content += '\0';
    content += std::to_string(incident.effect);
    return content;
}

std::string IncidentMerger::normalised(std::string_view text) {
    std::string line = TextCleaner::cleanLine(text);
    if (ByteScan::isASCII(line))
        return line;
    std::string plain;
    plain.reserve(line.size());
    for (std::string_view rest = line; !rest.empty();) {
        std::size_t length = 1;
        for (const std::string_view blank : {NoBreakSpace, NarrowNoBreakSpace})
            if (rest.starts_with(blank))
                length = blank.size();
        plain += length == 1 ? rest[0] : ' ';
        rest.remove_prefix(length);
    }
    return plain;
}

} // namespace orvo
