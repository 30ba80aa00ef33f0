#include "platform/demo/DemoIncidents.h"

#include <cmath>

namespace orvo::DemoIncidents {

namespace {

constexpr double Minute = 60;
constexpr double Hour = 60 * Minute;
constexpr double Day = 24 * Hour;

DemoIncident signalFailure() {
    return {"signals",
            {"Delays on M1 and M2", "Verspätungen auf M1 und M2"},
            {"Trains run up to 15 minutes late after a signal failure at Central Station.\n"
             "Change at Market Square for the tram to Old Harbour.",
             "Nach einer Signalstörung am Hauptbahnhof fahren die Züge bis zu 15 Minuten später.\n"
             "Zum Alten Hafen bitte am Marktplatz in die Straßenbahn umsteigen."},
            IncidentCause::TechnicalProblem,
            IncidentEffect::SignificantDelays,
            IncidentSeverity::Warning,
            {{"", "M1", ""}, {"", "M2", ""}}};
}

DemoIncident trackWorks() {
    return {"track-works",
            {"Trams diverted at Old Harbour", "Umleitung am Alten Hafen"},
            {"Track works: line 4 runs by way of Quay Street, without the stop Old Harbour.",
             "Gleisbauarbeiten: Die Linie 4 fährt über die Kaistraße, ohne Halt am Alten Hafen."},
            IncidentCause::Construction,
            IncidentEffect::Detour,
            IncidentSeverity::Warning,
            {{"", "T4", ""}}};
}

DemoIncident movedStop() {
    return {"moved-stop",
            {"Hospital stop moved", "Haltestelle Krankenhaus verlegt"},
            {"Buses 12 and 48 stop 100 metres further on, in front of the pharmacy.",
             "Die Busse 12 und 48 halten 100 Meter weiter vor der Apotheke."},
            IncidentCause::Construction,
            IncidentEffect::StopMoved,
            IncidentSeverity::Info,
            {{"", "B12", "hospital"}, {"", "B48", "hospital"}}};
}

DemoIncident shorterTrains() {
    return {"short-trains",
            {"Fewer trains to the coast", "Weniger Züge zur Küste"},
            {"After a medical emergency at Northgate every second train is left out.",
             "Nach einem Notarzteinsatz am Nordtor fällt jeder zweite Zug aus."},
            IncidentCause::MedicalEmergency,
            IncidentEffect::ReducedService,
            IncidentSeverity::Warning,
            {{"", "S1", ""}}};
}

DemoIncident storm() {
    return {"storm",
            {"No ferries", "Kein Fährverkehr"},
            {"The ferry to Gull Island stays in harbour because of the storm.",
             "Die Fähre zur Möweninsel bleibt wegen des Sturms im Hafen."},
            IncidentCause::Weather,
            IncidentEffect::NoService,
            IncidentSeverity::Severe,
            {{"", "F1", ""}}};
}

DemoIncident inspection() {
    return {"inspection",
            {"Cable car closed for inspection", "Seilbahn wegen Prüfung geschlossen"},
            {"The yearly inspection of the ropes. Buses run between Botanical Garden and Lookout "
             "Summit every 20 minutes.",
             "Jährliche Prüfung der Seile. Zwischen Botanischem Garten und Aussichtsberg fahren "
             "alle 20 Minuten Busse."},
            IncidentCause::Maintenance,
            IncidentEffect::NoService,
            IncidentSeverity::Severe,
            {{"", "SKY", ""}}};
}

DemoIncident strike() {
    return {"strike",
            {"Warning strike on the railway", "Warnstreik bei der Bahn"},
            {"Harbour and Hills Railway expects fewer trains and boats.",
             "Die Hafen- und Hangbahn rechnet mit weniger Zügen und Schiffen."},
            IncidentCause::Strike,
            IncidentEffect::ReducedService,
            IncidentSeverity::Warning,
            {{"hhr", "", ""}}};
}

DemoIncident brokenLift() {
    return {"lift",
            {"Lift out of order at Airport", "Aufzug am Flughafen außer Betrieb"},
            {"Step-free from Northgate by bus X90.", "Stufenlos ab Nordtor mit dem Bus X90."},
            IncidentCause::TechnicalProblem,
            IncidentEffect::AccessibilityIssue,
            IncidentSeverity::Info,
            {{"", "M1", "airport"}}};
}

DemoIncident festival() {
    return {"festival",
            {"More trams to the garden festival", "Mehr Bahnen zum Gartenfest"},
            {"Line 7 runs every five minutes until midnight.",
             "Die Linie 7 fährt bis Mitternacht alle fünf Minuten."},
            IncidentCause::OtherCause,
            IncidentEffect::AdditionalService,
            IncidentSeverity::Info,
            {{"", "T7", ""}}};
}

DemoIncident during(DemoIncident incident, std::vector<DemoIncident::Period> periods) {
    incident.periods = std::move(periods);
    return incident;
}

} // namespace

std::vector<DemoIncident> around(double written) {
    const auto after = [&](double seconds) {
        return written + seconds;
    };
    return {
        during(signalFailure(), {{after(-25 * Minute), after(3 * Hour)}}),
        during(trackWorks(), {{after(-6 * Day), after(9 * Day)}}),
        // Also tomorrow at the same time: one incident with two periods.
        during(movedStop(),
               {{after(-1 * Hour), after(4 * Hour)}, {after(22 * Hour), after(28 * Hour)}}),
        during(shorterTrains(), {{after(-40 * Minute), after(2 * Minute)}}),
        during(storm(), {{after(1.5 * Minute), after(4 * Hour)}}),
        during(inspection(), {{after(5 * Hour), after(9 * Hour)}}),
        during(strike(), {{after(20 * Hour), after(44 * Hour)}}),
        during(brokenLift(), {{after(-2 * Day), std::nullopt}}),
        during(festival(), {{after(-1 * Hour), after(6 * Hour)}}),
    };
}

std::vector<DemoIncident> live(double begun, double now) {
    const double elapsed = std::max(0.0, now - begun);
    const double inCycle = std::fmod(elapsed, LiveCycleSeconds);
    const double cycle = now - inCycle;
    std::vector<DemoIncident> incidents;
    // Without a period: it is there as long as the feed says so.
    if (inCycle >= 0.5 * Minute && inCycle < 2 * Minute)
        incidents.push_back(signalFailure());
    // Announced with both its ends: rows change at these moments without another fetch.
    incidents.push_back(during(trackWorks(), {{cycle + Minute, cycle + 3 * Minute}}));
    // Open until it is withdrawn.
    if (inCycle >= 1.5 * Minute && inCycle < 3.5 * Minute)
        incidents.push_back(during(storm(), {{cycle + 1.5 * Minute, std::nullopt}}));
    incidents.push_back(movedStop());
    incidents.push_back(during(strike(), {{begun + 20 * Hour, begun + 44 * Hour}}));
    return incidents;
}

} // namespace orvo::DemoIncidents
