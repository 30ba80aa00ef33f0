#pragma once

#include "platform/uikit/UITraitCollection.h"

#include <string>
#include <string_view>

namespace orvo {

/// How a person has set their desktop up, as far as it concerns looks. A value.
struct DesktopAppearance {
    bool isDark = false;
    bool hasHighContrast = false;
    bool reducesMotion = false;
    /// How large text is, in parts of the usual size.
    double textScale = 1;

    friend bool operator==(const DesktopAppearance&, const DesktopAppearance&) = default;

    /// `traits` with these looks; direction and scale stay as they are.
    [[nodiscard]] UITraitCollection appliedTo(UITraitCollection traits) const;

    /// One line of text, for `fromText`.
    [[nodiscard]] std::string text() const;
    /// What is missing in the text, or cannot be read, is as on a desktop that says nothing.
    [[nodiscard]] static DesktopAppearance fromText(std::string_view text);

    /// What this profile's programs saw last, so that a first frame looks right before anybody was
    /// asked; the usual looks where there is none.
    [[nodiscard]] static DesktopAppearance remembered();
    /// Kept in the profile; what cannot be written is said in the log.
    void remember() const;
};

/// The category whose body text is nearest to that many times the usual size. A scale that is not
/// above 0 is the usual one.
[[nodiscard]] UIContentSizeCategory contentSizeCategoryForTextScale(double scale);

} // namespace orvo
