#pragma once

#include "platform/feeds/schedule/ImportNotes.h"
#include "platform/feeds/schedule/ScheduleInfo.h"
#include "platform/feeds/schedule/ScheduleLine.h"

#include <cstdint>
#include <deque>
#include <string>
#include <vector>

namespace orvo {

/// One row of stops.txt.
struct ScheduleStop {
    std::string id;
    std::string name;
    std::string parentId; ///< the station that it belongs to; empty for none
    int locationType = 0; ///< 0 stop, 1 station, 2 entrance, 3 node, 4 boarding area
};

/// That a line serves a stop: places in the lists of the contents.
struct StopOfLine {
    std::uint32_t stop = 0;
    std::uint32_t line = 0;

    friend auto operator<=>(const StopOfLine&, const StopOfLine&) = default;
};

/// A text of routes.txt or agency.txt in another language.
struct ScheduleTranslation {
    std::string table;    ///< `routes` or `agency`
    std::string field;    ///< `route_long_name`
    std::string language; ///< a BCP-47 tag
    std::string recordId; ///< of the row that is translated; empty: each row with `fieldValue`
    std::string fieldValue;
    std::string text;

    friend bool operator==(const ScheduleTranslation&, const ScheduleTranslation&) = default;
};

/// A schedule as it was read.
struct ScheduleContents {
    ScheduleInfo info; ///< all but `importedAt`
    std::vector<ScheduleAgency> agencies;
    std::vector<ScheduleLine> lines;      ///< in the schedule's order
    std::deque<ScheduleStop> stops;       ///< a list whose elements stay where they are
    std::vector<StopOfLine> stopsOfLines; ///< sorted, each once; stations count with their stops
    std::vector<ScheduleTranslation> translations;
    ImportNotes notes;
    std::uint64_t rows = 0;
};

} // namespace orvo
