#include "platform/feeds/schedule/LineColors.h"

#include "platform/feeds/schedule/ScheduleText.h"

#include <algorithm>
#include <charconv>
#include <cmath>

namespace orvo {

namespace {

constexpr const char* White = "FFFFFF";
constexpr const char* Black = "000000";

double linearPart(std::string_view twoDigits) {
    int value = 0;
    std::from_chars(twoDigits.data(), twoDigits.data() + twoDigits.size(), value, 16);
    const double part = value / 255.0;
    return part <= 0.04045 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4);
}

double luminance(std::string_view color) {
    return 0.2126 * linearPart(color.substr(0, 2)) + 0.7152 * linearPart(color.substr(2, 2)) +
           0.0722 * linearPart(color.substr(4, 2));
}

} // namespace

double contrastRatio(std::string_view a, std::string_view b) {
    const auto [darker, lighter] = std::minmax({luminance(a), luminance(b)});
    return (lighter + 0.05) / (darker + 0.05);
}

LineColors LineColors::mended(std::string_view background, std::string_view text) {
    LineColors colors{ScheduleText::color(background), ScheduleText::color(text)};
    if (colors.background.empty())
        colors.background = White;
    if (colors.text.empty() || contrastRatio(colors.background, colors.text) < LeastContrast)
        colors.text =
            contrastRatio(colors.background, White) >= contrastRatio(colors.background, Black)
                ? White
                : Black;
    return colors;
}

} // namespace orvo
