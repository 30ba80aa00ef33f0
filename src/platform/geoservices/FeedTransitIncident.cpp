#include "platform/geoservices/FeedTransitIncident.h"

#include <array>
#include <utility>

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
    Occurrence occurrence{fields.startDate,
                          fields.endDate,
                          fields.isBlockingIncident,
                          details.isPartOfLine,
                          details.timeZone};
    return initWithCommon_occurrence(
        std::make_shared<const Common>(Common{std::move(fields), std::move(details)}),
        std::move(occurrence));
}

std::shared_ptr<FeedTransitIncident>
FeedTransitIncident::initWithCommon_occurrence(std::shared_ptr<const Common> common,
                                               Occurrence occurrence) {
    auto incident = std::make_shared<FeedTransitIncident>();
    incident->_common = std::move(common);
    incident->_occurrence = std::move(occurrence);
    return incident;
}

FeedTransitIncident::Details FeedTransitIncident::details() const {
    Details details = _common->details;
    details.isPartOfLine = _occurrence.isPartOfLine;
    details.timeZone = _occurrence.timeZone;
    return details;
}

} // namespace orvo
