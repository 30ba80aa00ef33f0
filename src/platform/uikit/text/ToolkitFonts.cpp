#include "platform/uikit/text/private/ToolkitFonts.h"

#include "platform/uikit/text/private/ProgramFonts.h"

#include <QGuiApplication>
#include <QTextOption>

#include <algorithm>
#include <cmath>

namespace orvo::ToolkitFonts {

bool areAvailable() {
    return qobject_cast<QGuiApplication*>(QCoreApplication::instance()) != nullptr;
}

QFont fontOf(const FontFace& face) {
    const auto& nearest = ProgramFonts::faceOf(face.weight);
    QFont font(nearest.family);
    font.setPixelSize(std::max(1, static_cast<int>(std::lround(face.pointSize))));
    font.setWeight(static_cast<QFont::Weight>(nearest.weight));
    // With hinting, advances depend on the scale of the screen and on the machine's settings.
    font.setHintingPreference(QFont::PreferNoHinting);
    return font;
}

QFont fontOf(const FontFace& face, const QString& text) {
    ProgramFonts::makeReadyFor(text);
    return fontOf(face);
}

void layOut(QTextLayout& layout,
            const std::string& text,
            std::span<const TextRun> runs,
            bool rightToLeft) {
    const auto utf16Length = [&text](std::size_t begin, std::size_t end) {
        return static_cast<int>(
            QString::fromUtf8(text.data() + begin, static_cast<qsizetype>(end - begin)).size());
    };
    layout.setText(QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size())));
    ProgramFonts::makeReadyFor(layout.text());
    if (!runs.empty())
        layout.setFont(fontOf(runs.front().face));
    QList<QTextLayout::FormatRange> formats;
    if (runs.size() > 1) {
        int start = 0;
        for (const auto& run : runs) {
            QTextLayout::FormatRange range;
            range.start = start;
            range.length = utf16Length(run.begin, run.end);
            range.format.setFont(fontOf(run.face));
            start += range.length;
            formats.push_back(range);
        }
    }
    layout.setFormats(formats);
    QTextOption option;
    option.setTextDirection(rightToLeft ? Qt::RightToLeft : Qt::LeftToRight);
    // A line of unlimited width has no right edge to stand at.
    option.setAlignment(Qt::AlignLeft | Qt::AlignAbsolute);
    option.setWrapMode(QTextOption::NoWrap);
    option.setUseDesignMetrics(true);
    layout.setTextOption(option);
    layout.setCacheEnabled(true);
    layout.beginLayout();
    auto line = layout.createLine();
    if (line.isValid()) {
        line.setNumColumns(static_cast<int>(layout.text().size()));
        line.setPosition({0, 0});
    }
    layout.endLayout();
}

} // namespace orvo::ToolkitFonts
