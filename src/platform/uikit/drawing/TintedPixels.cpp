#include "platform/uikit/drawing/TintedPixels.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace orvo::TintedPixels {

namespace {

constexpr std::size_t Steps = 32;
constexpr double LeastContrast = 0.1; // less is shading, nothing to cut out
constexpr double CutOut = 0.9;

struct Channels {
    double alpha;
    double red;
    double green;
    double blue;
};

Channels channelsOf(std::uint32_t pixel) {
    const auto part = [pixel](unsigned shift) {
        return static_cast<double>((pixel >> shift) & 0xFFU) / 255;
    };
    return {part(24), part(16), part(8), part(0)};
}

/// 0 for black to 1 for white, of the colour without its transparency.
double brightness(const Channels& pixel) {
    if (pixel.alpha <= 0)
        return 0;
    return (0.299 * pixel.red + 0.587 * pixel.green + 0.114 * pixel.blue) / pixel.alpha;
}

std::size_t stepOf(double brightness) {
    return std::min(Steps - 1, static_cast<std::size_t>(brightness * Steps));
}

/// The brightness that most of the picture has, in steps.
double usualBrightness(std::span<const std::uint32_t> pixels) {
    std::array<double, Steps> weights{};
    for (const auto pixel : pixels) {
        const auto channels = channelsOf(pixel);
        weights.at(stepOf(brightness(channels))) += channels.alpha;
    }
    const auto* const most = std::ranges::max_element(weights);
    return (static_cast<double>(most - weights.begin()) + 0.5) / Steps;
}

std::uint32_t premultiplied(RGBA tint, double alpha) {
    const double strength = alpha * tint.alpha / 255;
    const auto channel = [strength](std::uint8_t value) {
        return static_cast<std::uint32_t>(std::lround(value * strength));
    };
    return static_cast<std::uint32_t>(std::lround(strength * 255)) << 24 | channel(tint.red) << 16 |
           channel(tint.green) << 8 | channel(tint.blue);
}

} // namespace

std::vector<std::uint32_t> of(std::span<const std::uint32_t> pixels, RGBA tint) {
    const double usual = usualBrightness(pixels);
    double furthest = 0;
    for (const auto pixel : pixels) {
        const auto channels = channelsOf(pixel);
        if (channels.alpha > 0.5)
            furthest = std::max(furthest, std::abs(brightness(channels) - usual));
    }
    std::vector<std::uint32_t> tinted;
    tinted.reserve(pixels.size());
    for (const auto pixel : pixels) {
        const auto channels = channelsOf(pixel);
        const double away = furthest < LeastContrast
                                ? 0
                                : std::min(1.0, std::abs(brightness(channels) - usual) / furthest);
        tinted.push_back(premultiplied(tint, channels.alpha * (1 - CutOut * away)));
    }
    return tinted;
}

} // namespace orvo::TintedPixels
