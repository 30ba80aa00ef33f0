#pragma once

#include <array>
#include <optional>
#include <string_view>

namespace orvo {

/// The text size that the person prefers, from the smallest to the largest. `L` is the default.
enum class UIContentSizeCategory { XS, S, M, L, XL, XXL, XXXL, AX1, AX2, AX3, AX4, AX5 };

inline constexpr std::array AllContentSizeCategories{UIContentSizeCategory::XS,
                                                     UIContentSizeCategory::S,
                                                     UIContentSizeCategory::M,
                                                     UIContentSizeCategory::L,
                                                     UIContentSizeCategory::XL,
                                                     UIContentSizeCategory::XXL,
                                                     UIContentSizeCategory::XXXL,
                                                     UIContentSizeCategory::AX1,
                                                     UIContentSizeCategory::AX2,
                                                     UIContentSizeCategory::AX3,
                                                     UIContentSizeCategory::AX4,
                                                     UIContentSizeCategory::AX5};

/// Posted to the default notification centre, on the main thread, when the category of the system
/// has changed.
inline constexpr const char* UIContentSizeCategoryDidChangeNotification =
    "UIContentSizeCategoryDidChangeNotification";

/// `XS` to `AX5`.
[[nodiscard]] std::string_view nameOf(UIContentSizeCategory category);
/// The category of that name; nil for any other text.
[[nodiscard]] std::optional<UIContentSizeCategory> contentSizeCategoryNamed(std::string_view name);

} // namespace orvo
