#pragma once

#include "platform/foundation/NSObject.h"
#include "platform/uikit/NSLayoutAnchor.h"

#include <cstdint>

namespace orvo {

class UIView;

/// What constraints stand between: a view or a layout guide. Main thread.
class UILayoutItem : public virtual NSObject {
public:
    [[nodiscard]] NSLayoutXAxisAnchor leadingAnchor() const;
    [[nodiscard]] NSLayoutXAxisAnchor trailingAnchor() const;
    [[nodiscard]] NSLayoutXAxisAnchor leftAnchor() const;
    [[nodiscard]] NSLayoutXAxisAnchor rightAnchor() const;
    [[nodiscard]] NSLayoutXAxisAnchor centerXAnchor() const;
    [[nodiscard]] NSLayoutYAxisAnchor topAnchor() const;
    [[nodiscard]] NSLayoutYAxisAnchor bottomAnchor() const;
    [[nodiscard]] NSLayoutYAxisAnchor centerYAnchor() const;
    [[nodiscard]] NSLayoutDimension widthAnchor() const;
    [[nodiscard]] NSLayoutDimension heightAnchor() const;

    /// The view that the item is, or belongs to; nil for a guide without an owner.
    [[nodiscard]] virtual UIView* _layoutView() const = 0;
    /// The view that the item is; nil for a guide.
    [[nodiscard]] virtual UIView* _asView() const { return nullptr; }
    /// Where it is now, in the coordinates of the view above.
    [[nodiscard]] virtual const CGRect& _placedFrame() const = 0;
    /// `UILabel#3`, or the identifier where it has one: how dumps and logs call it.
    [[nodiscard]] std::string _layoutName() const;
    /// Counts up from 1 in order of creation, so that no order depends on an address.
    [[nodiscard]] std::uint64_t _creationNumber() const noexcept { return _number; }

    /// For dumps, logs and tests. Empty by default.
    [[nodiscard]] const std::string& identifier() const noexcept { return _identifier; }
    void setIdentifier(std::string identifier) { _identifier = std::move(identifier); }

protected:
    UILayoutItem();

    [[nodiscard]] std::weak_ptr<UILayoutItem> weakItem() const;

private:
    std::uint64_t _number;
    std::string _identifier;
};

} // namespace orvo
