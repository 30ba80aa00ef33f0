#pragma once

#include "orvo/window/LineMark.h"
#include "platform/favorites/TransitStorageIncident.h"
#include "platform/favorites/TransitStorageLineItem.h"

#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// What is told of a line with its incidents, or of a list of incidents, as plain values: the same
/// for a terminal and for a window. Its texts come from strangers; those that are one line of text
/// hold no control characters.
struct IncidentPage {
    /// So many lines of an incident are named; the others are counted.
    static constexpr std::size_t MostNamedLines = 12;

    struct Incident {
        std::string title;      ///< one line; may be empty
        bool isUnknown = false; ///< no incident at all: a status that could not be proven
        /// Seconds since 1970; nothing is open.
        std::optional<double> start;
        std::optional<double> end;
        std::optional<std::string> timeZone; ///< the agency's, an IANA name
        /// Of the lines that it concerns those that are known here, each once.
        std::vector<LineMark> lines;
        std::size_t otherLines = 0; ///< those besides, known or not; 0 where none is known
        std::string summary;
        /// All that is said: the description where there is one, with the summary before it unless
        /// it begins so anyway. Paragraphs are parted by line breaks.
        std::string text;
        std::optional<std::string> link;

        /// The period in words, with the clock of the agency's place. Empty for a status that is
        /// unknown.
        [[nodiscard]] std::string period(double now) const;
        /// Whether it is going on at `now`: as of `start`, and before `end`.
        [[nodiscard]] bool isCurrent(double now) const;
        /// When those words next change, later than `now`; nothing where they do not.
        [[nodiscard]] std::optional<double> nextPeriodChange(double now) const;
        /// The paragraphs of `text`, each one line; none is empty.
        [[nodiscard]] std::vector<std::string> paragraphs() const;
        /// Whether the link is one of the web: another kind is shown and not followed.
        [[nodiscard]] bool canOpenLink() const;
    };

    std::optional<LineMark> line; ///< nothing for a list
    std::vector<Incident> incidents;

    /// @param schedules names the lines that are concerned; may be nil
    [[nodiscard]] static IncidentPage ofLine(const TransitStorageLineItem& line,
                                             const ScheduleStore* schedules);
    /// None of `incidents` is nil.
    [[nodiscard]] static IncidentPage
    ofIncidents(const std::vector<std::shared_ptr<TransitStorageIncident>>& incidents,
                const ScheduleStore* schedules);

    /// What is going on at `now` comes before what is only to come, or is over; else the order
    /// stays.
    void putCurrentFirst(double now);
    /// The window's title and, of a list, its heading: `M1 · Marrow Bay Transit`, `3 incidents`.
    [[nodiscard]] std::string heading() const;
    /// All that a window shows, in its order, a line of text for each element.
    [[nodiscard]] std::string shown(double now) const;
};

} // namespace orvo
