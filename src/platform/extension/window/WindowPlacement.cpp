#include "platform/extension/window/WindowPlacement.h"

#include <algorithm>
#include <cmath>

namespace orvo {

namespace {

CGFloat startWithin(CGFloat start, CGFloat length, CGFloat from, CGFloat room) {
    return std::max(from, std::min(start, from + room - length));
}

} // namespace

CGRect windowFramePlacing(CGPoint topLeft, CGSize size, const CGRect& available) {
    return {{startWithin(topLeft.x, size.width, available.origin.x, available.size.width),
             startWithin(topLeft.y, size.height, available.origin.y, available.size.height)},
            size};
}

CGRect rectUniting(const CGRect& one, const CGRect& other) {
    const CGPoint origin{std::min(one.origin.x, other.origin.x),
                         std::min(one.origin.y, other.origin.y)};
    const auto end = [](const CGRect& rect) {
        return CGPoint{rect.origin.x + rect.size.width, rect.origin.y + rect.size.height};
    };
    return {origin,
            {std::max(end(one).x, end(other).x) - origin.x,
             std::max(end(one).y, end(other).y) - origin.y}};
}

CGRect rectBetween(const CGRect& from, const CGRect& to, double progress) {
    return {{std::lerp(from.origin.x, to.origin.x, progress),
             std::lerp(from.origin.y, to.origin.y, progress)},
            {std::lerp(from.size.width, to.size.width, progress),
             std::lerp(from.size.height, to.size.height, progress)}};
}

bool rectContains(const CGRect& rect, CGPoint point) {
    return point.x >= rect.origin.x && point.x < rect.origin.x + rect.size.width &&
           point.y >= rect.origin.y && point.y < rect.origin.y + rect.size.height;
}

} // namespace orvo
