#include "platform/uikit/solver/Additions.h"

#include <gtest/gtest.h>

#include <vector>

namespace {

using namespace orvo;
using namespace orvo::test;
using enum LinearRelation;

std::vector<SolverConflict> conflictsOf(LayoutSolver& solver) {
    const auto conflicts = solver.solve().conflicts;
    return {conflicts.begin(), conflicts.end()};
}

TEST(LayoutSolverConflict, NamesBothThatContradictAndDropsTheLaterOne) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint first = exactly(solver, x, 10);
    const SolverConstraint second = exactly(solver, x, 20);
    EXPECT_EQ(conflictsOf(solver),
              (std::vector{SolverConflict{.dropped = second, .members = {first, second}}}));
    EXPECT_EQ(solver.value(x), 10);
    EXPECT_TRUE(solver.isDropped(second));
    EXPECT_TRUE(solver.isAdded(second));
    EXPECT_FALSE(solver.isDropped(first));
    EXPECT_EQ(solver.error(second), 10);
}

TEST(LayoutSolverConflict, NamesAWholeChainAndNobodyBesideIt) {
    LayoutSolver solver;
    std::vector<SolverVariable> variables;
    for (int count = 0; count < 6; ++count)
        variables.push_back(solver.makeVariable());
    exactly(solver, variables[5], 3);
    std::vector<SolverConstraint> chain;
    for (std::size_t index = 0; index < 4; ++index)
        chain.push_back(added(
            solver, {{variables[index + 1], 1}, {variables[index], -1}}, GreaterOrEqual, -10));
    atMost(solver, variables[2], 500);
    exactly(solver, variables[0], 1, 900);
    chain.push_back(added(solver, {{variables[4], 1}, {variables[0], -1}}, LessOrEqual, -39.5));
    EXPECT_EQ(conflictsOf(solver),
              (std::vector{SolverConflict{.dropped = chain.back(), .members = chain}}));
}

TEST(LayoutSolverConflict, DropsTheSameOneWhateverTheOrderOfAdding) {
    for (const bool reverse : {false, true}) {
        LayoutSolver solver;
        const SolverVariable x = solver.makeVariable();
        std::vector<SolverConstraint> made;
        for (const double value : {10, 20, 30}) {
            const LinearTerm term{x};
            made.push_back(solver.makeConstraint({&term, 1}, Equal, -value).constraint);
        }
        for (std::size_t index = 0; index < made.size(); ++index) {
            EXPECT_EQ(solver.add(made[reverse ? made.size() - 1 - index : index]),
                      SolverRefusal::None);
            solver.solve();
        }
        EXPECT_EQ(conflictsOf(solver),
                  (std::vector{SolverConflict{.dropped = made[1], .members = {made[0], made[1]}},
                               SolverConflict{.dropped = made[2], .members = {made[0], made[2]}}}));
        EXPECT_EQ(solver.value(x), 10);
    }
}

TEST(LayoutSolverConflict, TellsOnceThatConflictsAreNotWhatTheyWere) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    exactly(solver, x, 10);
    const SolverConstraint second = exactly(solver, x, 20);
    const SolverConstraint weak = exactly(solver, x, 5, 20);
    EXPECT_TRUE(solver.solve().conflictsChanged);
    EXPECT_FALSE(solver.solve().conflictsChanged);
    EXPECT_EQ(solver.setConstant(weak, -6), SolverRefusal::None);
    EXPECT_FALSE(solver.solve().conflictsChanged);
    EXPECT_EQ(conflictsOf(solver).size(), 1U);
    EXPECT_EQ(solver.remove(second), SolverRefusal::None);
    const SolverOutcome outcome = solver.solve();
    EXPECT_TRUE(outcome.conflictsChanged);
    EXPECT_TRUE(outcome.conflicts.empty());
}

