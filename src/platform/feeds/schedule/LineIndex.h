#pragma once

#include "platform/feeds/schedule/ScheduleLine.h"
#include "platform/foundation/SeededStringHash.h"

#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// The lines of one feed by everything that an alert may name them by. Immutable; any thread.
///
/// Identifiers are compared exactly, but for blanks around them. Lists of lines hold each line
/// once, in the schedule's order.
class LineIndex {
public:
    /// Asks the schedule about a stop. Called on the thread that asks the index.
    struct StopLookup {
        /// The lines that serve the stop or, for a station, one of its stops; empty where the
        /// schedule does not tell. Nothing when the schedule cannot be asked. May hold lines that
        /// the index does not know: they are left out.
        std::function<std::optional<std::vector<std::uint64_t>>(std::string_view stopId)>
            linesServingStop;
        /// Nothing for a stop that the schedule does not have.
        std::function<std::optional<std::string>(std::string_view stopId)> stopName;
    };

    struct Contents {
        std::string feed;     ///< the feed's short name
        std::string language; ///< the schedule's, a BCP-47 tag; empty when it does not say
        std::string timezone; ///< an IANA name; empty when the schedule does not say
        std::vector<ScheduleLine> lines; ///< those in the schedule, in its order
        StopLookup stops;                ///< an empty function knows no stop
    };

    explicit LineIndex(Contents contents);
    LineIndex(const LineIndex&) = delete;
    LineIndex& operator=(const LineIndex&) = delete;

    [[nodiscard]] const std::string& feed() const noexcept { return _contents.feed; }
    [[nodiscard]] const std::string& language() const noexcept { return _contents.language; }
    [[nodiscard]] const std::string& timezone() const noexcept { return _contents.timezone; }
    /// All lines in the schedule's order.
    [[nodiscard]] const std::vector<ScheduleLine>& lines() const noexcept {
        return _contents.lines;
    }
    /// The line with its names and agency; nil when the schedule does not have it.
    [[nodiscard]] const ScheduleLine* line(std::uint64_t muid) const;

    /// Nothing for a blank or unknown route.
    [[nodiscard]] std::optional<std::uint64_t> lineForRoute(std::string_view routeId) const;
    /// Empty for a blank or unknown agency.
    [[nodiscard]] const std::vector<std::uint64_t>& linesOfAgency(std::string_view agencyId) const;
    /// The lines of this type; extended types, asked or in the schedule, stand for their basic one.
    [[nodiscard]] const std::vector<std::uint64_t>& linesOfType(int routeType) const;
    /// The lines that serve the stop; empty for a blank or unknown stop, nothing when the schedule
    /// cannot be asked.
    [[nodiscard]] std::optional<std::vector<std::uint64_t>>
    linesServingStop(std::string_view stopId) const;
    /// The stop's name, which may be empty; nothing for a stop that the schedule does not have.
    [[nodiscard]] std::optional<std::string> stopName(std::string_view stopId) const;

private:
    Contents _contents;
    SeededNumberMap<std::size_t> _positions;
    SeededTextMap<std::string_view, std::uint64_t> _byRoute; // views into _contents
    std::map<std::string, std::vector<std::uint64_t>, std::less<>> _byAgency;
    std::map<int, std::vector<std::uint64_t>> _byType;
};

} // namespace orvo
