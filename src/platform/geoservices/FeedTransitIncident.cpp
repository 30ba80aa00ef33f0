#include "platform/geoservices/FeedTransitIncident.h"

#include <array>

namespace orvo {

namespace {

template <std::size_t N>
std::string nameAt(const std::array<const char*, N>& names, std::int32_t number) {
    // The three enumerations count from 1.
    if (number >= 1 && number <= static_cast<std::int32_t>(N))
        return names[static_cast<std::size_t>(number - 1)];
    return std::to_string(number);
}

} // namespace

std::string nameOf(IncidentSeverity severity) {
    static constexpr std::array names{"UNKNOWN_SEVERITY", "INFO", "WARNING", "SEVERE"};
    return nameAt(names, static_cast<std::int32_t>(severity));
}

std::string nameOf(IncidentEffect effect) {
    static constexpr std::array names{"NO_SERVICE",
                                      "REDUCED_SERVICE",
                                      "SIGNIFICANT_DELAYS",
                                      "DETOUR",
                                      "ADDITIONAL_SERVICE",
                                      "MODIFIED_SERVICE",
                                      "OTHER_EFFECT",
                                      "UNKNOWN_EFFECT",
                                      "STOP_MOVED",
                                      "NO_EFFECT",
                                      "ACCESSIBILITY_ISSUE"};
    return nameAt(names, static_cast<std::int32_t>(effect));
}

std::string nameOf(IncidentCause cause) {
    static constexpr std::array names{"UNKNOWN_CAUSE",
                                      "OTHER_CAUSE",
                                      "TECHNICAL_PROBLEM",
                                      "STRIKE",
                                      "DEMONSTRATION",
                                      "ACCIDENT",
                                      "HOLIDAY",
                                      "WEATHER",
                                      "MAINTENANCE",
                                      "CONSTRUCTION",
                                      "POLICE_ACTIVITY",
                                      "MEDICAL_EMERGENCY"};
    return nameAt(names, static_cast<std::int32_t>(cause));
}

std::shared_ptr<FeedTransitIncident> FeedTransitIncident::initWithFields_details(Fields fields,
                                                                                 Details details) {
    auto incident = std::make_shared<FeedTransitIncident>();
    incident->_initWithFields(std::move(fields));
    incident->_details = std::move(details);
    return incident;
}

} // namespace orvo
