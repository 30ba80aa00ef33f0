#pragma once

#include <cstdint>
#include <span>
#include <vector>

/// Pictures as files.
namespace orvo::PngWriter {

/// A PNG file of premultiplied ARGB pixels, row by row from the top, that says how large a pixel
/// is: `scale` of them are a point, 72 points an inch. Any thread.
/// Empty where there are no pixels.
/// @throws NSInvalidArgumentException when the number of pixels does not fit
[[nodiscard]] std::vector<std::uint8_t>
write(std::span<const std::uint32_t> pixels, int columns, int rows, double scale);

} // namespace orvo::PngWriter
