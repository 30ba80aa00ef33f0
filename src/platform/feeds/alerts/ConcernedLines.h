#pragma once

#include "platform/feeds/alerts/Incident.h"
#include "platform/feeds/alerts/SelectorResolver.h"

#include <cstdint>
#include <optional>
#include <set>
#include <span>
#include <string_view>
#include <tuple>
#include <vector>

namespace orvo {

/// The lines that the alerts of an incident name together, each once, in the schedule's order. A
/// line that one selector names whole is concerned whole, whatever stops others name. One object
/// serves many incidents, one after the other.
class ConcernedLines {
public:
    struct Line {
        LineTable::Place place = LineTable::None;
        const ScheduleLine* line = nullptr;
        const LineTable::Entry* entry = nullptr; ///< the line's in the table
        bool isPart = true; ///< whether only stops or trips of it are concerned
        std::size_t firstStop = 0, endStop = 0;
        std::size_t firstMember = 0, endMember = 0;
    };

    /// The resolver outlives the object.
    explicit ConcernedLines(SelectorResolver& resolver)
        : _resolver(resolver) {}

    /// Finds the lines of an incident, in the place of the last one's: those that the selectors
    /// name that were read. All lines when one of these selectors needs the schedule to know its
    /// own, or the fields of an alert's selectors are not to be had.
    void find(const Incident& incident);
    /// Finds all lines, by the selectors too that were passed over when the alerts were read.
    void findAll(const Incident& incident);
    /// Whether `lines()` are all that the incident names.
    [[nodiscard]] bool areAll() const noexcept { return _areAll; }

    /// How many selectors named too many lines to be followed, over all incidents: each may name
    /// any line.
    [[nodiscard]] std::size_t lostSelectors() const noexcept { return _lostSelectors; }

    [[nodiscard]] const std::vector<Line>& lines() const noexcept { return _lines; }
    /// The stops by which the line is concerned, sorted; none where it is concerned whole.
    [[nodiscard]] std::span<const std::string_view> stopsOf(const Line& line) const noexcept {
        return std::span(_stops).subspan(line.firstStop, line.endStop - line.firstStop);
    }
    /// The places of the incident's members that name the line, ascending.
    [[nodiscard]] std::span<const std::size_t> membersOf(const Line& line) const noexcept {
        return std::span(_members).subspan(line.firstMember, line.endMember - line.firstMember);
    }

private:
    /// Lines named by selectors without a route, over all incidents. A few bytes of an alert name
    /// all lines of an agency: many such alerts would take thousands of times the room of their
    /// feed.
    static constexpr std::size_t MostBroad = 4'000'000;

    /// One line named by one selector.
    struct Mention {
        LineTable::Place place;
        bool isPart;
        std::size_t member;
        std::string_view stop; // empty for none

        friend auto operator<=>(const Mention& a, const Mention& b) {
            return std::tie(a.place, a.stop, a.member) <=> std::tie(b.place, b.stop, b.member);
        }
    };

    void collect(const Incident& incident);
    void addMentions(std::span<const AlertSelector> selectors, std::size_t member);
    [[nodiscard]] std::span<const AlertSelector> selectorsOf(const Alert& alert);
    [[nodiscard]] bool takeBroad();
    void takeMention(const Mention& mention);
    void finishLine();

    SelectorResolver& _resolver;
    bool _areAll = true;
    AlertSelectors _reread; // of an alert of which some were passed over
    std::vector<Line> _lines;
    std::vector<std::string_view> _stops;
    std::vector<std::size_t> _members;
    std::vector<Mention> _mentions;
    SelectorResolver::Places _named;
    std::size_t _broadLeft = MostBroad;
    std::size_t _lostSelectors = 0;
    std::set<std::tuple<std::string_view, std::string_view, std::optional<std::int32_t>>> _broad;
};

} // namespace orvo
