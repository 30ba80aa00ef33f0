#pragma once

#include "platform/uikit/solver/LayoutSolver.h"

#include <gtest/gtest.h>

#include <initializer_list>

namespace orvo::test {

/// Makes a constraint that must not be refused, and adds it.
inline SolverConstraint added(LayoutSolver& solver,
                              std::initializer_list<LinearTerm> terms,
                              LinearRelation relation,
                              double constant,
                              float priority = SolverLimits::RequiredPriority) {
    const LayoutSolver::Made made =
        solver.makeConstraint({terms.begin(), terms.size()}, relation, constant, priority);
    EXPECT_EQ(made.refusal, SolverRefusal::None);
    EXPECT_EQ(solver.add(made.constraint), SolverRefusal::None);
    return made.constraint;
}

inline SolverConstraint
atLeast(LayoutSolver& solver, SolverVariable variable, double least, float priority = 1000) {
    return added(solver, {{variable, 1}}, LinearRelation::GreaterOrEqual, -least, priority);
}
inline SolverConstraint
atMost(LayoutSolver& solver, SolverVariable variable, double most, float priority = 1000) {
    return added(solver, {{variable, 1}}, LinearRelation::LessOrEqual, -most, priority);
}
inline SolverConstraint
exactly(LayoutSolver& solver, SolverVariable variable, double value, float priority = 1000) {
    return added(solver, {{variable, 1}}, LinearRelation::Equal, -value, priority);
}

} // namespace orvo::test
