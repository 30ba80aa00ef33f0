#include "platform/uikit/text/ToolkitTextMeasurer.h"

#include "platform/uikit/text/private/ToolkitFonts.h"

#include <QFontMetricsF>

#include <algorithm>
#include <optional>

namespace orvo {

namespace {

// Of the program's font, as parts of its size: what holds where nothing can be shaped.
constexpr FontMetrics PlainMetrics{
    .ascender = 0.96875, .descender = -0.2415, .capHeight = 0.7273, .leading = 0};
constexpr double PlainAdvance = 0.56;

FontMetrics plainMetrics(double pointSize) {
    return {.ascender = PlainMetrics.ascender * pointSize,
            .descender = PlainMetrics.descender * pointSize,
            .capHeight = PlainMetrics.capHeight * pointSize,
            .leading = 0};
}

std::vector<double> uniformAdvances(std::span<const TextRun> runs,
                                    std::span<const std::size_t> clusters) {
    std::vector<double> advances;
    advances.reserve(clusters.size());
    std::size_t run = 0;
    for (const auto cluster : clusters) {
        while (run + 1 < runs.size() && cluster >= runs[run].end)
            ++run;
        advances.push_back(runs.empty() ? 0 : PlainAdvance * runs[run].face.pointSize);
    }
    return advances;
}

/// Where each cluster begins, and at last the end, in the units of the toolkit's strings.
std::vector<int> utf16Positions(const std::string& text, std::span<const std::size_t> clusters) {
    std::vector<int> positions;
    positions.reserve(clusters.size() + 1);
    int position = 0;
    for (std::size_t i = 0; i < clusters.size(); ++i) {
        positions.push_back(position);
        const auto end = i + 1 < clusters.size() ? clusters[i + 1] : text.size();
        position += static_cast<int>(
            QString::fromUtf8(text.data() + clusters[i], static_cast<qsizetype>(end - clusters[i]))
                .size());
    }
    positions.push_back(position);
    return positions;
}

bool hasTwoDirections(const QString& text) {
    return std::ranges::any_of(text, [](QChar character) {
        switch (character.direction()) {
        case QChar::DirR:
        case QChar::DirAL:
        case QChar::DirAN:
            return true;
        default: // characters beyond the first plane come in halves, which have no direction
            return character.isSurrogate();
        }
    });
}

std::vector<double> orderedAdvances(const QTextLine& line, const std::vector<int>& positions) {
    std::vector<double> advances;
    advances.reserve(positions.size() - 1);
    double left = 0;
    for (std::size_t i = 1; i < positions.size(); ++i) {
        const double right = line.cursorToX(positions[i]);
        advances.push_back(right - left);
        left = right;
    }
    return advances;
}

/// Each cluster reaches from its left edge to that of the next one as they stand on the line,
/// whatever their order in the text. Clusters that share a glyph share its width.
std::vector<double> visualAdvances(const QTextLayout& layout, const std::vector<int>& positions) {
    std::map<double, std::vector<std::size_t>> byLeft;
    std::vector<double> advances(positions.size() - 1);
    for (std::size_t i = 0; i < advances.size(); ++i) {
        std::optional<double> left;
        for (const auto& run : layout.glyphRuns(positions[i], positions[i + 1] - positions[i])) {
            for (const auto& position : run.positions())
                left = std::min(left.value_or(position.x()), position.x());
        }
        if (left)
            byLeft[*left].push_back(i);
    }
    const auto line = layout.lineAt(0);
    double right = line.horizontalAdvance();
    for (auto at = byLeft.rbegin(); at != byLeft.rend(); ++at) {
        const auto& [left, sharing] = *at;
        for (const auto cluster : sharing)
            advances[cluster] = (right - left) / static_cast<double>(sharing.size());
        right = left;
    }
    return advances;
}

} // namespace

FontMetrics ToolkitTextMeasurer::metricsOf(const FontFace& face) {
    if (!ToolkitFonts::areAvailable())
        return plainMetrics(face.pointSize);
    const auto known = _metrics.find(face);
    if (known != _metrics.end())
        return known->second;
    const QFontMetricsF metrics(ToolkitFonts::fontOf(face));
    const FontMetrics measured{.ascender = metrics.ascent(),
                               .descender = -metrics.descent(),
                               .capHeight = metrics.capHeight(),
                               .leading = metrics.leading()};
    _metrics.emplace(face, measured);
    return measured;
}

std::vector<double> ToolkitTextMeasurer::advances(const std::string& text,
                                                  std::span<const TextRun> runs,
                                                  std::span<const std::size_t> clusters,
                                                  bool rightToLeft) {
    if (!ToolkitFonts::areAvailable())
        return uniformAdvances(runs, clusters);
    QTextLayout layout;
    ToolkitFonts::layOut(layout, text, runs, rightToLeft);
    if (layout.lineCount() == 0)
        return std::vector<double>(clusters.size());
    const auto line = layout.lineAt(0);
    const auto positions = utf16Positions(text, clusters);
    // Where reading goes from right to left even signs and numbers stand in another order.
    return rightToLeft || hasTwoDirections(layout.text()) ? visualAdvances(layout, positions)
                                                          : orderedAdvances(line, positions);
}

} // namespace orvo
