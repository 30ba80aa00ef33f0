#include "platform/uikit/UIContentSizeCategory.h"

#include <algorithm>

namespace orvo {

namespace {

constexpr std::array<std::string_view, AllContentSizeCategories.size()> Names{
    "XS", "S", "M", "L", "XL", "XXL", "XXXL", "AX1", "AX2", "AX3", "AX4", "AX5"};

} // namespace

std::string_view nameOf(UIContentSizeCategory category) {
    return Names.at(static_cast<std::size_t>(category));
}

std::optional<UIContentSizeCategory> contentSizeCategoryNamed(std::string_view name) {
    const auto* const found = std::ranges::find(Names, name);
    if (found == Names.end())
        return std::nullopt;
    return AllContentSizeCategories.at(static_cast<std::size_t>(found - Names.begin()));
}

} // namespace orvo
