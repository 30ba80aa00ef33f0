#pragma once

#include "platform/uikit/text/TextLayout.h"

class QTextLayout;

/// Lines that were drawn lately, ready to be drawn again: shaping is most of the cost of a text.
namespace orvo::_ShapedLines {

/// Valid until the next call. Nil where there is no application object that can have fonts. Main
/// thread.
[[nodiscard]] const QTextLayout* shapeOf(const TextLine& line);

/// How many lines this process has shaped for drawing.
[[nodiscard]] std::uint64_t shaped() noexcept;

} // namespace orvo::_ShapedLines
