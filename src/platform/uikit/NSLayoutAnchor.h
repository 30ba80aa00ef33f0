#pragma once

#include "platform/uikit/NSLayoutConstraint.h"

#include <memory>

namespace orvo {

class UILayoutItem;

/// One edge, centre, baseline or dimension of a layout item: the short way to a constraint, which
/// starts inactive. A value; it does not keep its item alive. `Kind` keeps axes apart: only anchors
/// of one kind can be set against one another.
template <class Kind>
class NSLayoutAnchor {
public:
    NSLayoutAnchor(std::weak_ptr<UILayoutItem> item, NSLayoutAttribute attribute)
        : _item(std::move(item))
        , _attribute(attribute) {}

    [[nodiscard]] std::shared_ptr<UILayoutItem> item() const { return _item.lock(); }
    [[nodiscard]] NSLayoutAttribute attribute() const noexcept { return _attribute; }

    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintEqualToAnchor(const NSLayoutAnchor& other) const {
        return against(NSLayoutRelation::Equal, other, 1, 0);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintEqualToAnchor_constant(const NSLayoutAnchor& other, CGFloat constant) const {
        return against(NSLayoutRelation::Equal, other, 1, constant);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintGreaterThanOrEqualToAnchor(const NSLayoutAnchor& other) const {
        return against(NSLayoutRelation::GreaterThanOrEqual, other, 1, 0);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintGreaterThanOrEqualToAnchor_constant(const NSLayoutAnchor& other,
                                                  CGFloat constant) const {
        return against(NSLayoutRelation::GreaterThanOrEqual, other, 1, constant);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintLessThanOrEqualToAnchor(const NSLayoutAnchor& other) const {
        return against(NSLayoutRelation::LessThanOrEqual, other, 1, 0);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintLessThanOrEqualToAnchor_constant(const NSLayoutAnchor& other,
                                               CGFloat constant) const {
        return against(NSLayoutRelation::LessThanOrEqual, other, 1, constant);
    }

protected:
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint> against(NSLayoutRelation relation,
                                                              const NSLayoutAnchor& other,
                                                              CGFloat multiplier,
                                                              CGFloat constant) const {
        return NSLayoutConstraint::_between(_item.lock(),
                                            _attribute,
                                            relation,
                                            other.item(),
                                            other._attribute,
                                            multiplier,
                                            constant);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint> alone(NSLayoutRelation relation,
                                                            CGFloat constant) const {
        return NSLayoutConstraint::_between(_item.lock(),
                                            _attribute,
                                            relation,
                                            nullptr,
                                            NSLayoutAttribute::NotAnAttribute,
                                            1,
                                            constant);
    }

private:
    std::weak_ptr<UILayoutItem> _item;
    NSLayoutAttribute _attribute;
};

class NSLayoutXAxisAnchor : public NSLayoutAnchor<NSLayoutXAxisAnchor> {
public:
    using NSLayoutAnchor::NSLayoutAnchor;
};

class NSLayoutYAxisAnchor : public NSLayoutAnchor<NSLayoutYAxisAnchor> {
public:
    using NSLayoutAnchor::NSLayoutAnchor;
};

/// A width or a height.
class NSLayoutDimension : public NSLayoutAnchor<NSLayoutDimension> {
public:
    using NSLayoutAnchor::NSLayoutAnchor;

    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintEqualToConstant(CGFloat constant) const {
        return alone(NSLayoutRelation::Equal, constant);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintGreaterThanOrEqualToConstant(CGFloat constant) const {
        return alone(NSLayoutRelation::GreaterThanOrEqual, constant);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintLessThanOrEqualToConstant(CGFloat constant) const {
        return alone(NSLayoutRelation::LessThanOrEqual, constant);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint>
    constraintEqualToAnchor_multiplier(const NSLayoutDimension& other, CGFloat multiplier) const {
        return against(NSLayoutRelation::Equal, other, multiplier, 0);
    }
    [[nodiscard]] std::shared_ptr<NSLayoutConstraint> constraintEqualToAnchor_multiplier_constant(
        const NSLayoutDimension& other, CGFloat multiplier, CGFloat constant) const {
        return against(NSLayoutRelation::Equal, other, multiplier, constant);
    }
};

} // namespace orvo
