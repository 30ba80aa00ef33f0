#include "platform/settings/DesktopAppearance.h"

#include "platform/foundation/Log.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/NSUserDefaults.h"
#include "platform/uikit/UIFontDescriptor.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <fmt/format.h>

namespace orvo {

namespace {

constexpr const char* SuiteName = "com.zentu.Orvo.WidgetHost";
constexpr const char* Key = "DesktopAppearance";
constexpr std::string_view Dark = "dark";
constexpr std::string_view HighContrast = "contrast";
constexpr std::string_view ReducedMotion = "still";

double bodySize(UIContentSizeCategory category) {
    return pointSizeOf(UIFontTextStyleBody, category);
}

} // namespace

UIContentSizeCategory contentSizeCategoryForTextScale(double scale) {
    if (!(scale > 0))
        return UIContentSizeCategory::L;
    const double wanted = scale * bodySize(UIContentSizeCategory::L);
    return *std::ranges::min_element(
        AllContentSizeCategories, {}, [wanted](UIContentSizeCategory category) {
            return std::abs(bodySize(category) - wanted);
        });
}

UITraitCollection DesktopAppearance::appliedTo(UITraitCollection traits) const {
    traits.userInterfaceStyle = isDark ? UIUserInterfaceStyle::Dark : UIUserInterfaceStyle::Light;
    traits.accessibilityContrast =
        hasHighContrast ? UIAccessibilityContrast::High : UIAccessibilityContrast::Normal;
    traits.reducesMotion = reducesMotion;
    traits.preferredContentSizeCategory = contentSizeCategoryForTextScale(textScale);
    return traits;
}

std::string DesktopAppearance::text() const {
    return fmt::format("{}{}{}{}",
                       textScale,
                       isDark ? " dark" : "",
                       hasHighContrast ? " contrast" : "",
                       reducesMotion ? " still" : "");
}

DesktopAppearance DesktopAppearance::fromText(std::string_view text) {
    DesktopAppearance appearance;
    while (!text.empty()) {
        const auto end = std::min(text.find(' '), text.size());
        const auto word = text.substr(0, end);
        text.remove_prefix(std::min(end + 1, text.size()));
        double scale = 0;
        if (word == Dark)
            appearance.isDark = true;
        else if (word == HighContrast)
            appearance.hasHighContrast = true;
        else if (word == ReducedMotion)
            appearance.reducesMotion = true;
        else if (std::from_chars(word.data(), word.data() + word.size(), scale).ec == std::errc() &&
                 std::isfinite(scale) && scale > 0)
            appearance.textScale = scale;
    }
    return appearance;
}

DesktopAppearance DesktopAppearance::remembered() {
    return fromText(
        NSUserDefaults::initWithSuiteName(SuiteName)->stringForKey(Key).value_or(std::string()));
}

void DesktopAppearance::remember() const {
    const auto error = NSUserDefaults::initWithSuiteName(SuiteName)->setObject_forKey(
        NSString::string(text()), Key);
    if (error)
        Log::findOrCreate("DesktopSettings")->error("%@", error);
}

} // namespace orvo
