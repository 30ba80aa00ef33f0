#pragma once

#include "platform/uikit/UIFont.h"

/// The fonts of the kit's table cells.
namespace orvo::KitTableCellFont {

/// The font of a text style in the content size category of the system, with `traits` added to
/// those that the style has. Never nil. Any thread.
[[nodiscard]] std::shared_ptr<UIFont>
preferredTableCellFontForTextStyle_traits(UIFontTextStyle style,
                                          UIFontDescriptorSymbolicTraits traits);

} // namespace orvo::KitTableCellFont
