#include "platform/extension/WidgetCard.h"

#include "platform/extension/WidgetHost.h"
#include "platform/foundation/NSBundle.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIFont.h"
#include "platform/uikit/UIImage.h"
#include "platform/uikit/UIImageView.h"
#include "platform/uikit/UILabel.h"
#include "platform/uikit/drawing/Canvas.h"

#include <algorithm>

namespace orvo {

namespace {

constexpr CGFloat IconSide = 20;
constexpr CGFloat IconSpacing = 8;
constexpr double HeaderTextSize = 13;
constexpr int HeaderTextWeight = 500;
constexpr CGFloat ButtonPadding = 12;
constexpr CGFloat ButtonMinimumWidth = 44;
constexpr CGFloat HighlightedAlpha = 0.5;
constexpr CGFloat RingWidth = 2;
constexpr CGFloat RingRadius = 6;
constexpr CGSize RingDistance{6, 4};

std::shared_ptr<UILabel> headerLabel() {
    auto label = UILabel::init();
    label->setFont(UIFont::systemFontOfSize_weight(HeaderTextSize, HeaderTextWeight));
    label->setTextColor(UIColor::secondaryLabelColor());
    return label;
}

std::string hostText(const std::string& key) {
    return NSBundle::mainBundle()->localizedStringForKey_value_table(
        key, std::nullopt, std::string("WidgetHost"));
}

/// What the label takes, at most `width` of it.
CGSize sizeOf(UILabel& label, CGFloat width) {
    const auto wanted = label.intrinsicContentSize();
    return {std::max<CGFloat>(std::min(wanted.width, width), 0), wanted.height};
}

/// How much of the icon's square is empty on either side: the fixed images are the same on both.
CGFloat emptyBeside(const std::shared_ptr<UIImage>& icon) {
    return icon ? icon->alignmentRectInsets().left * IconSide / icon->size().width : 0;
}

/// Where its capitals stand in the middle of the header.
CGFloat topOf(const UILabel& label, const UIView& card) {
    const auto& font = *label.font();
    return UIRoundToViewScale(WidgetCard::HeaderHeight / 2 - font.ascender() + font.capHeight() / 2,
                              &card);
}

} // namespace

std::shared_ptr<WidgetCard>
WidgetCard::cardWithHost_offersButton(const std::shared_ptr<WidgetHost>& host, bool offersButton) {
    auto card = std::make_shared<WidgetCard>();
    card->_initWithHost_offersButton(host, offersButton);
    return card;
}

void WidgetCard::_initWithHost_offersButton(const std::shared_ptr<WidgetHost>& host,
                                            bool offersButton) {
    _initWithFrame({{0, 0}, sizeForContentSize(host->contentSize())});
    _host = host;
    _offersButton = offersButton;
    setBackgroundColor(UIColor::cardColor());
    setCornerRadius(CornerRadius);
    setClipsToBounds(true);

    const auto& description = host->extensionDescription();
    _icon = UIImageView::initWithImage(
        description.iconName ? UIImage::imageNamed(*description.iconName) : nullptr);
    _icon->setTintColor(UIColor::secondaryLabelColor());
    _name = headerLabel();
    _name->setText(description.displayName);
    _button = headerLabel();
    for (const auto& view : {std::shared_ptr<UIView>(_icon),
                             std::shared_ptr<UIView>(_name),
                             std::shared_ptr<UIView>(_button)})
        addSubview(view);
    update();
}

void WidgetCard::update() {
    if (_content != _host->view()) {
        if (_content)
            _content->removeFromSuperview();
        _content = _host->view();
        addSubview(_content);
    }
    _button->setText(buttonTitle());
    _button->setHidden(!_offersButton || !_host->offersExpanded());
    setNeedsLayout();
    setNeedsDisplay();
}

std::string WidgetCard::buttonTitle() const {
    return hostText(_host->displayMode() == NCWidgetDisplayMode::Compact ? "ShowMore" : "ShowLess");
}

CGRect WidgetCard::buttonArea() const {
    if (_button->isHidden())
        return {};
    const auto& label = _button->frame();
    const bool leads =
        effectiveUserInterfaceLayoutDirection() == UIUserInterfaceLayoutDirection::RightToLeft;
    const auto width =
        std::max(label.size.width + ButtonPadding + WidgetHost::SideMargin, ButtonMinimumWidth);
    return {{leads ? 0 : frame().size.width - width, 0}, {width, HeaderHeight}};
}

void WidgetCard::pressButton() {
    if (_button->isHidden())
        return;
    _host->setDisplayMode(_host->displayMode() == NCWidgetDisplayMode::Compact
                              ? NCWidgetDisplayMode::Expanded
                              : NCWidgetDisplayMode::Compact);
}

void WidgetCard::setButtonHighlighted(bool highlighted) {
    _button->setAlpha(highlighted ? HighlightedAlpha : 1);
}

void WidgetCard::setButtonFocused(bool focused) {
    if (focused == _buttonFocused)
        return;
    _buttonFocused = focused;
    setNeedsDisplay();
}

void WidgetCard::place(UIView& view, CGFloat leading, CGFloat top, CGSize size) {
    const bool isMirrored =
        effectiveUserInterfaceLayoutDirection() == UIUserInterfaceLayoutDirection::RightToLeft;
    const auto left = isMirrored ? frame().size.width - leading - size.width : leading;
    view.setFrame({{UIRoundToViewScale(left, this), top}, size});
}

void WidgetCard::layoutSubviews() {
    const auto size = frame().size;
    constexpr auto margin = WidgetHost::SideMargin;
    const auto button = _button->isHidden() ? CGSize{} : sizeOf(*_button, size.width / 2);
    place(*_button, size.width - margin - button.width, topOf(*_button, *this), button);
    // What one sees of the icon begins where the texts below it do.
    const auto iconEmpty = emptyBeside(_icon->image());
    const auto iconStart = margin - iconEmpty;
    place(*_icon, iconStart, (HeaderHeight - IconSide) / 2, {IconSide, IconSide});
    const auto nameStart = _icon->image() ? iconStart + IconSide - iconEmpty + IconSpacing : margin;
    const auto nameEnd = size.width - margin - button.width - (button.width > 0 ? margin : 0);
    place(*_name, nameStart, topOf(*_name, *this), sizeOf(*_name, nameEnd - nameStart));
    _host->view()->setFrame(
        {{0, HeaderHeight}, {size.width, std::max<CGFloat>(size.height - HeaderHeight, 0)}});
    UIView::layoutSubviews();
}

void WidgetCard::drawRect(Canvas& canvas) {
    const auto traits = traitCollection();
    if (traits.accessibilityContrast == UIAccessibilityContrast::High)
        canvas.stroke(bounds(),
                      CornerRadius,
                      1 / canvas.scale(),
                      UIColor::labelColor()->resolvedColorWithTraitCollection(traits));
    if (!_buttonFocused || _button->isHidden())
        return;
    const auto& label = _button->frame();
    canvas.stroke(
        {{label.origin.x - RingDistance.width, label.origin.y - RingDistance.height},
         {label.size.width + 2 * RingDistance.width, label.size.height + 2 * RingDistance.height}},
        RingRadius,
        RingWidth,
        UIColor::secondaryLabelColor()->resolvedColorWithTraitCollection(traits));
}

void WidgetCard::traitCollectionDidChange(const UITraitCollection& previous) {
    UIView::traitCollectionDidChange(previous);
    update();
}

} // namespace orvo
