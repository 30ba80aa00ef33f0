#include "platform/uikit/UIView.h"

#include "platform/foundation/Exceptions.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/_LayoutEngine.h"

#include <algorithm>

namespace orvo {

std::shared_ptr<UIView> UIView::init() {
    return initWithFrame({});
}

std::shared_ptr<UIView> UIView::initWithFrame(CGRect frame) {
    auto view = std::make_shared<UIView>();
    return view->_initWithFrame(frame) ? view : nullptr;
}

UIView::UIView() = default;

UIView::~UIView() = default;

bool UIView::_initWithFrame(CGRect frame) {
    _frame = frame;
    return true;
}

// The tree

void UIView::addSubview(const std::shared_ptr<UIView>& view) {
    insertSubview_atIndex(view, _subviews.size());
}

void UIView::insertSubview_atIndex(const std::shared_ptr<UIView>& view, std::size_t index) {
    if (!view)
        throw NSInvalidArgumentException("a nil view was added as a subview");
    if (isDescendantOfView(*view))
        throw NSInvalidArgumentException("a view was added to itself or to what it holds");
    const auto previous = view->traitCollection();
    view->removeFromSuperview();
    const auto at = std::min(index, _subviews.size());
    _subviews.insert(_subviews.begin() + static_cast<std::ptrdiff_t>(at), view);
    view->_superview = strong(this);
    if (!view->_isLayoutRoot())
        view->_engine.reset();
    structureChanged();
    view->setNeedsLayout();
    setNeedsDisplay();
    if (view->traitCollection() != previous)
        view->tellTraits(previous);
    didAddSubview(view);
    view->didMoveToSuperview();
}

void UIView::removeFromSuperview() {
    const auto above = superview();
    if (!above)
        return;
    const auto self = strong(this);
    above->willRemoveSubview(self);
    for (auto view = above; view; view = view->superview())
        view->deactivateConstraintsReaching(*this);
    std::erase(above->_subviews, self);
    _superview.reset();
    above->structureChanged();
    above->setNeedsDisplay();
    didMoveToSuperview();
}

bool UIView::isDescendantOfView(const UIView& view) const {
    for (auto at = strong(this); at; at = at->superview()) {
        if (at.get() == &view)
            return true;
    }
    return false;
}

// Geometry

void UIView::setFrame(const CGRect& frame) {
    if (frame == _frame)
        return;
    place(frame);
    auto& root = layoutRoot();
    if (root._engine) {
        root._engine->frameChanged(*this);
        setNeedsLayout();
    }
}

void UIView::setBounds(const CGRect& bounds) {
    if (bounds.origin != _boundsOrigin)
        setNeedsDisplay();
    _boundsOrigin = bounds.origin;
    setFrame({_frame.origin, bounds.size});
}

void UIView::place(const CGRect& frame) {
    const bool sizeChanged = frame.size != _frame.size;
    _frame = frame;
    if (sizeChanged)
        setNeedsLayout();
    setNeedsDisplay();
}

CGPoint UIView::convertPoint_toView(CGPoint point, const UIView& view) const {
    const auto toRoot = [](const UIView& from) {
        CGPoint offset;
        for (auto at = strong(&from); at; at = at->superview()) {
            offset.x += at->_frame.origin.x - at->_boundsOrigin.x;
            offset.y += at->_frame.origin.y - at->_boundsOrigin.y;
        }
        return offset;
    };
    const auto from = toRoot(*this);
    const auto to = toRoot(view);
    return {point.x + from.x - to.x, point.y + from.y - to.y};
}

CGRect UIView::convertRect_toView(const CGRect& rect, const UIView& view) const {
    return {convertPoint_toView(rect.origin, view), rect.size};
}

// Looks

void UIView::setHidden(bool hidden) {
    if (hidden == _hidden)
        return;
    _hidden = hidden;
    // A stack view further up may arrange it or what shows it.
    structureChanged();
    setNeedsDisplay();
}

void UIView::setAlpha(CGFloat alpha) {
    if (alpha == _alpha)
        return;
    _alpha = alpha;
    setNeedsDisplay();
}

void UIView::setBackgroundColor(std::shared_ptr<UIColor> color) {
    _backgroundColor = std::move(color);
    setNeedsDisplay();
}

std::shared_ptr<UIColor> UIView::tintColor() const {
    for (auto at = strong(this); at; at = at->superview()) {
        if (at->_tintColor)
            return at->_tintColor;
    }
    return UIColor::labelColor();
}

void UIView::setTintColor(std::shared_ptr<UIColor> color) {
    _tintColor = std::move(color);
    setNeedsDisplay();
}

void UIView::setCornerRadius(CGFloat radius) {
    _cornerRadius = radius;
    setNeedsDisplay();
}

void UIView::setClipsToBounds(bool clips) {
    _clipsToBounds = clips;
    setNeedsDisplay();
}

std::shared_ptr<UIColor> UIView::_vibrantColor() const {
    const auto above = superview();
    return above ? above->_vibrantColor() : nullptr;
}

void UIView::setNeedsDisplay() {
    for (auto at = strong(this); at && !at->_displayDirty; at = at->superview())
        at->_displayDirty = true;
}

void UIView::_didDisplay() {
    _displayDirty = false;
    for (const auto& subview : _subviews)
        subview->_didDisplay();
}

// Traits

UITraitCollection UIView::traitCollection() const {
    for (auto at = strong(this); at; at = at->superview()) {
        if (at->_traits)
            return *at->_traits;
    }
    return UITraitCollection::system().get();
}

void UIView::setTraitCollection(const std::optional<UITraitCollection>& traits) {
    const auto previous = traitCollection();
    _traits = traits;
    if (traitCollection() != previous)
        tellTraits(previous);
}

void UIView::_traitsDidChange(const UITraitCollection& previous) {
    if (traitCollection() != previous)
        tellTraits(previous);
}

void UIView::tellTraits(const UITraitCollection& previous) {
    structureChanged();
    setNeedsLayout();
    setNeedsDisplay();
    traitCollectionDidChange(previous);
    const auto subviews = _subviews;
    for (const auto& subview : subviews) {
        if (!subview->_traits)
            subview->tellTraits(previous);
    }
}

void UIView::traitCollectionDidChange(const UITraitCollection&) {}

void UIView::setSemanticContentAttribute(UISemanticContentAttribute attribute) {
    _semantic = attribute;
    structureChanged();
    setNeedsDisplay();
}

UIUserInterfaceLayoutDirection UIView::effectiveUserInterfaceLayoutDirection() const {
    switch (_semantic) {
    case UISemanticContentAttribute::ForceLeftToRight:
        return UIUserInterfaceLayoutDirection::LeftToRight;
    case UISemanticContentAttribute::ForceRightToLeft:
        return UIUserInterfaceLayoutDirection::RightToLeft;
    case UISemanticContentAttribute::Unspecified:
        break;
    }
    return traitCollection().layoutDirection;
}

} // namespace orvo
