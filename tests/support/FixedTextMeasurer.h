#pragma once

#include "platform/uikit/text/TextMeasurer.h"

namespace orvo::testing {

/// Text of fixed numbers: a line is as high as its font's size, 0.8 of it above the baseline,
/// capitals 0.7 of it, and every character, whatever it is, half as wide. Bold ones are no wider.
class FixedTextMeasurer final : public TextMeasurer {
public:
    static constexpr double Advance = 0.5;

    FontMetrics metricsOf(const FontFace& face) override {
        return {.ascender = 0.8 * face.pointSize,
                .descender = -0.2 * face.pointSize,
                .capHeight = 0.7 * face.pointSize,
                .leading = 0};
    }

    std::vector<double> advances(const std::string&,
                                 std::span<const TextRun> runs,
                                 std::span<const std::size_t> clusters,
                                 bool) override {
        std::vector<double> advances;
        std::size_t run = 0;
        for (const auto cluster : clusters) {
            while (run + 1 < runs.size() && cluster >= runs[run].end)
                ++run;
            advances.push_back(runs.empty() ? 0 : Advance * runs[run].face.pointSize);
        }
        ++measured;
        return advances;
    }

    /// How many paragraphs were measured.
    std::size_t measured = 0;
};

} // namespace orvo::testing
