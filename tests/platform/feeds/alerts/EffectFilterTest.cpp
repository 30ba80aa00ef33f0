#include "platform/feeds/alerts/EffectFilter.h"

#include "platform/geoservices/FeedTransitIncident.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

bool isIncident(IncidentEffect effect, IncidentSeverity severity, bool stepFree = false) {
    return !reasonAgainstIncident(
        static_cast<std::int32_t>(effect), static_cast<std::int32_t>(severity), stepFree);
}

constexpr IncidentSeverity Severities[] = {IncidentSeverity::Unknown,
                                           IncidentSeverity::Info,
                                           IncidentSeverity::Warning,
                                           IncidentSeverity::Severe};

} // namespace

TEST(EffectFilter, NoEffectAndAdditionalServiceAreNeverIncidents) {
    for (const IncidentSeverity severity : Severities) {
        EXPECT_FALSE(isIncident(IncidentEffect::NoEffect, severity, true));
        EXPECT_FALSE(isIncident(IncidentEffect::AdditionalService, severity, true));
    }
}

TEST(EffectFilter, AccessibilityIssuesAreIncidentsOnlyForStepFreeTravel) {
    for (const IncidentSeverity severity : Severities) {
        EXPECT_FALSE(isIncident(IncidentEffect::AccessibilityIssue, severity, false));
        EXPECT_TRUE(isIncident(IncidentEffect::AccessibilityIssue, severity, true));
    }
}

TEST(EffectFilter, OtherAndUnknownEffectsAreIncidentsUnlessTheyAreInformation) {
    for (const IncidentEffect effect : {IncidentEffect::OtherEffect, IncidentEffect::UnknownEffect})
        for (const IncidentSeverity severity : Severities)
            EXPECT_EQ(isIncident(effect, severity), severity != IncidentSeverity::Info);
}

TEST(EffectFilter, EverythingElseIsAnIncident) {
    for (const std::int32_t effect : {1, 2, 3, 4, 6, 9})
        for (const IncidentSeverity severity : Severities)
            EXPECT_TRUE(isIncident(static_cast<IncidentEffect>(effect), severity)) << effect;
}

TEST(EffectFilter, SaysWhy) {
    EXPECT_EQ(reasonAgainstIncident(10, 1, false), AlertCount::AlertsWithoutEffect);
    EXPECT_EQ(reasonAgainstIncident(11, 1, false), AlertCount::AlertsOnlyAboutAccess);
    EXPECT_EQ(reasonAgainstIncident(7, 2, false), AlertCount::AlertsOnlyInformation);
}

} // namespace orvo::testing
