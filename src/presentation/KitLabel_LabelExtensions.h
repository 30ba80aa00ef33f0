#pragma once

#include "platform/mapuikit/KitLabel.h"

#include <memory>

namespace orvo {

class UIFont;

namespace LabelExtensions {

/// A label for text of as many lines as it needs, wrapped at words, to be placed by constraints.
[[nodiscard]] std::shared_ptr<KitLabel> multiLineLabelWithFont(const std::shared_ptr<UIFont>& font);

/// Points between lines, as the paragraph style of the text's beginning says; 0 for an empty text,
/// or one without a style.
[[nodiscard]] double _orvo_lineSpacing(const KitLabel& label);
/// Of the whole text, which takes the paragraph style of its beginning. Nothing for an empty text,
/// or where it is so already.
void _orvo_setLineSpacing(KitLabel& label, double lineSpacing);

} // namespace LabelExtensions

} // namespace orvo
