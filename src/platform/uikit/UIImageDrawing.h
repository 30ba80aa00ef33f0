#pragma once

#include "platform/foundation/CGGeometry.h"

namespace orvo {

class Canvas;
class UIImage;
class UIView;

/// How views show images.
namespace UIImageDrawing {

/// The largest rectangle of the image's proportions within `bounds`, in its middle, no larger than
/// the image, on whole device pixels where the image has them.
[[nodiscard]] CGRect placeIn(const CGRect& bounds, CGSize image, double scale);

/// Draws the image there in the look of `view`: inside vibrancy in the colour of that alone,
/// elsewhere as it is; a fixed image, which has no colour itself, in the tint colour, and the mark
/// of good service in its own.
void draw(Canvas& canvas, const UIImage& image, const CGRect& bounds, const UIView& view);

} // namespace UIImageDrawing

} // namespace orvo
