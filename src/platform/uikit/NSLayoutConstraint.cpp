#include "platform/uikit/NSLayoutConstraint.h"

#include "platform/foundation/Exceptions.h"
#include "platform/uikit/UIView.h"
#include "platform/uikit/_LayoutEngine.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <cmath>
#include <cstdio>

namespace orvo {

namespace {

constexpr std::array AttributeNames{"nothing",
                                    "left",
                                    "right",
                                    "top",
                                    "bottom",
                                    "leading",
                                    "trailing",
                                    "width",
                                    "height",
                                    "centerX",
                                    "centerY",
                                    "lastBaseline",
                                    "firstBaseline"};

std::uint64_t nextNumber() {
    static std::atomic<std::uint64_t> last = 0;
    return ++last;
}

std::string number(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.10g", value);
    return text;
}

const char* symbolOf(NSLayoutRelation relation) {
    switch (relation) {
    case NSLayoutRelation::LessThanOrEqual:
        return " <= ";
    case NSLayoutRelation::GreaterThanOrEqual:
        return " >= ";
    case NSLayoutRelation::Equal:
        break;
    }
    return " == ";
}

UIView* viewOf(const UILayoutItem* item) {
    return item ? item->_layoutView() : nullptr;
}

} // namespace

std::shared_ptr<NSLayoutConstraint>
NSLayoutConstraint::constraintWithItem_attribute_relatedBy_toItem_attribute_multiplier_constant(
    const std::shared_ptr<NSObject>& firstItem,
    NSLayoutAttribute firstAttribute,
    NSLayoutRelation relation,
    const std::shared_ptr<NSObject>& secondItem,
    NSLayoutAttribute secondAttribute,
    CGFloat multiplier,
    CGFloat constant) {
    auto constraint = std::make_shared<NSLayoutConstraint>();
    constraint->_firstItem = firstItem;
    constraint->_secondItem = secondItem;
    constraint->_first = dynamic_cast<UILayoutItem*>(firstItem.get());
    constraint->_second = dynamic_cast<UILayoutItem*>(secondItem.get());
    constraint->_hasSecondItem = secondItem != nullptr;
    constraint->_firstAttribute = firstAttribute;
    constraint->_secondAttribute = secondAttribute;
    constraint->_relation = relation;
    constraint->_multiplier = multiplier;
    constraint->_constant = constant;
    return constraint;
}

std::shared_ptr<NSLayoutConstraint>
NSLayoutConstraint::_between(const std::shared_ptr<UILayoutItem>& firstItem,
                             NSLayoutAttribute firstAttribute,
                             NSLayoutRelation relation,
                             const std::shared_ptr<UILayoutItem>& secondItem,
                             NSLayoutAttribute secondAttribute,
                             CGFloat multiplier,
                             CGFloat constant) {
    return constraintWithItem_attribute_relatedBy_toItem_attribute_multiplier_constant(
        firstItem, firstAttribute, relation, secondItem, secondAttribute, multiplier, constant);
}

void NSLayoutConstraint::activateConstraints(
    const std::vector<std::shared_ptr<NSLayoutConstraint>>& constraints) {
    for (const auto& constraint : constraints)
        constraint->setActive(true);
}

void NSLayoutConstraint::deactivateConstraints(
    const std::vector<std::shared_ptr<NSLayoutConstraint>>& constraints) {
    for (const auto& constraint : constraints)
        constraint->setActive(false);
}

NSLayoutConstraint::NSLayoutConstraint()
    : _number(nextNumber()) {}

bool NSLayoutConstraint::isActive() const noexcept {
    return _active && !_holder.expired();
}

void NSLayoutConstraint::setConstant(CGFloat constant) {
    if (constant == _constant)
        return;
    _constant = constant;
    if (const auto holder = _holder.lock(); holder && _active)
        holder->_layoutEngine().constantChanged(*this);
}

void NSLayoutConstraint::setPriority(UILayoutPriority priority) {
    if (priority == _priority)
        return;
    _priority = priority;
    if (const auto holder = _holder.lock(); holder && _active)
        holder->_layoutEngine().structureChanged();
}

void NSLayoutConstraint::setActive(bool active) {
    if (active == isActive())
        return;
    if (!active) {
        _holder.lock()->_releaseConstraint(*this);
        return;
    }
    const auto holder = commonView();
    if (!holder)
        throw NSInvalidArgumentException(
            "a constraint needs items with a common view above them: " + description());
    _active = true;
    _holder = holder;
    holder->_holdConstraint(strong(this));
}

bool NSLayoutConstraint::_hasItems() const {
    return !_firstItem.expired() && (!_hasSecondItem || !_secondItem.expired());
}

UILayoutItem* NSLayoutConstraint::_firstLayoutItem() const {
    return _firstItem.expired() ? nullptr : _first;
}

UILayoutItem* NSLayoutConstraint::_secondLayoutItem() const {
    return _secondItem.expired() ? nullptr : _second;
}

void NSLayoutConstraint::_wasReleased() {
    _active = false;
    _holder.reset();
}

/// The nearest view that both items lie in, or are.
std::shared_ptr<UIView> NSLayoutConstraint::commonView() const {
    auto* const first = viewOf(_firstLayoutItem());
    if (!first)
        return nullptr;
    if (!_hasSecondItem)
        return strong(first);
    const auto* const second = viewOf(_secondLayoutItem());
    if (!second)
        return nullptr;
    for (auto view = strong(first); view; view = view->superview()) {
        if (second->isDescendantOfView(*view))
            return view;
    }
    return nullptr;
}

std::string NSLayoutConstraint::_equation(
    const std::function<std::string(const UILayoutItem&)>& nameOfItem) const {
    const auto side = [&nameOfItem](const NSObject* object, NSLayoutAttribute attribute) {
        const auto* item = dynamic_cast<const UILayoutItem*>(object);
        const std::string name = item     ? nameOfItem(*item)
                                 : object ? object->className()
                                          : std::string("(gone)");
        return name + "." + AttributeNames.at(static_cast<std::size_t>(attribute));
    };
    std::string text = side(firstItem().get(), _firstAttribute) + symbolOf(_relation);
    if (_hasSecondItem) {
        text += side(secondItem().get(), _secondAttribute);
        if (_multiplier != 1)
            text += " * " + number(_multiplier);
        if (_constant != 0)
            text += (_constant < 0 ? " - " : " + ") + number(std::abs(_constant));
    } else {
        text += number(_constant);
    }
    if (_priority != UILayoutPriorityRequired)
        text += " @" + number(_priority);
    return _identifier.empty() ? text : _identifier + ": " + text;
}

std::string NSLayoutConstraint::description() const {
    return _equation([](const UILayoutItem& item) { return item._layoutName(); });
}

} // namespace orvo
