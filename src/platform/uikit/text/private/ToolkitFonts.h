#pragma once

#include "platform/uikit/text/TextMeasurer.h"

#include <QFont>
#include <QTextLayout>

namespace orvo::ToolkitFonts {

/// Whether there is an application object that can have fonts.
[[nodiscard]] bool areAvailable();

/// The face of the program's font set; the toolkit's own choice where the set is not installed.
[[nodiscard]] QFont fontOf(const FontFace& face);

/// Shapes `text`, without line breaks, as one line: line 0 of `layout`.
void layOut(QTextLayout& layout,
            const std::string& text,
            std::span<const TextRun> runs,
            bool rightToLeft);

} // namespace orvo::ToolkitFonts
