#include "presentation/OWTransitSummaryCell.h"

#include "platform/mapuikit/KitLabel.h"
#include "platform/mapuikit/KitTableCellFont.h"
#include "platform/mapuikit/TransitInfoLabelView.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIGeometry.h"
#include "platform/uikit/UIStackView.h"
#include "presentation/DynamicTypeWizard.h"
#include "presentation/VisualEffectWrappingView.h"
#include "viewmodel/WidgetTexts.h"

#include <utility>

namespace orvo {

namespace {

using Cell = OWTransitSummaryCell;
using Constraints = std::vector<std::shared_ptr<NSLayoutConstraint>>;

constexpr double DefaultRowHeight = 110;
// From the title's baseline to that of the shields, in every text size: these do not grow with it.
constexpr double BaselineSpacing = 35;
constexpr std::int64_t ShieldSize = 7;
constexpr double ShieldSpacing = 5;

constexpr std::int64_t PrimaryVibrancy = 101;

constexpr const char* UpdateSelector = "_updatePrimaryLabelToContentGuideConstaint";
constexpr std::uint64_t AfterNewFonts = 1;

std::string textForLeftOutShields(std::uint64_t count) {
    return WidgetTexts::localized("Transit_Incident_Not_Displayed_Incidents", {count});
}

} // namespace

std::shared_ptr<Cell>
Cell::initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                    std::optional<std::string> reuseIdentifier) {
    auto cell = std::make_shared<Cell>();
    return cell->_initWithStyle_reuseIdentifier(style, std::move(reuseIdentifier)) ? cell : nullptr;
}

bool Cell::_initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                          std::optional<std::string> reuseIdentifier) {
    if (!KitTableViewCell::_initWithStyle_reuseIdentifier(style, std::move(reuseIdentifier)))
        return false;
    _createSubviews();
    return true;
}

std::shared_ptr<UIFont> Cell::_primaryFont() const {
    return KitTableCellFont::preferredTableCellFontForTextStyle_traits(UIFontTextStyleHeadline, 0);
}

std::shared_ptr<UIFont> Cell::_secondaryFont() const {
    return KitTableCellFont::preferredTableCellFontForTextStyle_traits(UIFontTextStyleBody, 0);
}

// Creation

void Cell::_createSubviews() {
    // The cell's own, not the content view's.
    _contentGuide = UILayoutGuide::init();
    _contentGuide->setIdentifier("contentGuide");
    addLayoutGuide(_contentGuide);
    _stackView = UIStackView::initWithFrame({});
    _stackView->setIdentifier("stackView");
    _stackView->setTranslatesAutoresizingMaskIntoConstraints(false);
    _stackView->setAxis(UILayoutConstraintAxis::Vertical);
    _stackView->setBaselineRelativeArrangement(true);
    _stackView->setSpacing(BaselineSpacing);
    _stackView->setDistribution(UIStackViewDistribution::Fill);
    _stackView->setAlignment(UIStackViewAlignment::Fill);
    contentView()->addSubview(_stackView);
    _createTitle();
    _createShields();
    NSLayoutConstraint::activateConstraints(_initialConstraints());
}

void Cell::_createTitle() {
    _vibrancyViewForPrimaryLabel = VisualEffectWrappingView::initWithEffect(
        UIVibrancyEffect::widgetEffectForVibrancyStyle(PrimaryVibrancy));
    _vibrancyViewForPrimaryLabel->setIdentifier("vibrancyViewForPrimaryLabel");
    _vibrancyViewForPrimaryLabel->setTranslatesAutoresizingMaskIntoConstraints(false);
    _stackView->addArrangedSubview(_vibrancyViewForPrimaryLabel);
    _primaryLabel = KitLabel::initWithFrame({});
    _primaryLabel->setIdentifier("primaryLabel");
    _primaryLabel->setTranslatesAutoresizingMaskIntoConstraints(false);
    _primaryLabel->setNumberOfLines(1);
    DynamicTypeWizard::autorefreshLabel_withFontProvider(
        _primaryLabel, [weakCell = std::weak_ptr<Cell>(strong(this))]() -> std::shared_ptr<UIFont> {
            const auto strongCell = weakCell.lock();
            return strongCell ? strongCell->_primaryFont() : nullptr;
        });
    _vibrancyViewForPrimaryLabel->setWrappedView(_primaryLabel);
}

