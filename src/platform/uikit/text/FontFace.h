#pragma once

#include <compare>

namespace orvo {

/// One face of the program's font at one size.
struct FontFace {
    double pointSize = 0;
    int weight = 400; ///< 400 regular, 500 medium, 600 semibold, 700 bold

    friend auto operator<=>(const FontFace&, const FontFace&) = default;
};

/// In points. Equal at every scale of the screen.
struct FontMetrics {
    double ascender = 0;  ///< above the baseline
    double descender = 0; ///< below the baseline, negative
    double capHeight = 0;
    double leading = 0; ///< extra room between two lines

    [[nodiscard]] double lineHeight() const noexcept { return ascender - descender + leading; }
    friend bool operator==(const FontMetrics&, const FontMetrics&) = default;
};

} // namespace orvo