TEST(LayoutSolverConflict, DroppedConstraintReturnsWhenThereIsRoom) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint first = exactly(solver, x, 10);
    const SolverConstraint second = atLeast(solver, x, 20);
    EXPECT_EQ(conflictsOf(solver).size(), 1U);
    EXPECT_EQ(solver.setConstant(first, -25), SolverRefusal::None);
    EXPECT_TRUE(conflictsOf(solver).empty());
    EXPECT_EQ(solver.value(x), 25);
    EXPECT_FALSE(solver.isDropped(second));
    EXPECT_EQ(solver.remove(first), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(solver.value(x), 20);
}

TEST(LayoutSolverConflict, ConstantChangesMayBringOneAbout) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverVariable y = solver.makeVariable();
    const SolverConstraint inner = exactly(solver, x, 10);
    const SolverConstraint inside = added(solver, {{y, 1}, {x, -1}}, GreaterOrEqual, 0);
    const SolverConstraint outer = exactly(solver, y, 30);
    EXPECT_TRUE(conflictsOf(solver).empty());
    EXPECT_EQ(solver.setConstant(inner, -31), SolverRefusal::None);
    EXPECT_EQ(conflictsOf(solver),
              (std::vector{SolverConflict{.dropped = outer, .members = {inner, inside, outer}}}));
    EXPECT_EQ(solver.value(y), 31);
}

TEST(LayoutSolverConflict, SayingTheSameTwiceIsNone) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverVariable y = solver.makeVariable();
    const SolverConstraint one = added(solver, {{x, 1}, {y, -1}}, Equal, -7);
    const SolverConstraint same = added(solver, {{y, -3}, {x, 3}}, Equal, -21);
    exactly(solver, y, 1);
    EXPECT_TRUE(conflictsOf(solver).empty());
    EXPECT_EQ(solver.value(x), 8);
    // Both change before anybody looks.
    EXPECT_EQ(solver.setConstant(one, -9), SolverRefusal::None);
    EXPECT_EQ(solver.setConstant(same, -27), SolverRefusal::None);
    EXPECT_TRUE(conflictsOf(solver).empty());
    EXPECT_EQ(solver.value(x), 10);
}

TEST(LayoutSolverConflict, ExchangeBeforeTheSolveIsNone) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint one = exactly(solver, x, 10);
    solver.solve();
    const SolverConstraint other = exactly(solver, x, 20);
    EXPECT_EQ(solver.remove(one), SolverRefusal::None);
    EXPECT_TRUE(conflictsOf(solver).empty());
    EXPECT_EQ(solver.value(x), 20);
    EXPECT_EQ(solver.add(one), SolverRefusal::None);
    EXPECT_EQ(solver.remove(other), SolverRefusal::None);
    EXPECT_TRUE(conflictsOf(solver).empty());
    EXPECT_EQ(solver.value(x), 10);
}

TEST(LayoutSolverConflict, OptionalConstraintsOfTheNextPriorityNeverMakeOne) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    exactly(solver, x, 10, 999.9F);
    exactly(solver, x, 20, 999.9F);
    exactly(solver, x, 15);
    EXPECT_TRUE(conflictsOf(solver).empty());
    EXPECT_EQ(solver.value(x), 15);
}

/// Later ones take the places of some that were made before the first, and are none the earlier.
TEST(LayoutSolverConflict, DropsByTheOrderOfMakingThoughPlacesAreUsedAgain) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint gone[] = {exactly(solver, x, 1), exactly(solver, x, 1)};
    const SolverConstraint low = atMost(solver, x, 10);
    for (const SolverConstraint constraint : gone)
        EXPECT_EQ(solver.destroy(constraint), SolverRefusal::None);
    const SolverConstraint high = atLeast(solver, x, 20);
    const SolverConstraint last = atMost(solver, x, 15);
    EXPECT_LT(last.index, low.index);
    EXPECT_EQ(conflictsOf(solver),
              (std::vector{SolverConflict{.dropped = high, .members = {low, high}}}));
    EXPECT_FALSE(solver.isDropped(last));
}

} // namespace
