#pragma once

#include <cstdint>
#include <memory>

namespace orvo {

class Canvas;
class UIImage;
class UIView;

/// Draws the view and what it holds, hidden ones left out, from its own origin, and marks all as
/// displayed. What is faded inside a vibrancy effect is drawn stronger than its alpha, so that it
/// stays legible. Lays nothing out. Main thread.
void drawViewHierarchy(UIView& root, Canvas& canvas);

/// Lays the root out and draws it at its size, `scale` pixels a point, on nothing. The root's
/// `displayScale` should be the same, so that edges are crisp. Main thread.
[[nodiscard]] std::shared_ptr<UIImage> snapshotOf(UIView& root, double scale);

} // namespace orvo
