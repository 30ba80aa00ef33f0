#pragma once

#include "orvo/console/JsonWriter.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSError.h"
#include "platform/geoservices/TransitIncident.h"
#include "platform/geoservices/TransitLineItem.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

class ScheduleStore;

/// What a lookup answered, as plain values that can be printed.
struct IncidentReport {
    struct Incident {
        std::uint64_t muid = 0;
        std::string title;
        std::string summary;
        /// Seconds since 1970; nothing is open.
        std::optional<double> start;
        std::optional<double> end;
        std::string severity; ///< its GTFS-Realtime name
        std::string effect;   ///< likewise
        bool isPartOfLine = false;
        bool isUnknown = false; ///< a status that could not be proven
        std::optional<std::string> timeZone;
        /// Of an unknown status: why it is unknown, in the person's language; may be empty.
        std::string reason;
    };
    struct Line {
        std::optional<std::string> feed; ///< nothing, as the next, for a line of no feed
        std::optional<std::string> routeId;
        std::uint64_t muid = 0;
        std::string name;
        std::string system;
        std::vector<Incident> incidents; ///< current and coming, most important first
    };

    double at = 0; ///< seconds since 1970
    std::vector<Line> lines;
    std::shared_ptr<NSError> error; ///< why there are no lines; nil when there is an answer

    /// An incident as it came from a lookup, or a storable copy of one.
    [[nodiscard]] static Incident incidentOf(const TransitIncident& incident);
    /// @param schedules tells where a line comes from that does not say so itself; may be nil
    [[nodiscard]] static Line lineOf(const TransitLineItem& item, const ScheduleStore* schedules);
    /// The lines of `TransitLineItem`s, in their order.
    /// @param schedules tells where a line comes from that does not say so itself; may be nil
    [[nodiscard]] static std::vector<Line> linesOf(const std::shared_ptr<NSArray>& items,
                                                   const ScheduleStore* schedules);

    /// The form that scripts rely on.
    [[nodiscard]] std::string json() const;
    /// The members of a line but for its incidents, and those of an incident, into an object that
    /// has begun.
    static void addMembers(JsonWriter& json, const Line& line);
    static void addMembers(JsonWriter& json, const Incident& incident);
};

} // namespace orvo
