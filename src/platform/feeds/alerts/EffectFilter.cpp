#include "platform/feeds/alerts/EffectFilter.h"

#include "platform/geoservices/FeedTransitIncident.h"

namespace orvo {

std::optional<AlertCount>
reasonAgainstIncident(std::int32_t effect, std::int32_t severity, bool stepFree) noexcept {
    switch (static_cast<IncidentEffect>(effect)) {
    case IncidentEffect::NoEffect:
    case IncidentEffect::AdditionalService:
        return AlertCount::AlertsWithoutEffect;
    case IncidentEffect::AccessibilityIssue:
        return stepFree ? std::nullopt : std::optional(AlertCount::AlertsOnlyAboutAccess);
    case IncidentEffect::OtherEffect:
    case IncidentEffect::UnknownEffect:
        if (static_cast<IncidentSeverity>(severity) == IncidentSeverity::Info)
            return AlertCount::AlertsOnlyInformation;
        return std::nullopt;
    default:
        return std::nullopt;
    }
}

} // namespace orvo
