#pragma once

#include "platform/uikit/UIView.h"
#include "platform/uikit/_LayoutExpression.h"
#include "platform/uikit/solver/LayoutSolver.h"

#include <array>
#include <string>

namespace orvo {

/// What the content of one view asks of its size: to be no larger (hugging) and no smaller
/// (compression resistance), each as strongly as the view says.
///
/// A text keeps its first line more strongly than further ones. A view keeps its solver no longer
/// than the engine that owns both.
class _ContentConstraints {
public:
    /// Adds what `view` wants now, or changes what it wanted.
    void update(LayoutSolver& solver, const _LayoutVariables& variables, const UIView& view);
    void remove(LayoutSolver& solver);

    /// For a text that wraps: asks for the height at the width that was solved.
    /// @returns whether that is another height than before
    bool fitHeight(LayoutSolver& solver, const _LayoutVariables& variables, const UIView& view);
    /// For a text that was solved to less height than it asked for: asks for as many whole lines as
    /// that height holds.
    /// @returns whether that is another height than before
    bool dropLines(LayoutSolver& solver, const _LayoutVariables& variables, const UIView& view);
    /// Whether it is a text that was solved to less height than it asked for and has lines to lose.
    [[nodiscard]] bool canDropLines(const LayoutSolver& solver,
                                    const _LayoutVariables& variables) const;

    [[nodiscard]] bool wraps() const noexcept { return _wraps; }
    /// `height >= 20 @750 (content)`; empty for a constraint of somebody else.
    [[nodiscard]] std::string nameOf(SolverConstraint constraint) const;

private:
    enum Kind { WidthHugging, WidthResistance, HeightHugging, HeightResistance, FirstLine, Kinds };

    struct Part {
        SolverConstraint handle;
        UILayoutPriority priority = 0;
        CGFloat size = 0;
    };

    void set(LayoutSolver& solver,
             Kind kind,
             SolverVariable variable,
             CGFloat size,
             UILayoutPriority priority);
    void clear(LayoutSolver& solver, Kind kind);
    bool setHeight(LayoutSolver& solver, const _LayoutVariables& variables, CGFloat height);

    std::array<Part, Kinds> _parts;
    CGFloat _firstLine = 0;
    bool _wraps = false;
};

} // namespace orvo
