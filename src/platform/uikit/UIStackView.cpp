#include "platform/uikit/UIStackView.h"

#include "platform/uikit/_LayoutEngine.h"

#include <algorithm>

namespace orvo {

namespace {

// Strong enough to fold up what is left out, but nothing that has a required size is forced.
constexpr UILayoutPriority LeftOutPriority = 999;

/// Hidden itself, or by showing nothing but a hidden view.
bool isLeftOut(UIView& view) {
    if (view.isHidden())
        return true;
    const auto shown = view.viewForFirstBaselineLayout();
    return shown && shown.get() != &view && shown->isHidden();
}

} // namespace

std::shared_ptr<UIStackView> UIStackView::init() {
    return initWithFrame({});
}

std::shared_ptr<UIStackView> UIStackView::initWithFrame(CGRect frame) {
    auto stack = std::make_shared<UIStackView>();
    return stack->_initWithFrame(frame) ? stack : nullptr;
}

void UIStackView::addArrangedSubview(const std::shared_ptr<UIView>& view) {
    std::erase(_arranged, view);
    _arranged.push_back(view);
    view->setTranslatesAutoresizingMaskIntoConstraints(false);
    if (view->superview().get() != this)
        addSubview(view);
    rearrange();
}

void UIStackView::removeArrangedSubview(const std::shared_ptr<UIView>& view) {
    if (std::erase(_arranged, view) != 0)
        rearrange();
}

void UIStackView::willRemoveSubview(const std::shared_ptr<UIView>& view) {
    removeArrangedSubview(view);
}

void UIStackView::setAxis(UILayoutConstraintAxis axis) {
    _axis = axis;
    rearrange();
}

void UIStackView::setDistribution(UIStackViewDistribution distribution) {
    _distribution = distribution;
    rearrange();
}

void UIStackView::setAlignment(UIStackViewAlignment alignment) {
    _alignment = alignment;
    rearrange();
}

void UIStackView::setSpacing(CGFloat spacing) {
    if (spacing == _spacing)
        return;
    _spacing = spacing;
    for (const auto& gap : _gaps) {
        gap->setConstant(spacing);
        _layoutEngine().constantChanged(*gap);
    }
    setNeedsLayout();
}

void UIStackView::setBaselineRelativeArrangement(bool relative) {
    _baselineRelative = relative;
    rearrange();
}

void UIStackView::rearrange() {
    _isStale = true;
    _setArrangementChanged();
}

std::vector<std::shared_ptr<UIView>> UIStackView::shownViews() const {
    std::vector<std::shared_ptr<UIView>> shown;
    std::ranges::copy_if(
        _arranged, std::back_inserter(shown), [](const auto& view) { return !isLeftOut(*view); });
    return shown;
}

std::shared_ptr<UIView> UIStackView::viewForFirstBaselineLayout() {
    const auto shown = shownViews();
    return shown.empty() ? strong<UIView>(this) : shown.front();
}

std::shared_ptr<UIView> UIStackView::viewForLastBaselineLayout() {
    const auto shown = shownViews();
    return shown.empty() ? strong<UIView>(this) : shown.back();
}

std::vector<std::shared_ptr<NSLayoutConstraint>> UIStackView::_ownConstraints() {
    auto shown = shownViews();
    if (_isStale || shown != _shown) {
        _shown = std::move(shown);
        _isStale = false;
        arrange();
    }
    return _own;
}

void UIStackView::arrange() {
    _own.clear();
    _gaps.clear();
    const bool vertical = _axis == UILayoutConstraintAxis::Vertical;
    const auto before = vertical ? NSLayoutAttribute::Top : NSLayoutAttribute::Leading;
    const auto after = vertical ? NSLayoutAttribute::Bottom : NSLayoutAttribute::Trailing;
    const auto length = vertical ? NSLayoutAttribute::Height : NSLayoutAttribute::Width;
    const bool byBaselines = vertical && _baselineRelative;
    for (std::size_t i = 0; i < _shown.size(); ++i) {
        const auto& view = _shown[i];
        if (i == 0) {
            add(view, before, NSLayoutRelation::Equal, nullptr, before);
        } else {
            _gaps.push_back(add(view,
                                byBaselines ? NSLayoutAttribute::FirstBaseline : before,
                                NSLayoutRelation::Equal,
                                _shown[i - 1],
                                byBaselines ? NSLayoutAttribute::LastBaseline : after));
            _gaps.back()->setConstant(_spacing);
            if (_distribution == UIStackViewDistribution::FillEqually)
                add(view, length, NSLayoutRelation::Equal, _shown.front(), length);
        }
        alignAcross(view);
    }
    if (!_shown.empty())
        add(_shown.back(), after, NSLayoutRelation::Equal, nullptr, after);
    for (const auto& view : _arranged) {
        if (std::ranges::find(_shown, view) == _shown.end())
            foldUp(view);
    }
}

void UIStackView::alignAcross(const std::shared_ptr<UIView>& view) {
    const bool vertical = _axis == UILayoutConstraintAxis::Vertical;
    const auto before = vertical ? NSLayoutAttribute::Leading : NSLayoutAttribute::Top;
    const auto after = vertical ? NSLayoutAttribute::Trailing : NSLayoutAttribute::Bottom;
    const auto centre = vertical ? NSLayoutAttribute::CenterX : NSLayoutAttribute::CenterY;
    using enum NSLayoutRelation;
    switch (_alignment) {
    case UIStackViewAlignment::Fill:
        add(view, before, Equal, nullptr, before);
        add(view, after, Equal, nullptr, after);
        return;
    case UIStackViewAlignment::Leading:
        add(view, before, Equal, nullptr, before);
        break;
    case UIStackViewAlignment::Trailing:
        add(view, after, Equal, nullptr, after);
        break;
    case UIStackViewAlignment::Center:
        add(view, centre, Equal, nullptr, centre);
        break;
    case UIStackViewAlignment::FirstBaseline:
    case UIStackViewAlignment::LastBaseline:
        if (view != _shown.front()) {
            const auto baseline = _alignment == UIStackViewAlignment::FirstBaseline
                                      ? NSLayoutAttribute::FirstBaseline
                                      : NSLayoutAttribute::LastBaseline;
            add(view, baseline, Equal, _shown.front(), baseline);
        }
        break;
    }
    add(view, before, GreaterThanOrEqual, nullptr, before);
    add(view, after, LessThanOrEqual, nullptr, after);
}

/// What is left out waits, without length, at the start of the stack.
void UIStackView::foldUp(const std::shared_ptr<UIView>& view) {
    using enum NSLayoutRelation;
    using enum NSLayoutAttribute;
    for (const auto& [own, stacks] : {std::pair{Leading, Leading}, {Top, Top}})
        add(view, own, Equal, nullptr, stacks);
    const bool vertical = _axis == UILayoutConstraintAxis::Vertical;
    if (vertical)
        add(view, Trailing, Equal, nullptr, Trailing);
    else
        add(view, Bottom, Equal, nullptr, Bottom);
    _own.push_back(NSLayoutConstraint::_between(
        view, vertical ? Height : Width, Equal, nullptr, NotAnAttribute, 1, 0));
    _own.back()->setPriority(LeftOutPriority);
}

/// Against another view, or the stack itself for nil.
std::shared_ptr<NSLayoutConstraint> UIStackView::add(const std::shared_ptr<UIView>& view,
                                                     NSLayoutAttribute attribute,
                                                     NSLayoutRelation relation,
                                                     const std::shared_ptr<UIView>& other,
                                                     NSLayoutAttribute otherAttribute) {
    _own.push_back(NSLayoutConstraint::_between(
        view, attribute, relation, other ? other : strong<UIView>(this), otherAttribute, 1, 0));
    return _own.back();
}

} // namespace orvo
