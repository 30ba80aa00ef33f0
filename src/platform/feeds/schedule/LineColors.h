#pragma once

#include <string>
#include <string_view>

namespace orvo {

/// The two colours of a line's shield.
struct LineColors {
    /// Text and background are at least this far apart, by WCAG 2.
    static constexpr double LeastContrast = 4.5;

    std::string background; ///< `RRGGBB` in capitals
    std::string text;       ///< likewise

    /// Colours that can be read from those that a schedule gives (`RRGGBB`; whatever else it is
    /// counts as missing): a missing background is white, as a missing route_color means; a text
    /// colour that is missing or too close to the background is black or white, whichever is
    /// further from it.
    [[nodiscard]] static LineColors mended(std::string_view background, std::string_view text);

    /// Background and text as a shield's colour string: `RRGGBB,RRGGBB`.
    [[nodiscard]] std::string shieldColorString() const { return background + "," + text; }
};

/// The contrast ratio of two colours (`RRGGBB`), 1 to 21, by WCAG 2; in either order.
[[nodiscard]] double contrastRatio(std::string_view a, std::string_view b);

} // namespace orvo
