#include "platform/uikit/_FrameConstraints.h"

#include <algorithm>

namespace orvo {

void _FrameConstraints::update(LayoutSolver& solver,
                               const _LayoutVariables& variables,
                               const _LayoutVariables& above,
                               const UIView& view) {
    const auto superview = view.superview()->_creationNumber();
    if (superview != _above)
        remove(solver);
    _above = superview;
    const auto set = [&](SolverConstraint& side,
                         SolverVariable variable,
                         SolverVariable origin,
                         CGFloat length) {
        if (side) {
            std::ignore = solver.setConstant(side, -length);
            return;
        }
        std::vector<LinearTerm> terms{{variable, 1}};
        if (origin)
            terms.push_back({origin, -1});
        side = solver.makeConstraint(terms, LinearRelation::Equal, -length).constraint;
        std::ignore = solver.add(side);
    };
    const auto& frame = view.frame();
    set(_sides[0], variables.left, above.left, frame.origin.x);
    set(_sides[1], variables.top, above.top, frame.origin.y);
    set(_sides[2], variables.width, {}, frame.size.width);
    set(_sides[3], variables.height, {}, frame.size.height);
}

void _FrameConstraints::remove(LayoutSolver& solver) {
    for (auto& side : _sides) {
        if (side)
            std::ignore = solver.destroy(side);
        side = {};
    }
}

bool _FrameConstraints::contains(SolverConstraint constraint) const noexcept {
    return std::ranges::find(_sides, constraint) != _sides.end();
}

} // namespace orvo
