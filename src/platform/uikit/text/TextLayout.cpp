#include "platform/uikit/text/TextLayout.h"

#include "platform/uikit/text/_TextBreaks.h"

#include <algorithm>

namespace orvo {

namespace {

constexpr const char* Ellipsis = "\u2026";
// Widths are sums of fractions that went through a solver; a line that fits must not wrap for it.
constexpr double Tolerance = 0.01;

/// The runs of `runs` within a stretch, counted from its begin.
std::vector<TextRun>
runsWithin(const std::vector<TextRun>& runs, std::size_t begin, std::size_t end) {
    std::vector<TextRun> within;
    for (const auto& run : runs) {
        const auto from = std::max(run.begin, begin);
        const auto to = std::min(run.end, end);
        if (from < to)
            within.push_back({from - begin, to - begin, run.face});
    }
    return within;
}

FontMetrics greatest(const FontMetrics& a, const FontMetrics& b) {
    return {.ascender = std::max(a.ascender, b.ascender),
            .descender = std::min(a.descender, b.descender),
            .capHeight = std::max(a.capHeight, b.capHeight),
            .leading = std::max(a.leading, b.leading)};
}

} // namespace

double TextLines::width() const {
    double widest = 0;
    for (const auto& line : lines)
        widest = std::max(widest, line.width);
    return widest;
}

double TextLines::height(std::size_t count) const {
    double height = 0;
    for (std::size_t i = 0; i < count; ++i)
        height += lines[i].metrics.lineHeight() + (i > 0 ? lineSpacing : 0);
    return height;
}

double TextLines::baselineOf(std::size_t line) const {
    double top = 0;
    for (std::size_t i = 0; i < line; ++i)
        top += lines[i].metrics.lineHeight() + lineSpacing;
    return top + lines[line].metrics.ascender;
}

bool TextLines::truncated() const {
    return std::ranges::any_of(lines, &TextLine::truncated);
}

TextLayout::TextLayout(Request request)
    : _request(std::move(request))
    , _measurer(TextMeasurer::shared().get()) {
    const auto& text = _request.text;
    const auto breaks = _TextBreaks::of(text);
    auto opportunity = breaks.opportunities.begin();
    for (std::size_t i = 0; i < breaks.clusters.size(); ++i) {
        const auto begin = breaks.clusters[i];
        const auto end = i + 1 < breaks.clusters.size() ? breaks.clusters[i + 1] : text.size();
        while (opportunity != breaks.opportunities.end() && *opportunity < end)
            ++opportunity;
        const bool mayBreak = opportunity != breaks.opportunities.end() && *opportunity == end;
        _clusters.push_back({.begin = begin,
                             .advance = 0,
                             .space = _isSpaceAt(text, begin),
                             .mayBreakAfter = mayBreak || _request.breaksAnywhere,
                             .mustBreakAfter = _isParagraphEndAt(text, begin)});
    }
    for (std::size_t first = 0; first < _clusters.size();) {
        auto end = first;
        while (end < _clusters.size() && !_clusters[end].mustBreakAfter)
            ++end;
        measureParagraph(first, end);
        first = std::min(end + 1, _clusters.size());
    }
}

void TextLayout::measureParagraph(std::size_t first, std::size_t end) {
    const auto byteAt = [this](std::size_t cluster) {
        return cluster < _clusters.size() ? _clusters[cluster].begin : _request.text.size();
    };
    const auto begin = byteAt(first);
    const auto text = _request.text.substr(begin, byteAt(end) - begin);
    const bool rightToLeft =
        _isRightToLeft(_request.text, begin, byteAt(end), _request.rightToLeft);
    _paragraphs.push_back({first, end, rightToLeft});
    if (text.empty())
        return;
    std::vector<std::size_t> starts;
    for (auto i = first; i < end; ++i)
        starts.push_back(_clusters[i].begin - begin);
    const auto runs = runsWithin(_request.runs, begin, byteAt(end));
    const auto advances = _measurer->advances(text, runs, starts, rightToLeft);
    for (auto i = first; i < end; ++i)
        _clusters[i].advance = advances.at(i - first);
}

FontMetrics TextLayout::metricsAtStart() const {
    return _request.runs.empty() ? FontMetrics() : _measurer->metricsOf(_request.runs.front().face);
}

FontMetrics TextLayout::metricsAtEnd() const {
    return _request.runs.empty() ? FontMetrics() : _measurer->metricsOf(_request.runs.back().face);
}

TextLines TextLayout::lines(double width, std::size_t maximum) const {
    TextLines result{.lines = {}, .lineSpacing = _request.lineSpacing};
    for (std::size_t p = 0; p < _paragraphs.size(); ++p) {
        const auto& paragraph = _paragraphs[p];
        auto first = paragraph.firstCluster;
        do {
            if (result.lines.size() == maximum)
                return result;
            const auto end = lineEnd(first, paragraph.endCluster, width);
            const bool textFollows = end < paragraph.endCluster || p + 1 < _paragraphs.size();
            if (result.lines.size() + 1 == maximum && textFollows)
                result.lines.push_back(
                    cutLine(first, paragraph.endCluster, width, paragraph.rightToLeft));
            else
                result.lines.push_back(makeLine(first, end, paragraph.rightToLeft));
            first = end;
        } while (first < paragraph.endCluster);
    }
    return result;
}

/// White space hangs over the edge of its line; a word wider than the line is parted.
std::size_t TextLayout::lineEnd(std::size_t first, std::size_t end, double width) const {
    double x = 0;
    auto lastBreak = first;
    for (auto i = first; i < end; ++i) {
        const auto& cluster = _clusters[i];
        if (!cluster.space && i > first && x + cluster.advance > width + Tolerance)
            return lastBreak > first ? lastBreak : i;
        x += cluster.advance;
        if (cluster.mayBreakAfter)
            lastBreak = i + 1;
    }
    return end;
}

TextLine TextLayout::makeLine(std::size_t first, std::size_t end, bool rightToLeft) const {
    while (end > first && _clusters[end - 1].space)
        --end;
    const auto begin = first < _clusters.size() ? _clusters[first].begin : _request.text.size();
    const auto endByte = end < _clusters.size() ? _clusters[end].begin : _request.text.size();
    TextLine line;
    line.begin = begin;
    line.rightToLeft = rightToLeft;
    if (end > first) {
        line.text = _request.text.substr(begin, endByte - begin);
        line.runs = runsWithin(_request.runs, begin, endByte);
        for (auto i = first; i < end; ++i)
            line.width += _clusters[i].advance;
    }
    if (line.runs.empty())
        line.runs = emptyRunAt(begin);
    for (const auto& run : line.runs)
        line.metrics = greatest(line.metrics, _measurer->metricsOf(run.face));
    return line;
}

TextLine
TextLayout::cutLine(std::size_t first, std::size_t end, double width, bool rightToLeft) const {
    const auto ellipsisWidth = [this](const FontFace& face) {
        const std::string text = Ellipsis;
        const TextRun run{0, text.size(), face};
        const std::size_t start = 0;
        return _measurer->advances(text, {&run, 1}, {&start, 1}, false).at(0);
    };
    auto cut = first;
    for (double x = 0; cut < end && x <= width + Tolerance; ++cut)
        x += _clusters[cut].advance;
    auto line = makeLine(first, cut, rightToLeft);
    auto dots = ellipsisWidth(line.runs.back().face);
    while (cut > first && line.width + dots > width + Tolerance) {
        line = makeLine(first, --cut, rightToLeft);
        dots = ellipsisWidth(line.runs.back().face);
    }
    line.text += Ellipsis;
    line.runs.back().end = line.text.size();
    line.width += dots;
    line.truncated = true;
    return line;
}

std::vector<TextRun> TextLayout::emptyRunAt(std::size_t byte) const {
    const auto run = std::ranges::find_if(_request.runs,
                                          [byte](const TextRun& each) { return byte < each.end; });
    if (run != _request.runs.end())
        return {{0, 0, run->face}};
    return {{0, 0, _request.runs.empty() ? FontFace() : _request.runs.back().face}};
}

} // namespace orvo
