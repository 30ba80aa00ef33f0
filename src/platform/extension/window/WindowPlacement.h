#pragma once

#include "platform/foundation/CGGeometry.h"

namespace orvo {

/// Where a window of that size stands so that it moves as little as can be and is seen whole: its
/// top left stays unless an edge would leave `available`, the screen's free part. One that is
/// larger than that keeps its top left corner on it. All in points of the desktop.
[[nodiscard]] CGRect windowFramePlacing(CGPoint topLeft, CGSize size, const CGRect& available);

/// The smallest rectangle that holds both.
[[nodiscard]] CGRect rectUniting(const CGRect& one, const CGRect& other);

/// The rectangle that lies at `progress`, from 0 to 1, of the way.
[[nodiscard]] CGRect rectBetween(const CGRect& from, const CGRect& to, double progress);

/// Whether the point lies in it; its right and bottom edges do not.
[[nodiscard]] bool rectContains(const CGRect& rect, CGPoint point);

} // namespace orvo
