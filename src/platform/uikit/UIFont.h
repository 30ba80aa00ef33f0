#pragma once

#include "platform/uikit/UIFontDescriptor.h"
#include "platform/uikit/text/FontFace.h"

namespace orvo {

/// A font at a size. Its metrics, in points, are those of the text measurer in use when it was
/// made. Immutable. Any thread.
class UIFont final : public virtual NSObject {
public:
    /// The font of a style in the content size category of the system.
    [[nodiscard]] static std::shared_ptr<UIFont> preferredFontForTextStyle(UIFontTextStyle style);
    /// `pointSize` 0 keeps the size of the descriptor.
    [[nodiscard]] static std::shared_ptr<UIFont>
    fontWithDescriptor_size(const std::shared_ptr<UIFontDescriptor>& descriptor, double pointSize);
    [[nodiscard]] static std::shared_ptr<UIFont> systemFontOfSize_weight(double pointSize,
                                                                         int weight);

    [[nodiscard]] const std::shared_ptr<UIFontDescriptor>& fontDescriptor() const noexcept {
        return _descriptor;
    }
    [[nodiscard]] double pointSize() const noexcept { return _face.pointSize; }
    /// What the text measurer and the canvas know it by.
    [[nodiscard]] const FontFace& face() const noexcept { return _face; }

    /// Above the baseline, positive.
    [[nodiscard]] double ascender() const noexcept { return _metrics.ascender; }
    /// Below the baseline, negative.
    [[nodiscard]] double descender() const noexcept { return _metrics.descender; }
    [[nodiscard]] double capHeight() const noexcept { return _metrics.capHeight; }
    [[nodiscard]] double leading() const noexcept { return _metrics.leading; }
    /// From one line's top to the next one's.
    [[nodiscard]] double lineHeight() const noexcept { return _metrics.lineHeight(); }

    /// A length that is `value` in the default category, in proportion to how the text style grows
    /// to the content size category of the system. Unchanged for a font without a text style.
    [[nodiscard]] double _scaledValueForValue(double value) const;

    /// By descriptor and size.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    std::shared_ptr<UIFontDescriptor> _descriptor;
    FontFace _face;
    FontMetrics _metrics;
};

} // namespace orvo
