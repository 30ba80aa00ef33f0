#include "platform/uikit/_LayoutEngine.h"

#include "platform/foundation/Log.h"

#include <algorithm>
#include <cmath>
#include <tuple>

namespace orvo {

namespace {

// Heights that change widths that change heights: what has not settled by then stays as it is.
constexpr int MostHeightRounds = 4;
constexpr int MostLineRounds = 200;

LinearRelation relationOf(NSLayoutRelation relation) {
    switch (relation) {
    case NSLayoutRelation::LessThanOrEqual:
        return LinearRelation::LessOrEqual;
    case NSLayoutRelation::GreaterThanOrEqual:
        return LinearRelation::GreaterOrEqual;
    case NSLayoutRelation::Equal:
        break;
    }
    return LinearRelation::Equal;
}

const Log& layoutLog() {
    static const auto log = Log::findOrCreate("Layout");
    return *log;
}

} // namespace

_LayoutEngine::_LayoutEngine(UIView& root)
    : _root(root) {}

_LayoutEngine::~_LayoutEngine() = default;

void _LayoutEngine::structureChanged() {
    _structureDirty = true;
    _dirty = true;
    _root._setSubtreeNeedsLayout();
}

void _LayoutEngine::constantChanged(const NSLayoutConstraint& constraint) {
    _dirty = true;
    _root._setSubtreeNeedsLayout();
    const auto found = _installed.find(constraint._creationNumber());
    if (found != _installed.end())
        std::ignore =
            _solver.setConstant(found->second.handle, found->second.offset - constraint.constant());
}

void _LayoutEngine::contentChanged(const UIView& view) {
    if (!_structureDirty && !_items.contains(view._creationNumber()))
        return;
    _contentDirty = true;
    _dirty = true;
}

void _LayoutEngine::frameChanged(const UIView& view) {
    const auto found = _items.find(view._creationNumber());
    if (found == _items.end())
        return;
    if (isRoot(view))
        updateRoot();
    else if (found->second.frame.isInstalled())
        setFrame(found->second, view);
    else
        return;
    _dirty = true;
}

void _LayoutEngine::solve() {
    if (!_dirty)
        return;
    update();
    solveWithTexts();
    _dirty = false;
    askForLayout();
}

CGSize
_LayoutEngine::fittingSize(CGSize target, UILayoutPriority horizontal, UILayoutPriority vertical) {
    update();
    const auto variables = itemFor(_root).variables;
    const auto aim = [this](SolverVariable side, CGFloat length, UILayoutPriority priority) {
        const LinearTerm term{side, 1};
        const auto made = _solver.makeConstraint(
            {&term, 1}, LinearRelation::Equal, -length, static_cast<float>(priority));
        std::ignore = _solver.add(made.constraint);
        return made.constraint;
    };
    for (const auto side : _rootSize)
        std::ignore = _solver.remove(side);
    const auto width = aim(variables.width, target.width, horizontal);
    const auto height = aim(variables.height, target.height, vertical);
    solveWithTexts();
    const CGSize size{_solver.value(variables.width), _solver.value(variables.height)};
    std::ignore = _solver.destroy(width);
    std::ignore = _solver.destroy(height);
    for (const auto side : _rootSize)
        std::ignore = _solver.add(side);
    _contentDirty = true;
    _dirty = true;
    return size;
}

void _LayoutEngine::update() {
    if (_structureDirty)
        synchronise();
    if (_contentDirty)
        updateContent();
}

void _LayoutEngine::synchronise() {
    _structureDirty = false;
    _contentDirty = true;
    const auto wanted = constraints();
    std::vector<_ConstraintShape> shapes;
    shapes.reserve(wanted.size());
    for (auto& [number, installed] : _installed)
        installed.isUsed = false;
    for (const auto& constraint : wanted) {
        const auto& shape = shapes.emplace_back(_ConstraintShape::of(*constraint, _root));
        const auto found = _installed.find(constraint->_creationNumber());
        if (found != _installed.end())
            found->second.isUsed = found->second.shape == shape;
    }
    std::erase_if(_installed, [this](auto& entry) {
        if (!entry.second.isUsed)
            std::ignore = _solver.destroy(entry.second.handle);
        return !entry.second.isUsed;
    });
    for (auto& [number, item] : _items)
        item.isUsed = false;
    itemFor(_root);
    for (std::size_t i = 0; i < wanted.size(); ++i)
        install(wanted[i], shapes[i]);
    removeUnusedItems();
    updateRoot();
}

std::vector<std::shared_ptr<NSLayoutConstraint>> _LayoutEngine::constraints() const {
    std::vector<std::shared_ptr<NSLayoutConstraint>> all;
    collect(_root, all);
    return all;
}

void _LayoutEngine::collect(UIView& view,
                            std::vector<std::shared_ptr<NSLayoutConstraint>>& into) const {
    for (const auto& constraint : view.constraints()) {
        if (constraint->_hasItems())
            into.push_back(constraint);
    }
    const auto own = view._ownConstraints();
    into.insert(into.end(), own.begin(), own.end());
    for (const auto& subview : view.subviews()) {
        if (!subview->_isLayoutRoot())
            collect(*subview, into);
    }
}

bool _LayoutEngine::isRoot(const UILayoutItem& object) const {
    return &object == static_cast<const UILayoutItem*>(&_root);
}

_LayoutEngine::Item& _LayoutEngine::itemFor(UILayoutItem& object) {
    auto& held = _ConstraintShape::placeholderOf(object, _root);
    const auto [found, isNew] = _items.try_emplace(held._creationNumber());
    auto& item = found->second;
    if (isNew) {
        item.object = strong(&held);
        if (!isRoot(held)) {
            item.variables.left = _solver.makeVariable();
            item.variables.top = _solver.makeVariable();
        }
        item.variables.width = _solver.makeVariable();
        item.variables.height = _solver.makeVariable();
    }
    if (item.isUsed)
        return item;
    item.isUsed = true;
    if (isRoot(held))
        return item;
    // Frames are given and told relative to the view above.
    auto* const view = held._asView();
    if (auto* const above = view ? view->superview().get() : held._layoutView())
        itemFor(*above);
    if (view && view->translatesAutoresizingMaskIntoConstraints())
        setFrame(item, *view);
    else
        item.frame.remove(_solver);
    return item;
}

void _LayoutEngine::removeUnusedItems() {
    for (auto& [number, item] : _items) {
        if (item.isUsed)
            continue;
        item.frame.remove(_solver);
        item.content.remove(_solver);
    }
    std::erase_if(_items, [this](auto& entry) {
        const auto& variables = entry.second.variables;
        if (!entry.second.isUsed) {
            for (const auto variable :
                 {variables.left, variables.top, variables.width, variables.height})
                std::ignore = _solver.destroy(variable);
        }
        return !entry.second.isUsed;
    });
}

void _LayoutEngine::install(const std::shared_ptr<NSLayoutConstraint>& constraint,
                            const _ConstraintShape& shape) {
    itemFor(*shape.first);
    if (shape.second)
        itemFor(*shape.second);
    const auto [found, isNew] = _installed.try_emplace(constraint->_creationNumber());
    auto& installed = found->second;
    if (!isNew) {
        std::ignore =
            _solver.setConstant(installed.handle, installed.offset - constraint->constant());
        return;
    }
    installed.object = constraint;
    installed.shape = shape;
    installed.hasBaseline = _ConstraintShape::isBaseline(constraint->firstAttribute()) ||
                            _ConstraintShape::isBaseline(constraint->secondAttribute());
    installed.offset = shape.baselineOffset(*constraint);
    installed.handle = make(*constraint, installed);
}

SolverConstraint _LayoutEngine::make(const NSLayoutConstraint& constraint,
                                     const Installed& installed) {
    const auto& shape = installed.shape;
    _LayoutExpression expression(itemFor(_root).variables.width, shape.rightToLeft);
    const auto holder = constraint._holderView();
    const auto origin = itemFor(holder ? *holder : _root).variables;
    const double multiplier = constraint.multiplier();
    const auto addSide = [&](UILayoutItem& item, NSLayoutAttribute attribute, double factor) {
        const auto edge = _ConstraintShape::edgeOf(item, attribute);
        expression.add(itemFor(item).variables, edge, factor);
        // Where positions are multiplied, it matters where they are counted from.
        if (multiplier != 1)
            expression.add(origin, _LayoutExpression::originOf(edge), -factor);
    };
    addSide(*shape.first, constraint.firstAttribute(), 1);
    if (shape.second)
        addSide(*shape.second, constraint.secondAttribute(), -multiplier);
    const auto made = _solver.makeConstraint(expression.terms(),
                                             relationOf(constraint.relation()),
                                             installed.offset - constraint.constant(),
                                             static_cast<float>(constraint.priority()));
    if (made.refusal != SolverRefusal::None)
        layoutLog().error(
            "Ignoring constraint %@: %@", constraint.description(), describe(made.refusal));
    std::ignore = _solver.add(made.constraint);
    return made.constraint;
}

void _LayoutEngine::setFrame(Item& item, const UIView& view) {
    item.frame.update(_solver, item.variables, itemFor(*view.superview()).variables, view);
}

void _LayoutEngine::updateRoot() {
    const auto& variables = itemFor(_root).variables;
    const auto& size = _root.frame().size;
    const auto set = [this](SolverConstraint& side,
                            SolverVariable variable,
                            CGFloat length,
                            UILayoutPriority priority) {
        if (side) {
            std::ignore = _solver.setConstant(side, -length);
            return;
        }
        const LinearTerm term{variable, 1};
        side = _solver
                   .makeConstraint(
                       {&term, 1}, LinearRelation::Equal, -length, static_cast<float>(priority))
                   .constraint;
        std::ignore = _solver.add(side);
    };
    set(_rootSize[0], variables.width, size.width, UILayoutPriorityRequired);
    set(_rootSize[1], variables.height, size.height, _root._rootHeightPriority());
}

void _LayoutEngine::updateContent() {
    _contentDirty = false;
    for (auto& [number, item] : _items) {
        const auto object = item.object.lock();
        const auto* view = object ? object->_asView() : nullptr;
        if (!view || isRoot(*view) || item.frame.isInstalled())
            item.content.remove(_solver);
        else
            item.content.update(_solver, item.variables, *view);
    }
    for (auto& [number, installed] : _installed) {
        const auto constraint = installed.hasBaseline ? installed.object.lock() : nullptr;
        if (!constraint)
            continue;
        installed.offset = installed.shape.baselineOffset(*constraint);
        std::ignore =
            _solver.setConstant(installed.handle, installed.offset - constraint->constant());
    }
}

void _LayoutEngine::solveWithTexts() {
    runSolver();
    for (int round = 0; round < MostHeightRounds && fitHeights(); ++round)
        runSolver();
    for (int round = 0; round < MostLineRounds && dropLines(); ++round)
        runSolver();
}

bool _LayoutEngine::fitHeights() {
    bool changed = false;
    for (auto& [number, item] : _items) {
        if (!item.content.wraps())
            continue;
        const auto object = item.object.lock();
        const auto* view = object ? object->_asView() : nullptr;
        changed = item.content.fitHeight(_solver, item.variables, *view) || changed;
    }
    return changed;
}

/// One text at a time: the one that resists least, of equals the one made last.
bool _LayoutEngine::dropLines() {
    Item* weakest = nullptr;
    UILayoutPriority least = UILayoutPriorityRequired;
    for (auto& [number, item] : _items) {
        if (!item.content.canDropLines(_solver, item.variables))
            continue;
        const auto object = item.object.lock();
        const auto resistance = object->_asView()->contentCompressionResistancePriorityForAxis(
            UILayoutConstraintAxis::Vertical);
        if (resistance > least)
            continue;
        least = resistance;
        weakest = &item;
    }
    if (!weakest)
        return false;
    const auto object = weakest->object.lock();
    return weakest->content.dropLines(_solver, weakest->variables, *object->_asView());
}

void _LayoutEngine::runSolver() {
    const auto outcome = _solver.solve();
    if (outcome.isStalled)
        layoutLog().error("The layout of %@ did not come to an end", _root._layoutName());
    if (!outcome.conflictsChanged)
        return;
    for (const auto& conflict : outcome.conflicts)
        log(conflict);
}

void _LayoutEngine::log(const SolverConflict& conflict) const {
    std::string members;
    for (const auto member : conflict.members)
        members += "\n    " + nameOf(member);
    layoutLog().error("Constraints of %@ contradict one another:%@\nLeaving out: %@",
                      _root._layoutName(),
                      members,
                      nameOf(conflict.dropped));
}

std::string _LayoutEngine::nameOf(SolverConstraint constraint) const {
    for (const auto& [number, installed] : _installed) {
        const auto object = installed.object.lock();
        if (installed.handle == constraint && object)
            return object->description();
    }
    if (constraint == _rootSize[0] || constraint == _rootSize[1])
        return "the size of " + _root._layoutName();
    for (const auto& [number, item] : _items) {
        const auto object = item.object.lock();
        const std::string name = object ? object->_layoutName() : "(gone)";
        if (item.frame.contains(constraint))
            return "the given frame of " + name;
        if (const auto content = item.content.nameOf(constraint); !content.empty())
            return name + "." + content;
    }
    return _solver.describe(constraint);
}

std::optional<CGRect> _LayoutEngine::solvedFrame(const UILayoutItem& object) const {
    const auto found =
        _items.find(_ConstraintShape::placeholderOf(const_cast<UILayoutItem&>(object), _root)
                        ._creationNumber());
    if (found == _items.end())
        return std::nullopt;
    const auto& variables = found->second.variables;
    return CGRect{{_solver.value(variables.left), _solver.value(variables.top)},
                  {_solver.value(variables.width), _solver.value(variables.height)}};
}

std::optional<CGRect> _LayoutEngine::pixelFrame(const UILayoutItem& object) const {
    const auto frame = solvedFrame(object);
    if (!frame)
        return std::nullopt;
    const double scale = _root.traitCollection().displayScale;
    const CGFloat left = UIRoundToScale(frame->origin.x, scale);
    const CGFloat top = UIRoundToScale(frame->origin.y, scale);
    const CGFloat right = UIRoundToScale(frame->origin.x + frame->size.width, scale);
    const CGFloat bottom = UIRoundToScale(frame->origin.y + frame->size.height, scale);
    return CGRect{{left, top}, {right - left, bottom - top}};
}

void _LayoutEngine::askForLayout() {
    for (const auto& [number, item] : _items) {
        const auto object = item.object.lock();
        if (!object || isRoot(*object))
            continue;
        auto* const view = object->_asView();
        if (view)
            view->_didSolveSize(solvedFrame(*view)->size);
        const auto above = view ? view->superview() : strong(object->_layoutView());
        const auto frame = above->_placeOf(*object, *this);
        if (frame && *frame != object->_placedFrame())
            above->setNeedsLayout();
    }
}

} // namespace orvo