/// Outside any vibrancy: shields keep the colours of their lines.
void Cell::_createShields() {
    _artworksLabel =
        TransitInfoLabelView::initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
            nullptr, ShieldSize, ShieldSize, ShieldSpacing, TransitInfoLabelViewNoMaximumWidth);
    _artworksLabel->setIdentifier("artworksLabel");
    _artworksLabel->setTranslatesAutoresizingMaskIntoConstraints(false);
    // Of the text size of now, for good: the count never grows above the shields beside it.
    _artworksLabel->setFont(UIFont::preferredFontForTextStyle(UIFontTextStyleBody));
    _artworksLabel->setNumberOfLines(1);
    _artworksLabel->setTextColor(UIColor::systemGrayColor());
    _stackView->addArrangedSubview(_artworksLabel);
}

Constraints Cell::_initialConstraints() {
    const auto& content = contentView();
    _rowHeightConstraint = content->heightAnchor().constraintEqualToConstant(DefaultRowHeight);
    _rowHeightConstraint->setIdentifier("rowHeight");
    _primaryLabelToContentGuideConstraint =
        _stackView->firstBaselineAnchor().constraintEqualToAnchor(_contentGuide->topAnchor());
    _primaryLabelToContentGuideConstraint->setIdentifier("primaryLabelToContentGuide");
    _updatePrimaryLabelToContentGuideConstaint();
    DynamicTypeWizard::makeObject_performSelector_whenSizeCategoryChangesWithOrder(
        strong(this), Selector(UpdateSelector), AfterNewFonts);
    return {
        _rowHeightConstraint,
        _contentGuide->centerYAnchor().constraintEqualToAnchor(content->centerYAnchor()),
        _contentGuide->leadingAnchor().constraintEqualToAnchor(content->leadingAnchor()),
        _contentGuide->trailingAnchor().constraintEqualToAnchor(content->trailingAnchor()),
        _contentGuide->topAnchor().constraintGreaterThanOrEqualToAnchor(content->topAnchor()),
        _contentGuide->bottomAnchor().constraintLessThanOrEqualToAnchor(content->bottomAnchor()),
        _primaryLabelToContentGuideConstraint,
        // To the shields' bottom, which is what one sees; a title alone ends at its descenders.
        _contentGuide->bottomAnchor().constraintEqualToAnchor(_stackView->bottomAnchor()),
        _stackView->leadingAnchor().constraintEqualToAnchor(_contentGuide->leadingAnchor()),
        _stackView->trailingAnchor().constraintEqualToAnchor(_contentGuide->trailingAnchor()),
    };
}

void Cell::_updatePrimaryLabelToContentGuideConstaint() {
    const auto& font = _primaryLabel->font();
    _primaryLabelToContentGuideConstraint->setConstant(
        UIRoundToViewScale(font ? font->capHeight() : 0, this));
}

NSObject::Method Cell::methodForSelector(const Selector& selector) {
    if (selector == Selector(UpdateSelector))
        return [this](const std::shared_ptr<NSObject>&) {
            _updatePrimaryLabelToContentGuideConstaint();
            return nullptr;
        };
    return KitTableViewCell::methodForSelector(selector);
}

// Content

void Cell::setItem(const std::shared_ptr<OWTransitSummaryItem>& item) {
    if (equal(_item, item))
        return;
    _item = item;
    _updateLayout();
}

void Cell::_updateLayout() {
    _primaryLabel->setText(_item ? _item->primaryText() : std::nullopt);
    _artworksLabel->setLabelItems(_item ? _item->artworks() : nullptr);
    const auto& shields = _artworksLabel->labelItems();
    _artworksLabel->setHidden(!shields || shields->count() == 0);
}

double Cell::rowHeight() const {
    return _rowHeightConstraint->constant();
}

void Cell::setRowHeight(double height) {
    _rowHeightConstraint->setConstant(height);
}

std::shared_ptr<ArtworkDataSourceCache> Cell::artworkCache() const {
    return _artworksLabel->artworkCache();
}

void Cell::setArtworkCache(const std::shared_ptr<ArtworkDataSourceCache>& cache) {
    _artworksLabel->setArtworkCache(cache);
}

// Layout

void Cell::layoutSubviews() {
    KitTableViewCell::layoutSubviews();
    // The title is as wide as it is going to be only after this.
    contentView()->layoutIfNeeded();
    _artworksLabel->setMaxWidth_textForTruncationGenerator(_primaryLabel->frame().size.width,
                                                           textForLeftOutShields);
}

CGSize Cell::systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
    CGSize target, UILayoutPriority horizontal, UILayoutPriority vertical) {
    layoutIfNeeded();
    return KitTableViewCell::
        systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
            target, horizontal, vertical);
}

} // namespace orvo
