#pragma once

#include "platform/uikit/text/TextMeasurer.h"

#include <cstdint>
#include <limits>

namespace orvo {

/// One line as it is drawn.
struct TextLine {
    std::string text;          ///< without the white space at its end; an ellipsis where it was cut
    std::vector<TextRun> runs; ///< of `text`
    std::size_t begin = 0;     ///< where it starts in the whole text, in bytes
    double width = 0;
    FontMetrics metrics; ///< the greatest of its faces
    bool rightToLeft = false;
    bool truncated = false;
};

/// Lines from top to bottom.
struct TextLines {
    std::vector<TextLine> lines;
    double lineSpacing = 0;

    /// Of the widest line.
    [[nodiscard]] double width() const;
    /// Of all lines and the spacing between them.
    [[nodiscard]] double height() const { return height(lines.size()); }
    /// Of the first `count` lines.
    [[nodiscard]] double height(std::size_t count) const;
    /// From the top of the first line.
    [[nodiscard]] double baselineOf(std::size_t line) const;
    [[nodiscard]] bool truncated() const;
};

/// A text that has been measured once and can be broken into lines at any width. Characters that a
/// reader sees as one are never parted (combining marks, emoji); where a line may end is Unicode's
/// rule (UAX #14), with words of languages without spaces found by dictionary.
class TextLayout {
public:
    static constexpr double Unlimited = std::numeric_limits<double>::infinity();
    static constexpr std::size_t AnyNumber = std::numeric_limits<std::size_t>::max();

    struct Request {
        std::string text;          ///< UTF-8; bytes that are not are shown as U+FFFD
        std::vector<TextRun> runs; ///< cover the text; a run for an empty text gives its metrics
        double lineSpacing = 0;
        /// The direction of a paragraph whose text has none of its own.
        bool rightToLeft = false;
        /// Whether a line may end between any two characters.
        bool breaksAnywhere = false;

        friend bool operator==(const Request&, const Request&) = default;
    };

    /// Measures with `TextMeasurer::shared()`.
    explicit TextLayout(Request request);

    [[nodiscard]] const Request& request() const noexcept { return _request; }
    /// Of the face that the text begins with, or ends with.
    [[nodiscard]] FontMetrics metricsAtStart() const;
    [[nodiscard]] FontMetrics metricsAtEnd() const;
    /// The lines at most `width` points wide (a single character may be wider). With more than
    /// `maximum` lines, the last one ends in an ellipsis. An empty text has no lines.
    [[nodiscard]] TextLines lines(double width, std::size_t maximum = AnyNumber) const;

private:
    struct Cluster {
        std::size_t begin;
        double advance;
        bool space; ///< takes no room at the end of a line
        bool mayBreakAfter;
        bool mustBreakAfter;
    };
    struct Paragraph {
        std::size_t firstCluster;
        std::size_t endCluster;
        bool rightToLeft;
    };

    void measureParagraph(std::size_t first, std::size_t end);
    [[nodiscard]] std::size_t lineEnd(std::size_t first, std::size_t end, double width) const;
    [[nodiscard]] TextLine makeLine(std::size_t first, std::size_t end, bool rightToLeft) const;
    [[nodiscard]] TextLine
    cutLine(std::size_t first, std::size_t end, double width, bool rightToLeft) const;
    [[nodiscard]] std::vector<TextRun> emptyRunAt(std::size_t byte) const;

    Request _request;
    std::shared_ptr<TextMeasurer> _measurer;
    std::vector<Cluster> _clusters;
    std::vector<Paragraph> _paragraphs;
};

} // namespace orvo
