#pragma once

#include "platform/uikit/drawing/RGBA.h"

#include <cstdint>
#include <string_view>
#include <vector>

/// Draws the program's fixed images. Each has one colour, and details that one looks through, so
/// that it stands on any ground.
namespace orvo::FixedImagePainter {

/// The image of that name, drawn for a square of `side` by `side` device pixels: premultiplied
/// ARGB, row by row from the top. Straight edges fall on whole pixels where `side` is a multiple of
/// the 24 points that the images measure. Empty for a name that is none, and for a side below 1.
/// Any thread.
[[nodiscard]] std::vector<std::uint32_t> draw(std::string_view name, int side, RGBA color);

} // namespace orvo::FixedImagePainter
