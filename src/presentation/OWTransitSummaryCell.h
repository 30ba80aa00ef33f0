#pragma once

#include "platform/mapuikit/KitTableViewCell.h"
#include "viewmodel/OWTransitSummaryItem.h"

#include <vector>

namespace orvo {

class ArtworkDataSourceCache;
class KitLabel;
class NSLayoutConstraint;
class TransitInfoLabelView;
class UIFont;
class UILayoutGuide;
class UIStackView;
class VisualEffectWrappingView;

/// The compact widget's row for several advisories: a title of one line, and below it the shields
/// of their lines, as many as fit into the title's width, with a count of the rest. The row's
/// height is given. Main thread.
class OWTransitSummaryCell : public KitTableViewCell {
public:
    [[nodiscard]] static std::shared_ptr<OWTransitSummaryCell>
    initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                  std::optional<std::string> reuseIdentifier);

    [[nodiscard]] const std::shared_ptr<KitLabel>& primaryLabel() const noexcept {
        return _primaryLabel;
    }
    [[nodiscard]] const std::shared_ptr<TransitInfoLabelView>& artworksLabel() const noexcept {
        return _artworksLabel;
    }

    /// Nil until set.
    [[nodiscard]] const std::shared_ptr<OWTransitSummaryItem>& item() const noexcept {
        return _item;
    }
    /// An equal item does nothing. Nil empties the row.
    virtual void setItem(const std::shared_ptr<OWTransitSummaryItem>& item);
    /// In points; 110 until set.
    [[nodiscard]] double rowHeight() const;
    virtual void setRowHeight(double height);
    /// Of the row of shields, which alone keeps it.
    [[nodiscard]] std::shared_ptr<ArtworkDataSourceCache> artworkCache() const;
    virtual void setArtworkCache(const std::shared_ptr<ArtworkDataSourceCache>& cache);

    /// Always nil: nothing makes it, since the stack view keeps the shields at their distance.
    [[nodiscard]] const std::shared_ptr<NSLayoutConstraint>&
    primaryToSecondaryLabelConstraint() const noexcept {
        return _primaryToSecondaryLabelConstraint;
    }
    /// Of the title, in the content size category of the moment.
    [[nodiscard]] virtual std::shared_ptr<UIFont> _primaryFont() const;
    /// For a text below the title; this row shows none.
    [[nodiscard]] virtual std::shared_ptr<UIFont> _secondaryFont() const;
    /// Puts the tops of the title's capitals on the top of the content guide. Spelt so; it is
    /// registered by this name.
    void _updatePrimaryLabelToContentGuideConstaint();

    [[nodiscard]] Method methodForSelector(const Selector& selector) override;
    /// Cuts the row of shields to the title's width.
    void layoutSubviews() override;
    /// Of the row as it is once laid out, so that it sees the shields that are left.
    [[nodiscard]] CGSize
    systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
        CGSize target, UILayoutPriority horizontal, UILayoutPriority vertical) override;
    [[nodiscard]] std::string className() const override { return "OWTransitSummaryCell"; }

protected:
    bool _initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                        std::optional<std::string> reuseIdentifier);
    /// Activates the initial constraints as well.
    virtual void _createSubviews();
    /// Those to activate, in order.
    [[nodiscard]] virtual std::vector<std::shared_ptr<NSLayoutConstraint>> _initialConstraints();
    /// Shows the item.
    virtual void _updateLayout();

private:
    void _createTitle();
    void _createShields();

    std::shared_ptr<UIStackView> _stackView;
    std::shared_ptr<UILayoutGuide> _contentGuide;
    std::shared_ptr<VisualEffectWrappingView> _vibrancyViewForPrimaryLabel;
    std::shared_ptr<NSLayoutConstraint> _rowHeightConstraint;
    std::shared_ptr<NSLayoutConstraint> _primaryLabelToContentGuideConstraint;
    std::shared_ptr<NSLayoutConstraint> _primaryToSecondaryLabelConstraint;
    std::shared_ptr<KitLabel> _primaryLabel;
    std::shared_ptr<TransitInfoLabelView> _artworksLabel;
    std::shared_ptr<OWTransitSummaryItem> _item;
};

} // namespace orvo
