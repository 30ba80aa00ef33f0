#pragma once

#include "platform/uikit/NSLayoutConstraint.h"
#include "platform/uikit/solver/LinearConstraint.h"

#include <vector>

namespace orvo {

/// The rectangle of a view or guide in the coordinates of the root. What names nothing is 0.
struct _LayoutVariables {
    SolverVariable left;
    SolverVariable top;
    SolverVariable width;
    SolverVariable height;
};

/// A sum of variables and a constant, which grows by one attribute after the other.
class _LayoutExpression {
public:
    /// Leading edges are counted from the side of the root where reading starts: with
    /// `rightToLeft` they grow to the left from its width.
    _LayoutExpression(SolverVariable rootWidth, bool rightToLeft);

    /// Any attribute but a baseline, as often as `factor` says.
    void add(const _LayoutVariables& item, NSLayoutAttribute attribute, double factor);
    void add(double constant) noexcept { _constant += constant; }

    [[nodiscard]] const std::vector<LinearTerm>& terms() const noexcept { return _terms; }
    [[nodiscard]] double constant() const noexcept { return _constant; }

    /// The edge that positions of this kind are counted from; for lengths there is none.
    [[nodiscard]] static NSLayoutAttribute originOf(NSLayoutAttribute attribute) noexcept;

private:
    void add(SolverVariable variable, double factor);

    SolverVariable _rootWidth;
    bool _rightToLeft;
    std::vector<LinearTerm> _terms;
    double _constant = 0;
};

} // namespace orvo
