#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/uikit/text/FontFace.h"

#include <cstddef>
#include <memory>
#include <span>
#include <string>
#include <vector>

namespace orvo {

/// A stretch of a text in one face, in bytes of its UTF-8, half open.
struct TextRun {
    std::size_t begin = 0;
    std::size_t end = 0;
    FontFace face;

    friend bool operator==(const TextRun&, const TextRun&) = default;
};

/// Knows how large text is. Tests bring one with fixed numbers. Main thread.
class TextMeasurer {
public:
    TextMeasurer() = default;
    TextMeasurer(const TextMeasurer&) = delete;
    TextMeasurer& operator=(const TextMeasurer&) = delete;
    virtual ~TextMeasurer() = default;

    [[nodiscard]] virtual FontMetrics metricsOf(const FontFace& face) = 0;
    /// The advance in points of each cluster of `text`, which has no line breaks in it. `clusters`
    /// are the bytes where the characters that a reader sees begin, the first one 0; `runs` cover
    /// the text.
    [[nodiscard]] virtual std::vector<double> advances(const std::string& text,
                                                       std::span<const TextRun> runs,
                                                       std::span<const std::size_t> clusters,
                                                       bool rightToLeft) = 0;

    /// Default: the program's font set (Inter), shaped by the toolkit; without a graphical
    /// application object, or without those fonts, its metrics with the same advance for every
    /// cluster.
    static EnvironmentSlot<std::shared_ptr<TextMeasurer>>& shared();
};

} // namespace orvo
