#pragma once

#include <cstdint>

namespace orvo {

/// A colour of the screen, not premultiplied.
struct RGBA {
    std::uint8_t red = 0;
    std::uint8_t green = 0;
    std::uint8_t blue = 0;
    std::uint8_t alpha = 255;

    friend bool operator==(const RGBA&, const RGBA&) = default;

    /// `0xRRGGBB`, opaque.
    [[nodiscard]] static constexpr RGBA fromHex(std::uint32_t rgb) noexcept {
        return {static_cast<std::uint8_t>(rgb >> 16),
                static_cast<std::uint8_t>(rgb >> 8),
                static_cast<std::uint8_t>(rgb),
                255};
    }
};

} // namespace orvo
