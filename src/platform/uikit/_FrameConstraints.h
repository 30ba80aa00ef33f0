#pragma once

#include "platform/uikit/UIView.h"
#include "platform/uikit/_LayoutExpression.h"
#include "platform/uikit/solver/LayoutSolver.h"

#include <array>

namespace orvo {

/// Holds a view whose frame is given at that frame, relative to the view above it.
class _FrameConstraints {
public:
    /// Adds what `view` needs now, or changes it; anew when it is in another view than before.
    void update(LayoutSolver& solver,
                const _LayoutVariables& variables,
                const _LayoutVariables& above,
                const UIView& view);
    void remove(LayoutSolver& solver);

    [[nodiscard]] bool isInstalled() const noexcept { return bool(_sides[0]); }
    [[nodiscard]] bool contains(SolverConstraint constraint) const noexcept;

private:
    std::array<SolverConstraint, 4> _sides; // left, top, width, height
    std::uint64_t _above = 0;
};

} // namespace orvo
