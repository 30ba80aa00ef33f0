#pragma once

#include "platform/uikit/text/TextMeasurer.h"

#include <QFont>
#include <QTextLayout>

namespace orvo::ToolkitFonts {

/// Whether there is an application object that can have fonts.
[[nodiscard]] bool areAvailable();

/// The face of the program's font set; the toolkit's own choice where the set is not installed.
/// For metrics alone: a text may need fonts of the system besides.
[[nodiscard]] QFont fontOf(const FontFace& face);
/// The same, when there is a font for each character of `text`, as far as the system has one.
[[nodiscard]] QFont fontOf(const FontFace& face, const QString& text);

/// Shapes `text`, without line breaks, as one line: line 0 of `layout`.
void layOut(QTextLayout& layout,
            const std::string& text,
            std::span<const TextRun> runs,
            bool rightToLeft);

} // namespace orvo::ToolkitFonts
