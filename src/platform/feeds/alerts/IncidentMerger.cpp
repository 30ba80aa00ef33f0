#include "platform/feeds/alerts/IncidentMerger.h"

#include <algorithm>
#include <tuple>
#include <utility>

namespace orvo {

namespace {

/// A feed that uses one identifier for many alerts does not mean translations.
constexpr std::size_t MostUnderOneId = 16;
/// No incident is told in more; each is compared with each.
constexpr std::size_t MostLanguages = 100;

bool hasTag(const AlertTexts& texts, std::string_view tag) {
    return std::any_of(texts.begin(), texts.end(), [&](const AlertText& text) {
        return LanguagePreference::isSameTag(text.language, tag);
    });
}

bool sharesLanguage(const AlertTexts& a, const AlertTexts& b) {
    return std::any_of(
        a.begin(), a.end(), [&](const AlertText& text) { return hasTag(b, text.language); });
}

void addMissingLanguages(AlertTexts& texts, const AlertTexts& more) {
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

Incident incidentOf(Alert& alert, std::size_t source, AlertRoom room) {
    Incident incident(room);
    incident.effect = alert.effect;
    incident.members.push_back({&alert, source});
    incident.header = std::move(alert.header);
    incident.description = std::move(alert.description);
    incident.spokenHeader = std::move(alert.spokenHeader);
    incident.link = std::move(alert.link);
    return incident;
}

} // namespace

IncidentMerger::IncidentMerger(std::string feed, std::string_view agencyLanguage, AlertRoom room)
    : _room(room)
    , _feed(std::move(feed))
    , _preference(LanguagePreference::forAgency(agencyLanguage))
    , _incidents(room)
    , _byId(room) {}

void IncidentMerger::add(Alert& alert, std::size_t source) {
    if (source != std::exchange(_source, source))
        _byId.clear();
    if (Incident* const partner = translationPartner(alert, source)) {
        unite(*partner, incidentOf(alert, source, _room));
        return;
    }
    addIncident(alert, source);
}

void IncidentMerger::addIncident(Alert& alert, std::size_t source) {
    const std::size_t place = _incidents.size();
    if (!alert.id.empty()) {
        const auto [sameId, isNew] = _byId.try_emplace(alert.id, SameId{place, place});
        if (!isNew)
            _nextOfId[std::exchange(sameId->second.last, place)] = place;
    }
    _nextOfId.push_back(0);
    _incidents.push_back(incidentOf(alert, source, _room));
}

Incident* IncidentMerger::translationPartner(const Alert& alert, std::size_t source) {
    if (alert.id.empty())
        return nullptr;
    const auto sameId = _byId.find(alert.id);
    if (sameId == _byId.end())
        return nullptr;
    std::size_t place = sameId->second.first;
    for (std::size_t looked = 0; looked < MostUnderOneId; ++looked) {
        Incident& incident = _incidents[place];
        if (incident.effect == alert.effect && incident.header.size() < MostLanguages &&
            incident.members.front().source == source &&
            !sharesLanguage(incident.header, alert.header) &&
            !sharesLanguage(incident.description, alert.description))
            return &incident;
        place = _nextOfId[place];
        if (place == 0)
            break;
    }
    return nullptr;
}

IncidentMerger::Incidents IncidentMerger::take() {
    mergeSameContent();
    return std::move(_incidents);
}

void IncidentMerger::mergeSameContent() {
    std::vector<IncidentContent> contents;
    contents.reserve(_incidents.size());
    for (const Incident& incident : _incidents)
        contents.push_back(contentOf(incident));
    const std::vector<std::uint64_t> numbers = IncidentContent::numbersOf(contents, _feed);
    std::pmr::monotonic_buffer_resource passing;
    // The first incident of each number.
    SeededNumberMap<std::size_t, std::pmr::polymorphic_allocator> firsts(&passing);
    firsts.reserve(_incidents.size());
    for (std::size_t i = 0; i < _incidents.size(); ++i) {
        std::uint64_t muid = numbers[i];
        auto [found, isNew] = firsts.try_emplace(muid, i);
        // Two contents of one hash would hide one another: the later takes the next free number.
        while (muid == 0 || (!isNew && contents[found->second] != contents[i]))
            std::tie(found, isNew) = firsts.try_emplace(++muid, i);
        if (isNew)
            _incidents[i].muid = muid;
        else
            unite(_incidents[found->second], _incidents[i]);
    }
    std::erase_if(_incidents, [](const Incident& incident) { return incident.muid == 0; });
}

IncidentContent IncidentMerger::contentOf(const Incident& incident) {
    const auto [header, description] = _preference.bestPair(incident.header, incident.description);
    return {normalised(header), normalised(description), incident.effect};
}

/// Once for each text: to clean one takes as long as it has markup.
std::string_view IncidentMerger::normalised(const AlertText* text) {
    if (!text)
        return {};
    std::string room;
    const std::string_view line = IncidentContent::normalised(text->text, room);
    if (line.empty()) // whatever it views
        return {};
    return room.empty() ? line : _normalised.emplace_back(std::move(room));
}

} // namespace orvo
