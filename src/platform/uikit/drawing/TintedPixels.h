#pragma once

#include "platform/uikit/drawing/RGBA.h"

#include <cstdint>
#include <span>
#include <vector>

namespace orvo::TintedPixels {

/// The picture in one colour: what is as bright as most of it takes that colour, what stands out
/// from that (the text of a shield) is cut out, the more the further it is. Premultiplied ARGB in
/// and out; the picture's own transparency stays. Any thread.
[[nodiscard]] std::vector<std::uint32_t> of(std::span<const std::uint32_t> pixels, RGBA tint);

} // namespace orvo::TintedPixels
