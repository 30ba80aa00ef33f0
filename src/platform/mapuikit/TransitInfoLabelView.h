#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/mapuikit/ArtworkDataSourceCache.h"
#include "platform/mapuikit/_ShieldRow.h"
#include "platform/uikit/UIView.h"
#include "platform/uikit/text/TextLayout.h"

#include <functional>
#include <limits>

namespace orvo {

class UIColor;
class UIFont;

/// As wide as the shields need.
inline constexpr CGFloat TransitInfoLabelViewNoMaximumWidth = std::numeric_limits<CGFloat>::max();

/// A row of line shields that is cut to a width, with a text for those left out. Its baseline is
/// that of the text, in which the shields stand centred on the height of capitals, whether there is
/// a text or not; the text is set no larger than fits the height of the shields, so that the row is
/// as high with it as without. Main thread.
class TransitInfoLabelView : public UIView {
public:
    /// Given the number of shields left out, above 0, answers the text in their place; nil or empty
    /// leaves the place empty.
    using TruncationGenerator = std::function<std::optional<std::string>(std::uint64_t leftOut)>;

    /// `labelItems`: `TransitArtworkDataSource`s; nil is none. `iconSize` and `shieldSize` 0 to 7.
    /// Lengths in points; `maxWidth` may be `TransitInfoLabelViewNoMaximumWidth`.
    [[nodiscard]] static std::shared_ptr<TransitInfoLabelView>
    initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
        std::shared_ptr<NSArray> labelItems,
        std::int64_t iconSize,
        std::int64_t shieldSize,
        CGFloat spaceBetweenShields,
        CGFloat maxWidth);

    [[nodiscard]] const std::shared_ptr<NSArray>& labelItems() const noexcept {
        return _labelItems;
    }
    /// @throws NSInvalidArgumentException when an element is of another class
    virtual void setLabelItems(std::shared_ptr<NSArray> items);
    [[nodiscard]] std::int64_t iconSize() const noexcept { return _iconSize; }
    [[nodiscard]] std::int64_t shieldSize() const noexcept { return _shieldSize; }
    [[nodiscard]] CGFloat spaceBetweenShields() const noexcept { return _space; }
    /// Draws and keeps the pictures. Nil shows nothing.
    [[nodiscard]] const std::shared_ptr<ArtworkDataSourceCache>& artworkCache() const noexcept {
        return _artworkCache;
    }
    virtual void setArtworkCache(std::shared_ptr<ArtworkDataSourceCache> cache);
    /// Nil is the system's body font.
    [[nodiscard]] const std::shared_ptr<UIFont>& font() const noexcept { return _font; }
    void setFont(std::shared_ptr<UIFont> font);
    [[nodiscard]] const std::shared_ptr<UIColor>& textColor() const noexcept { return _textColor; }
    void setTextColor(std::shared_ptr<UIColor> color);
    /// How many rows there may be; 0 for as many as the shields need. Default: 1.
    [[nodiscard]] std::int64_t numberOfLines() const noexcept { return _numberOfLines; }
    void setNumberOfLines(std::int64_t lines);
    [[nodiscard]] CGFloat maxWidth() const noexcept { return _maxWidth; }
    /// Cuts the row to `width`. The generator may be empty. Where the row comes out as before,
    /// nothing is laid out or drawn again.
    virtual void setMaxWidth_textForTruncationGenerator(CGFloat width,
                                                        TruncationGenerator generator);

    /// How many shields are shown, and the text for the others; nil while there is none.
    [[nodiscard]] std::size_t _shownShields() const;
    [[nodiscard]] std::optional<std::string> _truncationText() const;
    /// The font that the text is set in: that of the label, or as much of it as the shields are
    /// high.
    [[nodiscard]] std::shared_ptr<UIFont> _textFont() const;

    [[nodiscard]] CGSize intrinsicContentSize() const override;
    [[nodiscard]] std::optional<CGFloat> _firstBaselineFromTop() const override;
    [[nodiscard]] CGFloat _lastBaselineFromBottom() const override;
    void drawRect(Canvas& canvas) override;
    void traitCollectionDidChange(const UITraitCollection& previous) override;
    /// Where none was set: what is spoken for the shields that are shown, and the text.
    [[nodiscard]] std::optional<std::string> accessibilityLabel() const override;
    /// The shields that are shown, then the text for the others.
    [[nodiscard]] std::string _dumpedContent() const override;
    [[nodiscard]] std::string className() const override { return "TransitInfoLabelView"; }

private:
    using Artwork = TransitArtworkDataSource;
    struct Text {
        std::string string;
        std::shared_ptr<const TextLayout> layout;
        CGFloat width = 0;
    };

    bool _initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
        std::shared_ptr<NSArray> labelItems,
        std::int64_t iconSize,
        std::int64_t shieldSize,
        CGFloat spaceBetweenShields,
        CGFloat maxWidth);
    [[nodiscard]] std::shared_ptr<UIImage> pictureOf(const std::shared_ptr<Artwork>& artwork) const;
    [[nodiscard]] CGFloat lineHeight() const;
    [[nodiscard]] CGFloat baselineInLine() const;
    [[nodiscard]] const _ShieldRow& row() const;
    [[nodiscard]] CGSize sizeOf(std::size_t index) const;
    [[nodiscard]] CGFloat textWidthFor(std::size_t leftOut) const;
    [[nodiscard]] std::shared_ptr<const Text> measured(const std::string& string) const;
    [[nodiscard]] _ShieldRow arranged() const;
    void contentChanged();
    void forgetMeasures();
    void drawText(Canvas& canvas, const CGRect& place) const;

    std::shared_ptr<NSArray> _labelItems;
    std::vector<std::shared_ptr<Artwork>> _artworks;
    std::int64_t _iconSize = 0;
    std::int64_t _shieldSize = 0;
    CGFloat _space = 0;
    CGFloat _maxWidth = TransitInfoLabelViewNoMaximumWidth;
    std::int64_t _numberOfLines = 1;
    TruncationGenerator _generator;
    std::shared_ptr<ArtworkDataSourceCache> _artworkCache;
    std::shared_ptr<UIFont> _font;
    std::shared_ptr<UIColor> _textColor;
    mutable std::vector<std::optional<CGSize>> _sizes;       ///< of the pictures, as far as known
    mutable std::vector<std::shared_ptr<const Text>> _texts; ///< measured lately
    mutable std::shared_ptr<const Text> _text;               ///< of the row, or tried for it last
    mutable std::optional<_ShieldRow> _row;
};

} // namespace orvo
