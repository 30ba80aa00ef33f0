#pragma once

#include "platform/feeds/schedule/LineIndex.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <vector>

namespace orvo {

class SelectorShapes;

/// Finds the entities of messages that matter for some lines, without reading the others further
/// than their selectors.
///
/// Chosen are those whose selectors may name one of the lines or could not be read, and those that
/// may be the same incident as a chosen one: under the same identifier, or with a header that may
/// be the same. More may be chosen than matter, never fewer: what is built for the lines is the
/// same as from all entities.
class AlertSelection {
public:
    /// @param lines by muid; those that the schedule does not have are passed over
    /// @param stepFree whether incidents about step-free access matter
    AlertSelection(const LineIndex& index, const std::vector<std::uint64_t>& lines, bool stepFree);
    AlertSelection(const AlertSelection&) = delete;
    AlertSelection& operator=(const AlertSelection&) = delete;
    ~AlertSelection();

    /// Looks at the next entity; its bytes are not needed afterwards.
    void look(std::string_view entity);
    /// How many entities were looked at.
    [[nodiscard]] std::size_t count() const noexcept;
    /// Forgets the entities from the given place on.
    void truncate(std::size_t count);
    /// Ends the looking. Then it is known for each entity whether it is chosen.
    void choose();
    [[nodiscard]] bool isChosen(std::size_t entity) const;

    /// Tells selectors that name none of the lines from a look at their first bytes, by what was
    /// learnt of the entities looked at.
    [[nodiscard]] const SelectorShapes& shapes() const noexcept;

private:
    class Wanted;
    class Ties;
    std::unique_ptr<Wanted> _wanted;
    std::unique_ptr<Ties> _ties;
    bool _stepFree;
};

} // namespace orvo
