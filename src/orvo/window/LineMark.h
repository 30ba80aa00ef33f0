#pragma once

#include "platform/geoservices/TransitArtworkDataSource.h"
#include "platform/geoservices/TransitLine.h"

#include <cstdint>
#include <memory>
#include <string>

namespace orvo {

class ScheduleStore;
struct ScheduleLine;

/// What stands for a line, or a place, in a window: its shield and its words, each in one line of
/// text. A value.
struct LineMark {
    std::uint64_t muid = 0; ///< 0 for a place
    std::string name;       ///< what a rider calls it: `M1`; may be empty
    std::string title;      ///< the long name where the schedule gives one, else the name
    std::string detail;     ///< a line's system, a place's position; may be empty
    /// Nil where there is none; then the title stands alone.
    std::shared_ptr<TransitArtworkDataSource> artwork;

    /// @param schedules tells the long name; may be nil
    [[nodiscard]] static LineMark ofLine(const TransitLine& line, const ScheduleStore* schedules);
    [[nodiscard]] static LineMark ofLine(const ScheduleLine& line);

    /// What is written on the shield; empty without one.
    [[nodiscard]] std::string shieldText() const;
    /// All of it for a voice, nothing twice: `M1, Skyline Cable Car, Marrow Bay Transit`.
    [[nodiscard]] std::string spoken() const;
};

} // namespace orvo
