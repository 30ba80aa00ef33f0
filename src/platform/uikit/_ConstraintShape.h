#pragma once

#include "platform/uikit/NSLayoutConstraint.h"

namespace orvo {

/// What a constraint comes down to in the layout of one root. While it is the same, only the
/// constant can have changed.
struct _ConstraintShape {
    /// The items whose rectangles it is about: for a baseline those of the view that shows it.
    UILayoutItem* first = nullptr;
    UILayoutItem* second = nullptr; ///< nil without a second item
    /// Their creation numbers: another item may come to lie where one has gone.
    std::uint64_t firstNumber = 0;
    std::uint64_t secondNumber = 0;
    UILayoutPriority priority = 0;
    bool rightToLeft = false;

    friend bool operator==(const _ConstraintShape&, const _ConstraintShape&) = default;

    /// The items of the constraint must be there.
    [[nodiscard]] static _ConstraintShape of(const NSLayoutConstraint& constraint,
                                             const UIView& root);

    /// What its baselines add to the constant, measured from `edgeOf` their items.
    [[nodiscard]] double baselineOffset(const NSLayoutConstraint& constraint) const;

    /// The item whose rectangle `object` always has, at most the root: itself, unless it is a view
    /// that fills the one above.
    [[nodiscard]] static UILayoutItem& placeholderOf(UILayoutItem& object, const UIView& root);
    /// The edge of `item` that a baseline is measured from; any other attribute is its own.
    [[nodiscard]] static NSLayoutAttribute edgeOf(const UILayoutItem& item,
                                                  NSLayoutAttribute attribute);
    [[nodiscard]] static bool isBaseline(NSLayoutAttribute attribute) noexcept;
};

} // namespace orvo
