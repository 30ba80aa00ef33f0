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
    /// The line's own shield; nil where it has none.
    std::shared_ptr<TransitArtworkDataSource> artwork;
    /// Its system's mark; nil where there is none.
    std::shared_ptr<TransitArtworkDataSource> systemArtwork;

    /// @param schedules tells the long name; may be nil
    [[nodiscard]] static LineMark ofLine(const TransitLine& line, const ScheduleStore* schedules);
    [[nodiscard]] static LineMark ofLine(const ScheduleLine& line);

    /// What stands before the title: the shield, else the system's mark, else nil.
    [[nodiscard]] const std::shared_ptr<TransitArtworkDataSource>& picture() const noexcept {
        return artwork ? artwork : systemArtwork;
    }
    /// What is written on the line's own shield; empty without one.
    [[nodiscard]] std::string shieldText() const;
    /// What is written on the picture; empty without one.
    [[nodiscard]] std::string pictureText() const;
    /// All of it for a voice, nothing twice: `M1, Skyline Cable Car, Marrow Bay Transit`.
    [[nodiscard]] std::string spoken() const;
};

} // namespace orvo
