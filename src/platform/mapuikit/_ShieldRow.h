#pragma once

#include "platform/foundation/CGGeometry.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <vector>

namespace orvo {

/// Where the shields of a row stand, and the text for those that have no room. A value; lengths in
/// points, from the top and from where reading starts.
struct _ShieldRow {
    struct Request {
        std::size_t shields = 0;
        /// The size of a shield's picture; nothing for one that shows nothing, which takes no room.
        /// Asked from the first on, until one has no room.
        std::function<CGSize(std::size_t index)> sizeOf;
        CGFloat space = 0;      ///< between two shields, before the text, and between lines
        CGFloat lineHeight = 0; ///< shields stand in the middle of it
        CGFloat width = 0;
        std::size_t lines = 1; ///< at most; 0 for any number
        /// The width of the text for that many shields left out; 0 for none.
        std::function<CGFloat(std::size_t leftOut)> textWidth;
    };

    /// As many shields as have room together with the text for the others. Those that are shown are
    /// the first ones. A text that is wider than all the room, with no shield shown, is cut to it.
    [[nodiscard]] static _ShieldRow arrange(const Request& request);

    std::vector<CGRect> shields; ///< those shown
    std::optional<CGRect> text;  ///< as high as a line
    CGSize size;

    friend bool operator==(const _ShieldRow&, const _ShieldRow&) = default;
};

} // namespace orvo
