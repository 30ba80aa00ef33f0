#pragma once

#include "platform/foundation/CGGeometry.h"

namespace orvo {

class UIView;

/// Distances from the edges of a rectangle inwards, in points.
struct UIEdgeInsets {
    CGFloat top = 0;
    CGFloat left = 0;
    CGFloat bottom = 0;
    CGFloat right = 0;

    friend bool operator==(const UIEdgeInsets&, const UIEdgeInsets&) = default;
};

/// The same, of a rectangle whose sides follow the direction of reading.
struct NSDirectionalEdgeInsets {
    CGFloat top = 0;
    CGFloat leading = 0;
    CGFloat bottom = 0;
    CGFloat trailing = 0;

    friend bool operator==(const NSDirectionalEdgeInsets&,
                           const NSDirectionalEdgeInsets&) = default;
};

/// The nearest length that is a whole number of device pixels; a half goes away from zero. `scale`
/// is in pixels a point and above 0.
[[nodiscard]] CGFloat UIRoundToScale(CGFloat value, CGFloat scale);
/// The same with the display scale of `view`; of the main screen for nil.
[[nodiscard]] CGFloat UIRoundToViewScale(CGFloat value, const UIView* view);

} // namespace orvo
