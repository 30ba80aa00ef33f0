#pragma once

#include <string>

namespace orvo {

class UIView;

/// The tree of views with their frames, one a line, deeper ones indented: class or identifier,
/// `x y width height` in the coordinates of the root, then what is not as usual (`hidden`,
/// `alpha 0.5`), then what is shown: the lines of a label, `"…"` each, shields `[…]`, fixed images
/// by their names. Lays nothing out.
[[nodiscard]] std::string dumpViews(const UIView& root);

/// Every constraint that holds in the layout of `root`, one a line, in order: those of the views
/// from the root down, each view's in order of activation, then its own (a stack view's).
[[nodiscard]] std::string dumpConstraints(UIView& root);

} // namespace orvo
