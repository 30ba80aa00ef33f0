#include "presentation/OWTransitItemFixedHeightCell.h"

#include "platform/mapuikit/ArtworkImageView.h"
#include "platform/mapuikit/KitLabel.h"
#include "platform/mapuikit/KitTableCellFont.h"
#include "platform/uikit/UIGeometry.h"
#include "platform/uikit/UIStackView.h"
#include "presentation/DynamicTypeWizard.h"
#include "presentation/VisualEffectWrappingView.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace orvo {

namespace {

using Cell = OWTransitItemFixedHeightCell;
using Constraints = std::vector<std::shared_ptr<NSLayoutConstraint>>;

constexpr double DefaultRowHeight = 110;
// From the title's last baseline to the first one below it, in the default text size.
constexpr double BaselineSpacing = 21;
// Between the artwork and the row's edges, at least.
constexpr double ArtworkMargin = 8;

constexpr std::int64_t PrimaryVibrancy = 101;
constexpr std::int64_t SecondaryVibrancy = 102;

// Both below what says where the title stands: in a row that is too low for them the text below the
// title gives way first, then the title itself.
constexpr UILayoutPriority PrimaryTextResistance = 749;
constexpr UILayoutPriority SecondaryTextResistance = 748;

constexpr const char* UpdateSelector = "_updatePrimaryLabelToContentGuideConstaint";
constexpr std::uint64_t AfterNewFonts = 1;

/// Does not keep the cell alive; nil after it.
FontProvider provider(const std::shared_ptr<Cell>& cell,
                      std::shared_ptr<UIFont> (Cell::*font)() const) {
    return [weakCell = std::weak_ptr<Cell>(cell), font]() -> std::shared_ptr<UIFont> {
        const auto strongCell = weakCell.lock();
        return strongCell ? (strongCell.get()->*font)() : nullptr;
    };
}

std::shared_ptr<VisualEffectWrappingView> vibrancyView(std::int64_t style) {
    auto view = VisualEffectWrappingView::initWithEffect(
        UIVibrancyEffect::widgetEffectForVibrancyStyle(style));
    view->setTranslatesAutoresizingMaskIntoConstraints(false);
    return view;
}

std::shared_ptr<KitLabel> textLabel(const char* name, UILayoutPriority resistance) {
    auto label = KitLabel::initWithFrame({});
    label->setIdentifier(name);
    label->setTranslatesAutoresizingMaskIntoConstraints(false);
    label->setNumberOfLines(0);
    label->setContentCompressionResistancePriority_forAxis(resistance,
                                                           UILayoutConstraintAxis::Vertical);
    return label;
}

void append(Constraints& all, const Constraints& more) {
    std::ranges::copy(more, std::back_inserter(all));
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
    NSLayoutConstraint::activateConstraints(_initialConstraints());
    return true;
}

std::shared_ptr<UIFont> Cell::_primaryFont() const {
    return KitTableCellFont::preferredTableCellFontForTextStyle_traits(UIFontTextStyleHeadline,
                                                                       UIFontDescriptorTraitBold);
}

std::shared_ptr<UIFont> Cell::_secondaryFont() const {
    return KitTableCellFont::preferredTableCellFontForTextStyle_traits(UIFontTextStyleSubheadline,
                                                                       0);
}

// Creation

void Cell::_createSubviews() {
    // The cell's own, not the content view's.
    _contentGuide = UILayoutGuide::init();
    _contentGuide->setIdentifier("contentGuide");
    addLayoutGuide(_contentGuide);
    _createTexts();
    _trailingGutterGuide = UILayoutGuide::init();
    _trailingGutterGuide->setIdentifier("trailingGutterGuide");
    contentView()->addLayoutGuide(_trailingGutterGuide);
    _createArtworkViews();
}

void Cell::_createTexts() {
    const auto self = strong(this);
    _stackView = UIStackView::initWithFrame({});
    _stackView->setIdentifier("stackView");
    _stackView->setTranslatesAutoresizingMaskIntoConstraints(false);
    _stackView->setAxis(UILayoutConstraintAxis::Vertical);
    _stackView->setBaselineRelativeArrangement(true);
    _stackView->setDistribution(UIStackViewDistribution::Fill);
    _stackView->setAlignment(UIStackViewAlignment::Fill);
    DynamicTypeWizard::autoscaleStackView_spacing_withFontProvider(
        _stackView, BaselineSpacing, provider(self, &Cell::_primaryFont));
    contentView()->addSubview(_stackView);

    _vibrancyViewForPrimaryLabel = vibrancyView(PrimaryVibrancy);
    _vibrancyViewForPrimaryLabel->setIdentifier("vibrancyViewForPrimaryLabel");
    _stackView->addArrangedSubview(_vibrancyViewForPrimaryLabel);
    _primaryLabel = textLabel("primaryLabel", PrimaryTextResistance);
    DynamicTypeWizard::autorefreshLabel_withFontProvider(_primaryLabel,
                                                         provider(self, &Cell::_primaryFont));
    _vibrancyViewForPrimaryLabel->setWrappedView(_primaryLabel);

    _vibrancyViewForSecondaryLabel = vibrancyView(SecondaryVibrancy);
    _vibrancyViewForSecondaryLabel->setIdentifier("vibrancyViewForSecondaryLabel");
    _stackView->addArrangedSubview(_vibrancyViewForSecondaryLabel);
    _secondaryLabel = textLabel("secondaryLabel", SecondaryTextResistance);
    DynamicTypeWizard::autorefreshLabel_withFontProvider(_secondaryLabel,
                                                         provider(self, &Cell::_secondaryFont));
    _vibrancyViewForSecondaryLabel->setWrappedView(_secondaryLabel);
}

void Cell::_createArtworkViews() {
    _nonVibrantImageView = ArtworkImageView::initWithFrame({});
    _nonVibrantImageView->setIdentifier("nonVibrantImageView");
    _nonVibrantImageView->setTranslatesAutoresizingMaskIntoConstraints(false);
    contentView()->addSubview(_nonVibrantImageView);
    _vibrantImageView = vibrancyView(SecondaryVibrancy);
    _vibrantImageView->setIdentifier("vibrantImageView");
    const auto artwork = ArtworkImageView::initWithFrame({});
    artwork->setIdentifier("vibrantArtwork");
    _vibrantImageView->setWrappedView(artwork);
    contentView()->addSubview(_vibrantImageView);
}

Constraints Cell::_initialConstraints() {
    auto all = _guideConstraints();
    append(all, _textConstraints());
    append(all, _artworkConstraints());
    return all;
}

Constraints Cell::_guideConstraints() {
    const auto& content = contentView();
    _rowHeightConstraint = content->heightAnchor().constraintEqualToConstant(DefaultRowHeight);
    _rowHeightConstraint->setIdentifier("rowHeight");
    _trailingGutterGuideWidthConstraint =
        _trailingGutterGuide->widthAnchor().constraintEqualToConstant(0);
    _trailingGutterGuideWidthConstraint->setIdentifier("trailingArtworkColumnWidth");
    return {
        _rowHeightConstraint,
        _contentGuide->centerYAnchor().constraintEqualToAnchor(content->centerYAnchor()),
        _contentGuide->leadingAnchor().constraintEqualToAnchor(content->leadingAnchor()),
        _contentGuide->trailingAnchor().constraintEqualToAnchor(content->trailingAnchor()),
        _contentGuide->topAnchor().constraintGreaterThanOrEqualToAnchor(content->topAnchor()),
        _contentGuide->bottomAnchor().constraintLessThanOrEqualToAnchor(content->bottomAnchor()),
        _trailingGutterGuide->topAnchor().constraintEqualToAnchor(_contentGuide->topAnchor()),
        _trailingGutterGuide->bottomAnchor().constraintEqualToAnchor(_contentGuide->bottomAnchor()),
        _trailingGutterGuide->trailingAnchor().constraintEqualToAnchor(
            _contentGuide->trailingAnchor()),
        _trailingGutterGuideWidthConstraint,
    };
}

Constraints Cell::_textConstraints() {
    _primaryLabelToContentGuideConstraint =
        _primaryLabel->firstBaselineAnchor().constraintEqualToAnchor(_contentGuide->topAnchor());
    _primaryLabelToContentGuideConstraint->setIdentifier("primaryLabelToContentGuide");
    _primaryLabelToContentGuideConstraint->setPriority(UILayoutPriorityDefaultHigh);
    _updatePrimaryLabelToContentGuideConstaint();
    DynamicTypeWizard::makeObject_performSelector_whenSizeCategoryChangesWithOrder(
        strong(this), Selector(UpdateSelector), AfterNewFonts);

    _stackViewToTrailingGuideConstraint =
        _stackView->trailingAnchor().constraintEqualToAnchor(_trailingGutterGuide->leadingAnchor());
    _stackViewToTrailingGuideConstraint->setIdentifier("stackViewToTrailingGuide");
    _stackViewToContentGuideTrailingConstraint =
        _stackView->trailingAnchor().constraintEqualToAnchor(_contentGuide->trailingAnchor());
    _stackViewToContentGuideTrailingConstraint->setIdentifier("stackViewToContentGuideTrailing");
    return {
        _primaryLabel->topAnchor().constraintGreaterThanOrEqualToAnchor(contentView()->topAnchor()),
        _primaryLabelToContentGuideConstraint,
        // To the last line's baseline, not its bottom, so that descenders do not push the text up.
        _contentGuide->bottomAnchor().constraintEqualToAnchor(_stackView->lastBaselineAnchor()),
        _stackView->leadingAnchor().constraintEqualToAnchor(_contentGuide->leadingAnchor()),
        _stackViewToTrailingGuideConstraint,
    };
}

Constraints Cell::_artworkConstraints() {
    const auto& content = contentView();
    const auto& vibrant = *_vibrantImageView;
    const auto& plain = *_nonVibrantImageView;
    return {
        vibrant.trailingAnchor().constraintEqualToAnchor(_trailingGutterGuide->trailingAnchor()),
        vibrant.centerYAnchor().constraintEqualToAnchor(_contentGuide->centerYAnchor()),
        vibrant.topAnchor().constraintGreaterThanOrEqualToAnchor_constant(content->topAnchor(),
                                                                          ArtworkMargin),
        vibrant.bottomAnchor().constraintLessThanOrEqualToAnchor_constant(content->bottomAnchor(),
                                                                          -ArtworkMargin),
        vibrant.trailingAnchor().constraintEqualToAnchor(plain.trailingAnchor()),
        vibrant.leadingAnchor().constraintEqualToAnchor(plain.leadingAnchor()),
        vibrant.topAnchor().constraintEqualToAnchor(plain.topAnchor()),
        vibrant.bottomAnchor().constraintEqualToAnchor(plain.bottomAnchor()),
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

void Cell::setTransitItem(const std::shared_ptr<OWTransitItem>& item) {
    if (equal(item, _transitItem))
        return;
    _transitItem = item;
    _primaryLabel->setText(item ? item->primaryText() : std::nullopt);
    _secondaryLabel->setText(item ? item->secondaryText() : std::nullopt);
    _showArtwork();
    // Only nil hides it: an empty text keeps its line.
    _secondaryLabel->setHidden(!_secondaryLabel->text());
    const bool hidden = item && item->isArtworkHidden();
    _stackViewToTrailingGuideConstraint->setActive(!hidden);
    _stackViewToContentGuideTrailingConstraint->setActive(hidden);
}

/// A dimmed artwork takes on the vibrancy of texts instead of shining through by itself. Without an
/// artwork, as with one of alpha 0.
void Cell::_showArtwork() {
    const auto artwork = _transitItem ? _transitItem->artwork() : nullptr;
    const double alpha = artwork ? artwork->alpha() : 0;
    auto shown = _artworkImageViewInVibrantImageView();
    auto other = _nonVibrantImageView;
    if (!(alpha < 1))
        std::swap(shown, other);
    other->setImageSource(nullptr);
    other->setAlpha(1);
    other->setHidden(true);
    shown->setImageSource(artwork ? artwork->artworkSource() : nullptr);
    shown->setAlpha(alpha);
    shown->setHidden(_transitItem && _transitItem->isArtworkHidden());
}

std::shared_ptr<ArtworkImageView> Cell::_artworkImageViewInVibrantImageView() const {
    return std::dynamic_pointer_cast<ArtworkImageView>(_vibrantImageView->wrappedView());
}

double Cell::rowHeight() const {
    return _rowHeightConstraint->constant();
}

void Cell::setRowHeight(double height) {
    _rowHeightConstraint->setConstant(height);
}

double Cell::trailingArtworkColumnWidth() const {
    return _trailingGutterGuideWidthConstraint->constant();
}

void Cell::setTrailingArtworkColumnWidth(double width) {
    _trailingGutterGuideWidthConstraint->setConstant(width);
}

} // namespace orvo
