#include "platform/foundation/Log.h"
#include "platform/uikit/UIView.h"
#include "platform/uikit/_LayoutEngine.h"

#include <algorithm>
#include <array>
#include <cmath>

// A view's part in layout; the view itself is in UIView.cpp.

namespace orvo {

namespace {

// Each pass lays out what the one before asked for; a view that asks again in each never settles.
constexpr int MostPasses = 8;

std::size_t indexOf(UILayoutConstraintAxis axis) {
    return static_cast<std::size_t>(axis);
}

bool liesIn(const UILayoutItem* item, const UIView& subtree) {
    const auto* view = item ? item->_layoutView() : nullptr;
    return view && view->isDescendantOfView(subtree);
}

} // namespace

// Constraints

UIView& UIView::layoutRoot() {
    auto* at = this;
    while (!at->isLayoutRoot())
        at = at->_superview.lock().get();
    return *at;
}

_LayoutEngine& UIView::_layoutEngine() {
    auto& root = layoutRoot();
    if (!root._engine)
        root._engine = std::make_unique<_LayoutEngine>(root);
    return *root._engine;
}

void UIView::structureChanged() {
    auto& root = layoutRoot();
    if (root._engine)
        root._engine->structureChanged();
    root.setNeedsLayout();
}

void UIView::_holdConstraint(const std::shared_ptr<NSLayoutConstraint>& constraint) {
    _constraints.push_back(constraint);
    structureChanged();
}

void UIView::_releaseConstraint(NSLayoutConstraint& constraint) {
    const auto found =
        std::ranges::find(_constraints, &constraint, [](const auto& each) { return each.get(); });
    if (found == _constraints.end())
        return;
    const auto kept = *found;
    _constraints.erase(found);
    kept->_wasReleased();
    structureChanged();
}

void UIView::deactivateConstraintsReaching(const UIView& subtree) {
    std::erase_if(_constraints, [&subtree](const auto& constraint) {
        const bool reaches = liesIn(constraint->_firstLayoutItem(), subtree) ||
                             liesIn(constraint->_secondLayoutItem(), subtree);
        if (reaches)
            constraint->_wasReleased();
        return reaches;
    });
}

void UIView::setTranslatesAutoresizingMaskIntoConstraints(bool translates) {
    if (translates == _translatesFrame)
        return;
    _translatesFrame = translates;
    structureChanged();
}

void UIView::_setFillsSuperview(bool fills) {
    _fills = fills;
    structureChanged();
}

NSLayoutYAxisAnchor UIView::firstBaselineAnchor() const {
    return {weakItem(), NSLayoutAttribute::FirstBaseline};
}

NSLayoutYAxisAnchor UIView::lastBaselineAnchor() const {
    return {weakItem(), NSLayoutAttribute::LastBaseline};
}

void UIView::addLayoutGuide(const std::shared_ptr<UILayoutGuide>& guide) {
    if (const auto owner = guide->owningView())
        owner->removeLayoutGuide(guide);
    guide->_owner = strong(this);
    _guides.push_back(guide);
}

void UIView::removeLayoutGuide(const std::shared_ptr<UILayoutGuide>& guide) {
    if (std::erase(_guides, guide) == 0)
        return;
    for (auto view = strong(this); view; view = view->superview()) {
        const auto constraints = view->_constraints;
        for (const auto& constraint : constraints) {
            if (constraint->firstItem() == guide || constraint->secondItem() == guide)
                constraint->setActive(false);
        }
    }
    guide->_owner.reset();
}

void UIView::setDirectionalLayoutMargins(const NSDirectionalEdgeInsets& margins) {
    _margins = margins;
    if (_marginConstraints.empty())
        return;
    const std::array lengths{margins.leading, margins.top, -margins.trailing, -margins.bottom};
    for (std::size_t i = 0; i < lengths.size(); ++i)
        _marginConstraints.at(i)->setConstant(lengths.at(i));
}

std::shared_ptr<UILayoutGuide> UIView::layoutMarginsGuide() {
    if (_marginsGuide)
        return _marginsGuide;
    _marginsGuide = UILayoutGuide::init();
    _marginsGuide->setIdentifier("margins");
    addLayoutGuide(_marginsGuide);
    _marginConstraints = {
        _marginsGuide->leadingAnchor().constraintEqualToAnchor(leadingAnchor()),
        _marginsGuide->topAnchor().constraintEqualToAnchor(topAnchor()),
        _marginsGuide->trailingAnchor().constraintEqualToAnchor(trailingAnchor()),
        _marginsGuide->bottomAnchor().constraintEqualToAnchor(bottomAnchor()),
    };
    setDirectionalLayoutMargins(_margins);
    NSLayoutConstraint::activateConstraints(_marginConstraints);
    return _marginsGuide;
}

std::vector<std::shared_ptr<NSLayoutConstraint>> UIView::_ownConstraints() {
    return {};
}

// Sizes

std::shared_ptr<UIView> UIView::viewForFirstBaselineLayout() {
    return strong(this);
}

std::shared_ptr<UIView> UIView::viewForLastBaselineLayout() {
    return strong(this);
}

CGSize UIView::intrinsicContentSize() const {
    return {UIViewNoIntrinsicMetric, UIViewNoIntrinsicMetric};
}

void UIView::invalidateIntrinsicContentSize() {
    auto& root = layoutRoot();
    if (root._engine)
        root._engine->contentChanged(*this);
    root.setNeedsLayout();
}

UILayoutPriority UIView::contentHuggingPriorityForAxis(UILayoutConstraintAxis axis) const {
    return _hugging.at(indexOf(axis));
}

void UIView::setContentHuggingPriority_forAxis(UILayoutPriority priority,
                                               UILayoutConstraintAxis axis) {
    _hugging.at(indexOf(axis)) = priority;
    invalidateIntrinsicContentSize();
}

UILayoutPriority
UIView::contentCompressionResistancePriorityForAxis(UILayoutConstraintAxis axis) const {
    return _compression.at(indexOf(axis));
}

void UIView::setContentCompressionResistancePriority_forAxis(UILayoutPriority priority,
                                                             UILayoutConstraintAxis axis) {
    _compression.at(indexOf(axis)) = priority;
    invalidateIntrinsicContentSize();
}

CGSize UIView::systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
    CGSize target, UILayoutPriority horizontal, UILayoutPriority vertical) {
    const auto fitting = [&](_LayoutEngine& engine) {
        const auto size = engine.fittingSize(target, horizontal, vertical);
        const double scale = traitCollection().displayScale;
        // Whole device pixels that the content fits into; the solver's rounding asks for no more.
        const auto roundUp = [scale](CGFloat length) {
            return std::ceil(length * scale - 0.001) / scale;
        };
        return CGSize{roundUp(size.width), roundUp(size.height)};
    };
    if (isLayoutRoot())
        return fitting(_layoutEngine());
    _LayoutEngine engine(*this);
    return fitting(engine);
}

