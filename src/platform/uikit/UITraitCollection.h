#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/uikit/UIContentSizeCategory.h"

namespace orvo {

enum class UIUserInterfaceStyle { Light, Dark };
enum class UIAccessibilityContrast { Normal, High };
enum class UIUserInterfaceLayoutDirection { LeftToRight, RightToLeft };

/// What views must know about where they are shown and for whom. A value.
struct UITraitCollection {
    UIUserInterfaceStyle userInterfaceStyle = UIUserInterfaceStyle::Light;
    UIAccessibilityContrast accessibilityContrast = UIAccessibilityContrast::Normal;
    UIUserInterfaceLayoutDirection layoutDirection = UIUserInterfaceLayoutDirection::LeftToRight;
    UIContentSizeCategory preferredContentSizeCategory = UIContentSizeCategory::L;
    /// Pixels a point.
    double displayScale = 1;
    bool reducesMotion = false;

    friend bool operator==(const UITraitCollection&, const UITraitCollection&) = default;

    /// The traits of the main screen, this desktop and this person: what fonts of text styles and
    /// views outside any other root follow. Default: the values above.
    static EnvironmentSlot<UITraitCollection>& system();
    /// Sets the traits of the system for the rest of the process and, when the content size
    /// category is another one, posts `UIContentSizeCategoryDidChangeNotification`. Roots that have
    /// no traits of their own are told by their host (`UIView::_traitsDidChange`). Main thread.
    static void setSystem(const UITraitCollection& traits);
};

} // namespace orvo
