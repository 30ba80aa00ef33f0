#include "platform/uikit/table/UITableViewCell.h"

#include "platform/uikit/UIColor.h"
#include "platform/uikit/ViewAnimator.h"
#include "platform/uikit/drawing/Canvas.h"

namespace orvo {

namespace {

constexpr double HighlightOpacity = 0.08;
constexpr double FadeSeconds = 0.25;
// Beside the text, which begins at the row's edge.
constexpr CGFloat HighlightOutset = 8;
constexpr CGFloat HighlightRadius = 8;
constexpr CGFloat FocusRingWidth = 2;
// A row's own height wins until its table has asked for it.
constexpr UILayoutPriority HeightPriority = 999;

void collectSpoken(const UIView& view, std::string& into) {
    if (view.isHidden())
        return;
    if (const auto label = view.accessibilityLabel();
        view.isAccessibilityElement() && label && !label->empty()) {
        into += into.empty() ? "" : ", ";
        into += *label;
        return;
    }
    for (const auto& subview : view.subviews())
        collectSpoken(*subview, into);
}

} // namespace

std::shared_ptr<UITableViewCell>
UITableViewCell::initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                               std::optional<std::string> reuseIdentifier) {
    auto cell = std::make_shared<UITableViewCell>();
    return cell->_initWithStyle_reuseIdentifier(style, std::move(reuseIdentifier)) ? cell : nullptr;
}

bool UITableViewCell::_initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                                     std::optional<std::string> reuseIdentifier) {
    if (!_initWithFrame({}))
        return false;
    _style = style;
    _reuseIdentifier = std::move(reuseIdentifier);
    _contentView = UIView::init();
    _contentView->setIdentifier("contentView");
    _contentView->_setFillsSuperview(true);
    addSubview(_contentView);
    setIsAccessibilityElement(true);
    return true;
}

UILayoutPriority UITableViewCell::_rootHeightPriority() const {
    return HeightPriority;
}

void UITableViewCell::setSeparatorStyleOverride(
    std::optional<UITableViewCellSeparatorStyle> style) {
    if (style == _separatorOverride)
        return;
    _separatorOverride = style;
    if (const auto table = superview())
        table->setNeedsLayout();
}

void UITableViewCell::setSeparatorInset(const std::optional<NSDirectionalEdgeInsets>& insets) {
    if (insets == _separatorInset)
        return;
    _separatorInset = insets;
    if (const auto table = superview())
        table->setNeedsLayout();
}

void UITableViewCell::_setSeparator(std::optional<Separator> separator) {
    const auto same = [](const Separator& a, const Separator& b) {
        return a.insets == b.insets && equal(a.color, b.color);
    };
    if (separator.has_value() == _line.has_value() && (!separator || same(*separator, *_line)))
        return;
    _line = std::move(separator);
    setNeedsDisplay();
}

void UITableViewCell::prepareForReuse() {
    _highlighted = false;
    _selected = false;
    updateHighlight(false); // a fade that still runs ends here
    _setFocused(false);
}

// Highlight, selection, focus

void UITableViewCell::setHighlighted_animated(bool highlighted, bool animated) {
    if (highlighted == _highlighted)
        return;
    _highlighted = highlighted;
    updateHighlight(animated);
}

void UITableViewCell::setSelected_animated(bool selected, bool animated) {
    if (selected == _selected)
        return;
    _selected = selected;
    updateHighlight(animated);
}

void UITableViewCell::updateHighlight(bool animated) {
    const double from = _highlightLevelNow;
    const double to = _highlighted || _selected ? 1 : 0;
    const auto show = [this, from, to](double progress) {
        const double level = from + (to - from) * progress;
        if (level == _highlightLevelNow)
            return;
        _highlightLevelNow = level;
        setNeedsDisplay();
    };
    const auto animator = ViewAnimator::shared().get();
    if (animated)
        return animator->animate(*this, "highlight", 0, FadeSeconds, show);
    animator->cancel(*this, "highlight");
    show(1);
}

void UITableViewCell::_setFocused(bool focused) {
    if (focused == _focused)
        return;
    _focused = focused;
    setNeedsDisplay();
}

// Drawing

void UITableViewCell::drawRect(Canvas& canvas) {
    const auto size = frame().size;
    const auto traits = traitCollection();
    const CGRect area{{-HighlightOutset, 0}, {size.width + 2 * HighlightOutset, size.height}};
    if (_highlightLevelNow > 0) {
        const auto color =
            UIColor::labelColor()->colorWithAlphaComponent(HighlightOpacity * _highlightLevelNow);
        canvas.fill(area, HighlightRadius, color->resolvedColorWithTraitCollection(traits));
    }
    if (_line && _line->color) {
        const bool rightToLeft =
            effectiveUserInterfaceLayoutDirection() == UIUserInterfaceLayoutDirection::RightToLeft;
        const auto& insets = _line->insets;
        const CGFloat pixel = 1 / canvas.scale();
        canvas.fill({{rightToLeft ? insets.trailing : insets.leading, size.height - pixel},
                     {size.width - insets.leading - insets.trailing, pixel}},
                    0,
                    _line->color->resolvedColorWithTraitCollection(traits));
    }
    if (_focused)
        canvas.stroke(area,
                      HighlightRadius,
                      FocusRingWidth,
                      UIColor::secondaryLabelColor()->resolvedColorWithTraitCollection(traits));
}

std::optional<std::string> UITableViewCell::accessibilityLabel() const {
    if (auto given = UIView::accessibilityLabel())
        return given;
    std::string spoken;
    for (const auto& subview : subviews())
        collectSpoken(*subview, spoken);
    return spoken.empty() ? std::nullopt : std::optional(spoken);
}

} // namespace orvo
