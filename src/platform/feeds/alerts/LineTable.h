#pragma once

#include "platform/feeds/schedule/LineIndex.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// The lines of a schedule side by side with what selectors compare, for hundreds of thousands of
/// questions in one go. Lines are named by their place in the schedule's order.
class LineTable {
public:
    using Place = std::uint32_t;
    static constexpr Place None = 0xFFFFFFFF;

    struct Entry {
        const ScheduleLine* line = nullptr;
        std::string_view routeId;
        std::string_view agencyId;
        int basicType = 0;
        std::size_t nameLength = 0; ///< of its short and its long name together, in bytes
        std::uint64_t muid = 0;
    };

    explicit LineTable(std::shared_ptr<const LineIndex> index);
    LineTable(const LineTable&) = delete;
    LineTable& operator=(const LineTable&) = delete;

    [[nodiscard]] const LineIndex& index() const noexcept { return *_index; }
    [[nodiscard]] std::size_t count() const noexcept { return _entries.size(); }
    [[nodiscard]] const Entry& at(Place place) const noexcept { return _entries[place]; }
    /// `None` for a line that the schedule does not have.
    [[nodiscard]] Place placeOf(std::uint64_t muid) const;
    /// By the rules of `LineIndex::lineForRoute`. `None` for an unknown route.
    [[nodiscard]] Place placeOfRoute(std::string_view routeId) const;
    /// How many slots were passed to find room for the line that lies farthest from its own: tens
    /// at most, since nobody who writes a schedule can tell the slots of its lines.
    [[nodiscard]] std::size_t longestProbe() const noexcept { return _longestProbe; }
    /// The greatest `nameLength` of all lines; 0 without any.
    [[nodiscard]] std::size_t longestName() const noexcept { return _longestName; }

private:
    [[nodiscard]] std::size_t slotOf(std::string_view routeId) const noexcept;

    std::shared_ptr<const LineIndex> _index;
    std::string _routeIds; // of all entries, where they lie close together
    std::vector<Entry> _entries;
    std::vector<Place> _slots; // open addressing; at most half full
    std::size_t _longestProbe = 0;
    std::size_t _longestName = 0;
};

} // namespace orvo
