#include "platform/uikit/text/private/ToolkitFonts.h"

#include <QFontDatabase>
#include <QGuiApplication>
#include <QTextOption>

#include <algorithm>
#include <array>
#include <cmath>

namespace orvo::ToolkitFonts {

namespace {

// Static faces: the toolkit emboldens the bold of the variable font a second time.
struct Face {
    int weight;
    const char* path;
};
constexpr std::array Faces{Face{400, "/usr/share/fonts/opentype/inter/Inter-Regular.otf"},
                           Face{500, "/usr/share/fonts/opentype/inter/Inter-Medium.otf"},
                           Face{600, "/usr/share/fonts/opentype/inter/Inter-SemiBold.otf"},
                           Face{700, "/usr/share/fonts/opentype/inter/Inter-Bold.otf"}};

/// All are loaded when one is first used: whenever a face is added, the toolkit forgets every font
/// that it has opened, and opens it again beside the one that a text still holds.
std::array<QString, Faces.size()> loadedFamilies() {
    std::array<QString, Faces.size()> families;
    std::ranges::transform(Faces, families.begin(), [](const Face& face) {
        const int identifier = QFontDatabase::addApplicationFont(face.path);
        return QFontDatabase::applicationFontFamilies(identifier).value(0, "");
    });
    return families;
}

const QString& familyOf(std::size_t face) {
    static const auto families = loadedFamilies();
    return families.at(face);
}

std::size_t nearestFace(int weight) {
    const auto* const nearest = std::ranges::min_element(
        Faces, {}, [weight](const Face& face) { return std::abs(face.weight - weight); });
    return static_cast<std::size_t>(nearest - Faces.begin());
}

} // namespace

bool areAvailable() {
    return qobject_cast<QGuiApplication*>(QCoreApplication::instance()) != nullptr;
}

QFont fontOf(const FontFace& face) {
    const auto nearest = nearestFace(face.weight);
    QFont font(familyOf(nearest));
    font.setPixelSize(std::max(1, static_cast<int>(std::lround(face.pointSize))));
    font.setWeight(static_cast<QFont::Weight>(Faces.at(nearest).weight));
    // With hinting, advances depend on the scale of the screen and on the machine's settings.
    font.setHintingPreference(QFont::PreferNoHinting);
    return font;
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
