#pragma once

#include "platform/uikit/text/TextMeasurer.h"

#include <map>

namespace orvo {

/// Measures with the program's font set, shaped by the toolkit, and the system's fonts for what
/// that set has no glyphs of. Sizes are rounded to whole points.
class ToolkitTextMeasurer final : public TextMeasurer {
public:
    [[nodiscard]] FontMetrics metricsOf(const FontFace& face) override;
    [[nodiscard]] std::vector<double> advances(const std::string& text,
                                               std::span<const TextRun> runs,
                                               std::span<const std::size_t> clusters,
                                               bool rightToLeft) override;

private:
    std::map<FontFace, FontMetrics> _metrics;
};

} // namespace orvo
