#include "platform/uikit/_ConstraintShape.h"

#include "platform/uikit/UIView.h"

namespace orvo {

namespace {

/// The view that shows the baseline in the place of `view`.
UIView& baselineView(UIView& view, NSLayoutAttribute attribute) {
    auto* at = &view;
    while (true) {
        const auto next = attribute == NSLayoutAttribute::FirstBaseline
                              ? at->viewForFirstBaselineLayout()
                              : at->viewForLastBaselineLayout();
        if (!next || next.get() == at)
            return *at;
        at = next.get();
    }
}

UILayoutItem& targetOf(UILayoutItem& item, NSLayoutAttribute attribute, const UIView& root) {
    auto* const view = item._asView();
    const bool goesOn = view && _ConstraintShape::isBaseline(attribute);
    return _ConstraintShape::placeholderOf(goesOn ? baselineView(*view, attribute) : item, root);
}

bool isDirectional(NSLayoutAttribute attribute) {
    return attribute == NSLayoutAttribute::Leading || attribute == NSLayoutAttribute::Trailing;
}

double offsetOf(const UILayoutItem& item, NSLayoutAttribute attribute) {
    const auto* view = _ConstraintShape::isBaseline(attribute) ? item._asView() : nullptr;
    if (!view)
        return 0;
    if (attribute == NSLayoutAttribute::LastBaseline)
        return -view->_lastBaselineFromBottom();
    return view->_firstBaselineFromTop().value_or(0);
}

} // namespace

_ConstraintShape _ConstraintShape::of(const NSLayoutConstraint& constraint, const UIView& root) {
    _ConstraintShape shape;
    auto& first = *constraint._firstLayoutItem();
    shape.first = &targetOf(first, constraint.firstAttribute(), root);
    shape.firstNumber = shape.first->_creationNumber();
    if (auto* const second = constraint._secondLayoutItem()) {
        shape.second = &targetOf(*second, constraint.secondAttribute(), root);
        shape.secondNumber = shape.second->_creationNumber();
    }
    shape.priority = constraint.priority();
    const auto* const view = first._layoutView();
    shape.rightToLeft = isDirectional(constraint.firstAttribute()) && view &&
                        view->effectiveUserInterfaceLayoutDirection() ==
                            UIUserInterfaceLayoutDirection::RightToLeft;
    return shape;
}

double _ConstraintShape::baselineOffset(const NSLayoutConstraint& constraint) const {
    const double offset = offsetOf(*first, constraint.firstAttribute());
    if (!second)
        return offset;
    return offset - constraint.multiplier() * offsetOf(*second, constraint.secondAttribute());
}

UILayoutItem& _ConstraintShape::placeholderOf(UILayoutItem& object, const UIView& root) {
    auto* item = &object;
    while (item != static_cast<const UILayoutItem*>(&root)) {
        const auto* view = item->_asView();
        const auto above = view && view->_fillsSuperview() ? view->superview() : nullptr;
        if (!above)
            break;
        item = above.get();
    }
    return *item;
}

NSLayoutAttribute _ConstraintShape::edgeOf(const UILayoutItem& item, NSLayoutAttribute attribute) {
    if (!isBaseline(attribute))
        return attribute;
    const auto* view = item._asView();
    const bool fromTop = attribute == NSLayoutAttribute::FirstBaseline && view &&
                         view->_firstBaselineFromTop().has_value();
    return fromTop ? NSLayoutAttribute::Top : NSLayoutAttribute::Bottom;
}

bool _ConstraintShape::isBaseline(NSLayoutAttribute attribute) noexcept {
    return attribute == NSLayoutAttribute::FirstBaseline ||
           attribute == NSLayoutAttribute::LastBaseline;
}

} // namespace orvo
