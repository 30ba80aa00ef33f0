#include "platform/uikit/UILayoutItem.h"

#include <atomic>

namespace orvo {

namespace {

std::uint64_t nextNumber() {
    static std::atomic<std::uint64_t> last = 0;
    return ++last;
}

} // namespace

UILayoutItem::UILayoutItem()
    : _number(nextNumber()) {}

std::weak_ptr<UILayoutItem> UILayoutItem::weakItem() const {
    auto* self = const_cast<UILayoutItem*>(this);
    return strong(self);
}

std::string UILayoutItem::_layoutName() const {
    return _identifier.empty() ? className() + "#" + std::to_string(_number) : _identifier;
}

NSLayoutXAxisAnchor UILayoutItem::leadingAnchor() const {
    return {weakItem(), NSLayoutAttribute::Leading};
}
NSLayoutXAxisAnchor UILayoutItem::trailingAnchor() const {
    return {weakItem(), NSLayoutAttribute::Trailing};
}
NSLayoutXAxisAnchor UILayoutItem::leftAnchor() const {
    return {weakItem(), NSLayoutAttribute::Left};
}
NSLayoutXAxisAnchor UILayoutItem::rightAnchor() const {
    return {weakItem(), NSLayoutAttribute::Right};
}
NSLayoutXAxisAnchor UILayoutItem::centerXAnchor() const {
    return {weakItem(), NSLayoutAttribute::CenterX};
}
NSLayoutYAxisAnchor UILayoutItem::topAnchor() const {
    return {weakItem(), NSLayoutAttribute::Top};
}
NSLayoutYAxisAnchor UILayoutItem::bottomAnchor() const {
    return {weakItem(), NSLayoutAttribute::Bottom};
}
NSLayoutYAxisAnchor UILayoutItem::centerYAnchor() const {
    return {weakItem(), NSLayoutAttribute::CenterY};
}
NSLayoutDimension UILayoutItem::widthAnchor() const {
    return {weakItem(), NSLayoutAttribute::Width};
}
NSLayoutDimension UILayoutItem::heightAnchor() const {
    return {weakItem(), NSLayoutAttribute::Height};
}

} // namespace orvo