CGSize UIView::systemLayoutSizeFittingSize(CGSize target) {
    return systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
        target, UILayoutPriorityFittingSizeLevel, UILayoutPriorityFittingSizeLevel);
}

// The layout pass

void UIView::setNeedsLayout() {
    _needsLayout = true;
    if (const auto above = superview())
        above->_setSubtreeNeedsLayout();
}

void UIView::_setSubtreeNeedsLayout() {
    for (auto at = strong(this); at && !at->_subtreeNeedsLayout; at = at->superview())
        at->_subtreeNeedsLayout = true;
}

void UIView::layoutIfNeeded() {
    for (int pass = 0; pass < MostPasses; ++pass) {
        layoutRoot()._layoutEngine().solve();
        if (!_needsLayout && !_subtreeNeedsLayout)
            return;
        layOutTree();
    }
    Log::findOrCreate("Layout")->error("The layout of %@ does not settle", _layoutName());
}

void UIView::layOutTree() {
    if (isLayoutRoot())
        _layoutEngine().solve();
    if (_needsLayout) {
        _needsLayout = false;
        placeGuides(); // before an override asks for them
        layoutSubviews();
    }
    _subtreeNeedsLayout = false;
    const auto subviews = _subviews;
    for (const auto& subview : subviews) {
        if (subview->_needsLayout || subview->_subtreeNeedsLayout)
            subview->layOutTree();
    }
}

void UIView::layoutSubviews() {
    auto& engine = layoutRoot()._layoutEngine();
    for (const auto& subview : _subviews) {
        if (subview->_fills) {
            subview->place({{0, 0}, _frame.size});
        } else if (!subview->_translatesFrame) {
            if (const auto frame = _placeOf(*subview, engine); frame && *frame != subview->_frame)
                subview->place(*frame);
        }
    }
}

void UIView::placeGuides() {
    auto& engine = layoutRoot()._layoutEngine();
    for (const auto& guide : _guides) {
        if (const auto frame = _placeOf(*guide, engine))
            guide->_layoutFrame = *frame;
    }
}

std::optional<CGRect> UIView::_placeOf(const UILayoutItem& item,
                                       const _LayoutEngine& engine) const {
    auto frame = engine.pixelFrame(item);
    const auto own = engine.pixelFrame(*this);
    if (!frame || !own)
        return std::nullopt;
    frame->origin.x -= own->origin.x;
    frame->origin.y -= own->origin.y;
    return frame;
}

} // namespace orvo
