#pragma once

#include "print/PrintedTarget.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// A shield as text and colours.
struct PrintedShield {
    std::string text; ///< the line's name where its shield is a colour alone; never empty
    std::optional<std::string> background; ///< `RRGGBB`; nothing for a neutral shield
    std::string foreground;                ///< `RRGGBB`; empty for a neutral shield
};

/// One of the fixed images, or shields.
struct PrintedArtwork {
    std::optional<std::string> image;
    std::vector<PrintedShield> shields = {};
    double alpha = 1;
};

/// A row of the widget as plain values: what it shows, and what a tap on it opens.
struct PrintedRow {
    enum class Kind {
        Item,
        Summary, ///< the compact row of several advisories: a title above its lines' shields
    };

    Kind kind = Kind::Item;
    std::optional<std::string> primaryText;
    std::optional<std::string> secondaryText;
    std::optional<PrintedArtwork> artwork;
    bool artworkHidden = false;
    std::optional<PrintedTarget> opens;

    /// Of an `OWTransitItem` or `OWTransitSummaryItem`. `before`, which may be nil: the row before,
    /// as in `PrintedTarget::of`.
    /// @throws NSInvalidArgumentException for anything else
    [[nodiscard]] static PrintedRow of(const std::shared_ptr<NSObject>& item,
                                       const PrintedRow* before = nullptr);
};

/// What performs the tap on such an item; nil where it cannot be tapped.
/// @throws NSInvalidArgumentException as above
[[nodiscard]] std::shared_ptr<OWOpenable> openableOfItem(const std::shared_ptr<NSObject>& item);

} // namespace orvo
