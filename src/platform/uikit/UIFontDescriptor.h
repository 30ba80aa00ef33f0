#pragma once

#include "platform/foundation/NSObject.h"
#include "platform/uikit/UITraitCollection.h"

#include <cstdint>
#include <optional>
#include <string_view>

namespace orvo {

/// What a text is for; its size follows the content size category.
enum class UIFontTextStyle { Headline, Subheadline, Body };

inline constexpr UIFontTextStyle UIFontTextStyleHeadline = UIFontTextStyle::Headline;
inline constexpr UIFontTextStyle UIFontTextStyleSubheadline = UIFontTextStyle::Subheadline;
inline constexpr UIFontTextStyle UIFontTextStyleBody = UIFontTextStyle::Body;

[[nodiscard]] std::string_view nameOf(UIFontTextStyle style);
/// The size of a style in points.
[[nodiscard]] double pointSizeOf(UIFontTextStyle style, UIContentSizeCategory category);

/// Bits of a set of traits.
using UIFontDescriptorSymbolicTraits = std::uint32_t;
inline constexpr UIFontDescriptorSymbolicTraits UIFontDescriptorTraitBold = 2;

/// What a font is asked for by. Immutable. Any thread.
class UIFontDescriptor final : public virtual NSObject {
public:
    /// The descriptor of a style in the content size category of the system.
    [[nodiscard]] static std::shared_ptr<UIFontDescriptor>
    preferredFontDescriptorWithTextStyle(UIFontTextStyle style);
    [[nodiscard]] static std::shared_ptr<UIFontDescriptor>
    preferredFontDescriptorWithTextStyle_compatibleWithTraitCollection(
        UIFontTextStyle style, const UITraitCollection& traits);
    /// A size that follows nothing. `weight` is 400 for regular, 700 for bold.
    [[nodiscard]] static std::shared_ptr<UIFontDescriptor>
    systemFontDescriptorWithSize_weight(double pointSize, int weight);

    /// Nil for a font of a fixed size.
    [[nodiscard]] std::optional<UIFontTextStyle> textStyle() const noexcept { return _textStyle; }
    [[nodiscard]] double pointSize() const noexcept { return _pointSize; }
    [[nodiscard]] UIFontDescriptorSymbolicTraits symbolicTraits() const noexcept { return _traits; }
    /// 400 to 700; the bold trait makes it 700.
    [[nodiscard]] int weight() const noexcept;

    /// The same but for its traits, which are those given. Never nil.
    [[nodiscard]] std::shared_ptr<UIFontDescriptor>
    fontDescriptorWithSymbolicTraits(UIFontDescriptorSymbolicTraits traits) const;

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    std::optional<UIFontTextStyle> _textStyle;
    double _pointSize = 0;
    int _weight = 400;
    UIFontDescriptorSymbolicTraits _traits = 0;
};

} // namespace orvo
