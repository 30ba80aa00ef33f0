#pragma once

#include "platform/foundation/CGGeometry.h"
#include "platform/foundation/NSObject.h"

#include <cstdint>
#include <functional>
#include <vector>

namespace orvo {

class UILayoutItem;
class UIView;

enum class NSLayoutAttribute {
    NotAnAttribute = 0,
    Left = 1,
    Right = 2,
    Top = 3,
    Bottom = 4,
    Leading = 5,
    Trailing = 6,
    Width = 7,
    Height = 8,
    CenterX = 9,
    CenterY = 10,
    LastBaseline = 11,
    FirstBaseline = 12,
};

enum class NSLayoutRelation { LessThanOrEqual = -1, Equal = 0, GreaterThanOrEqual = 1 };

/// 1 to 1000. A constraint never gives way to one of a lower priority, however many those are.
using UILayoutPriority = double;
inline constexpr UILayoutPriority UILayoutPriorityRequired = 1000;
inline constexpr UILayoutPriority UILayoutPriorityDefaultHigh = 750;
inline constexpr UILayoutPriority UILayoutPriorityDefaultLow = 250;
inline constexpr UILayoutPriority UILayoutPriorityFittingSizeLevel = 50;

/// `firstItem.firstAttribute relation secondItem.secondAttribute × multiplier + constant`. Made
/// inactive; an active one is kept by the view above both its items. Its items are not kept alive:
/// without them it holds nothing. Changes are collected and take effect at the next layout pass, so
/// that of two constraints that exclude each other one may be activated before the other is
/// deactivated. Main thread.
class NSLayoutConstraint final : public virtual NSObject {
public:
    /// `secondItem` may be nil, then `secondAttribute` is `NotAnAttribute`.
    [[nodiscard]] static std::shared_ptr<NSLayoutConstraint>
    constraintWithItem_attribute_relatedBy_toItem_attribute_multiplier_constant(
        const std::shared_ptr<NSObject>& firstItem,
        NSLayoutAttribute firstAttribute,
        NSLayoutRelation relation,
        const std::shared_ptr<NSObject>& secondItem,
        NSLayoutAttribute secondAttribute,
        CGFloat multiplier,
        CGFloat constant);
    /// The same for anchors, which know their items.
    [[nodiscard]] static std::shared_ptr<NSLayoutConstraint>
    _between(const std::shared_ptr<UILayoutItem>& firstItem,
             NSLayoutAttribute firstAttribute,
             NSLayoutRelation relation,
             const std::shared_ptr<UILayoutItem>& secondItem,
             NSLayoutAttribute secondAttribute,
             CGFloat multiplier,
             CGFloat constant);

    static void
    activateConstraints(const std::vector<std::shared_ptr<NSLayoutConstraint>>& constraints);
    static void
    deactivateConstraints(const std::vector<std::shared_ptr<NSLayoutConstraint>>& constraints);

    NSLayoutConstraint();

    /// Nil when it has gone.
    [[nodiscard]] std::shared_ptr<NSObject> firstItem() const { return _firstItem.lock(); }
    [[nodiscard]] std::shared_ptr<NSObject> secondItem() const { return _secondItem.lock(); }
    [[nodiscard]] NSLayoutAttribute firstAttribute() const noexcept { return _firstAttribute; }
    [[nodiscard]] NSLayoutAttribute secondAttribute() const noexcept { return _secondAttribute; }
    [[nodiscard]] NSLayoutRelation relation() const noexcept { return _relation; }
    [[nodiscard]] CGFloat multiplier() const noexcept { return _multiplier; }

    /// In points. Setting it costs no rebuild.
    [[nodiscard]] CGFloat constant() const noexcept { return _constant; }
    void setConstant(CGFloat constant);
    /// Default: required.
    [[nodiscard]] UILayoutPriority priority() const noexcept { return _priority; }
    void setPriority(UILayoutPriority priority);
    [[nodiscard]] bool isActive() const noexcept;
    /// @throws NSInvalidArgumentException when the items have no common view above them, or one is
    ///     no layout item
    void setActive(bool active);
    /// For dumps and logs. Empty by default.
    [[nodiscard]] const std::string& identifier() const noexcept { return _identifier; }
    void setIdentifier(std::string identifier) { _identifier = std::move(identifier); }

    /// `UILabel#3.firstBaseline == UILayoutGuide#1.top + 12 @750`, after its identifier if any.
    [[nodiscard]] std::string description() const override;
    /// The same with other names for the items.
    [[nodiscard]] std::string
    _equation(const std::function<std::string(const UILayoutItem&)>& nameOfItem) const;
    [[nodiscard]] std::uint64_t _creationNumber() const noexcept { return _number; }
    /// Whether the items that it was made with are there.
    [[nodiscard]] bool _hasItems() const;
    /// Its items, where they are views or guides that are there; else nil.
    [[nodiscard]] UILayoutItem* _firstLayoutItem() const;
    [[nodiscard]] UILayoutItem* _secondLayoutItem() const;
    /// The view that keeps it; nil while inactive.
    [[nodiscard]] std::shared_ptr<UIView> _holderView() const { return _holder.lock(); }
    /// The view that kept it lets go.
    void _wasReleased();

private:
    [[nodiscard]] std::shared_ptr<UIView> commonView() const;

    std::uint64_t _number;
    std::weak_ptr<NSObject> _firstItem;
    std::weak_ptr<NSObject> _secondItem;
    // The same objects; of use only while the weak references are.
    UILayoutItem* _first = nullptr;
    UILayoutItem* _second = nullptr;
    bool _hasSecondItem = false;
    NSLayoutAttribute _firstAttribute = NSLayoutAttribute::NotAnAttribute;
    NSLayoutAttribute _secondAttribute = NSLayoutAttribute::NotAnAttribute;
    NSLayoutRelation _relation = NSLayoutRelation::Equal;
    CGFloat _multiplier = 1;
    CGFloat _constant = 0;
    UILayoutPriority _priority = UILayoutPriorityRequired;
    bool _active = false;
    std::string _identifier;
    std::weak_ptr<UIView> _holder;
};

} // namespace orvo
