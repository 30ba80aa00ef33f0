#pragma once

#include "platform/feeds/alerts/Incident.h"
#include "platform/feeds/alerts/IncidentContent.h"
#include "platform/feeds/alerts/LanguagePreference.h"
#include "platform/foundation/SeededStringHash.h"

#include <cstddef>
#include <deque>
#include <memory_resource>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// Finds which alerts are the same incident, so that neither publication under new identifiers, nor
/// one entity for each route, nor one for each language multiplies incidents.
///
/// Alerts of one source under one identifier are united where each only adds languages; and so are
/// alerts of the same effect whose header and description, in the agency's language or else the
/// first, are the same but for markup and blanks.
class IncidentMerger {
public:
    /// @param feed the feed's short name
    /// @param agencyLanguage a BCP-47 tag; empty where the schedule does not say
    /// @param room where the incidents' lists will lie; it outlives them
    IncidentMerger(std::string feed, std::string_view agencyLanguage, AlertRoom room = {});

    /// Alerts are added in the order of the feed and outlive the incidents, which take their texts.
    void add(Alert& alert, std::size_t source);
    using Incidents = std::pmr::deque<Incident>;

    /// The incidents, in the order in which their first alerts were added. Ends the merger.
    [[nodiscard]] Incidents take();

private:
    void addIncident(Alert& alert, std::size_t source);
    [[nodiscard]] Incident* translationPartner(const Alert& alert, std::size_t source);
    [[nodiscard]] IncidentContent contentOf(const Incident& incident);
    [[nodiscard]] std::string_view normalised(const AlertText* text);
    void mergeSameContent();

    AlertRoom _room;
    std::string _feed;
    LanguagePreference _preference;
    Incidents _incidents;
    std::deque<std::string> _normalised; // texts that are compared otherwise than published
    std::size_t _source = 0;
    /// The places of the first and the last incident of one identifier.
    struct SameId {
        std::size_t first = 0, last = 0;
    };
    // Of the current source.
    SeededTextMap<std::string_view, SameId, std::pmr::polymorphic_allocator> _byId;
    std::vector<std::size_t> _nextOfId; // beside the incidents: 0 behind the last
};

} // namespace orvo
