#pragma once

#include "platform/geoservices/FeedTransitIncident.h"

#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// An incident of the demonstration city, as its alert feed tells it.
struct DemoIncident {
    struct Text {
        std::string english;
        std::string german;
    };
    /// Seconds since 1970.
    struct Period {
        std::optional<double> start;
        std::optional<double> end;
    };
    /// What it concerns; an empty field says nothing.
    struct Selector {
        std::string agencyId;
        std::string routeId;
        std::string stopId;
    };

    std::string id;
    Text header;
    Text description;
    IncidentCause cause = IncidentCause::UnknownCause;
    IncidentEffect effect = IncidentEffect::UnknownEffect;
    IncidentSeverity severity = IncidentSeverity::Warning;
    std::vector<Selector> selectors;
    std::vector<Period> periods = {}; ///< none: as long as it is in the feed
};

namespace DemoIncidents {

/// How long what is written at one time shows all kinds of incidents.
inline constexpr double LifetimeSeconds = 3600;
/// How long the live incidents take until they begin again.
inline constexpr double LiveCycleSeconds = 240;

/// Incidents around `written` (seconds since 1970): shared by lines, current, coming, one that ends
/// two minutes later and one that begins a minute and a half later. The same time gives the same
/// incidents.
[[nodiscard]] std::vector<DemoIncident> around(double written);

/// What a live feed that began at `begun` says at `now` (both seconds since 1970): incidents that
/// are announced, begin, end and are withdrawn, over and over.
[[nodiscard]] std::vector<DemoIncident> live(double begun, double now);

} // namespace DemoIncidents

} // namespace orvo
