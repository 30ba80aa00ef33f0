#pragma once

#include "platform/mapuikit/KitTableViewCell.h"
#include "viewmodel/OWTransitItem.h"

#include <vector>

namespace orvo {

class ArtworkImageView;
class KitLabel;
class NSLayoutConstraint;
class UIFont;
class UILayoutGuide;
class UIStackView;
class VisualEffectWrappingView;

/// One row: a bold title, a text below it, and the line's shield in a column at the trailing edge
/// that all rows share. The row's height is given, and does not follow the texts: those that do not
/// fit end at a whole line, the lower one first. Main thread.
class OWTransitItemFixedHeightCell : public KitTableViewCell {
public:
    [[nodiscard]] static std::shared_ptr<OWTransitItemFixedHeightCell>
    initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                  std::optional<std::string> reuseIdentifier);

    [[nodiscard]] const std::shared_ptr<KitLabel>& primaryLabel() const noexcept {
        return _primaryLabel;
    }
    [[nodiscard]] const std::shared_ptr<KitLabel>& secondaryLabel() const noexcept {
        return _secondaryLabel;
    }

    /// Nil until set.
    [[nodiscard]] const std::shared_ptr<OWTransitItem>& transitItem() const noexcept {
        return _transitItem;
    }
    /// An equal item does nothing. An item without artwork, or nil, shows no shield.
    virtual void setTransitItem(const std::shared_ptr<OWTransitItem>& item);
    /// In points; 110 until set.
    [[nodiscard]] double rowHeight() const;
    virtual void setRowHeight(double height);
    /// In points; 0 until set.
    [[nodiscard]] double trailingArtworkColumnWidth() const;
    virtual void setTrailingArtworkColumnWidth(double width);

    /// Of the title, in the content size category of the moment.
    [[nodiscard]] virtual std::shared_ptr<UIFont> _primaryFont() const;
    /// Of the text below it.
    [[nodiscard]] virtual std::shared_ptr<UIFont> _secondaryFont() const;
    /// Puts the tops of the title's capitals on the top of the content guide, which centres the
    /// text by what one sees of it. Spelt so; it is registered by this name.
    void _updatePrimaryLabelToContentGuideConstaint();

    [[nodiscard]] Method methodForSelector(const Selector& selector) override;
    [[nodiscard]] std::string className() const override { return "OWTransitItemFixedHeightCell"; }

protected:
    bool _initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                        std::optional<std::string> reuseIdentifier);
    virtual void _createSubviews();
    /// Those to activate, in order. Makes `_stackViewToContentGuideTrailingConstraint` as well,
    /// which waits for an item whose artwork is hidden.
    [[nodiscard]] virtual std::vector<std::shared_ptr<NSLayoutConstraint>> _initialConstraints();

private:
    void _createTexts();
    void _createArtworkViews();
    [[nodiscard]] std::vector<std::shared_ptr<NSLayoutConstraint>> _guideConstraints();
    [[nodiscard]] std::vector<std::shared_ptr<NSLayoutConstraint>> _textConstraints();
    [[nodiscard]] std::vector<std::shared_ptr<NSLayoutConstraint>> _artworkConstraints();
    [[nodiscard]] std::shared_ptr<ArtworkImageView> _artworkImageViewInVibrantImageView() const;
    void _showArtwork();

    std::shared_ptr<UIStackView> _stackView;
    std::shared_ptr<UILayoutGuide> _contentGuide;
    std::shared_ptr<VisualEffectWrappingView> _vibrancyViewForPrimaryLabel;
    std::shared_ptr<VisualEffectWrappingView> _vibrancyViewForSecondaryLabel;
    std::shared_ptr<VisualEffectWrappingView> _vibrantImageView;
    std::shared_ptr<ArtworkImageView> _nonVibrantImageView;
    std::shared_ptr<NSLayoutConstraint> _stackViewToTrailingGuideConstraint;
    std::shared_ptr<NSLayoutConstraint> _stackViewToContentGuideTrailingConstraint;
    std::shared_ptr<UILayoutGuide> _trailingGutterGuide;
    std::shared_ptr<NSLayoutConstraint> _trailingGutterGuideWidthConstraint;
    std::shared_ptr<NSLayoutConstraint> _rowHeightConstraint;
    std::shared_ptr<NSLayoutConstraint> _primaryLabelToContentGuideConstraint;
    std::shared_ptr<KitLabel> _primaryLabel;
    std::shared_ptr<KitLabel> _secondaryLabel;
    std::shared_ptr<OWTransitItem> _transitItem;
};

} // namespace orvo
