#include "platform/mapuikit/KitTableCellFont.h"

namespace orvo::KitTableCellFont {

std::shared_ptr<UIFont>
preferredTableCellFontForTextStyle_traits(UIFontTextStyle style,
                                          UIFontDescriptorSymbolicTraits traits) {
    const auto preferred = UIFontDescriptor::preferredFontDescriptorWithTextStyle(style);
    const auto descriptor =
        traits == 0
            ? preferred
            : preferred->fontDescriptorWithSymbolicTraits(preferred->symbolicTraits() | traits);
    return UIFont::fontWithDescriptor_size(descriptor, 0);
}

} // namespace orvo::KitTableCellFont
