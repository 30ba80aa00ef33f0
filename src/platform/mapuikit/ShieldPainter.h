#pragma once

#include "platform/geoservices/TransitShieldDataSource.h"
#include "platform/uikit/UIImage.h"

#include <cstdint>
#include <memory>

namespace orvo::ShieldPainter {

/// A shield's height in points, by size 0 to 7; what is below or above counts as the nearest.
[[nodiscard]] double heightOf(std::int64_t shieldSize) noexcept;

/// Whether there is anything to draw of a shield: a text, or colours.
[[nodiscard]] bool isVisible(const TransitShieldDataSource& shield);

/// Draws a shield in the shape of its mode and the colours of its line: at least as wide as high,
/// its edges on whole device pixels, its text centred on the height of capitals. A shield without
/// colours is neutral, one without a text is its line's colour alone; one that the card would
/// nearly swallow gets a hairline around it. Of a text that no column has room for the beginning is
/// drawn. Nil for one that is not visible, and where the program has no graphical application
/// object.
[[nodiscard]] std::shared_ptr<UIImage>
draw(const TransitShieldDataSource& shield, std::int64_t shieldSize, double scale, bool nightMode);

} // namespace orvo::ShieldPainter
