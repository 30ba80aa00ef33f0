#include "platform/uikit/solver/Additions.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

namespace {

using namespace orvo;
using namespace orvo::test;
using enum LinearRelation;

std::vector<SolverVariable> changedBy(LayoutSolver& solver) {
    const auto changed = solver.solve().changed;
    return {changed.begin(), changed.end()};
}

TEST(LayoutSolver, VariablesWithoutConstraintsAreZero) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverOutcome outcome = solver.solve();
    EXPECT_EQ(solver.value(x), 0);
    EXPECT_TRUE(outcome.changed.empty());
    EXPECT_TRUE(outcome.conflicts.empty());
}

TEST(LayoutSolver, SolvesEqualitiesAndBothInequalities) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverVariable y = solver.makeVariable();
    const SolverVariable z = solver.makeVariable();
    exactly(solver, x, 12);
    added(solver, {{y, 1}, {x, -1}}, GreaterOrEqual, -5);
    atMost(solver, z, -3);
    solver.solve();
    EXPECT_EQ(solver.value(x), 12);
    EXPECT_EQ(solver.value(y), 17);
    EXPECT_EQ(solver.value(z), -3);
}

TEST(LayoutSolver, MultipliesAndDivides) {
    LayoutSolver solver;
    const SolverVariable width = solver.makeVariable();
    const SolverVariable height = solver.makeVariable();
    exactly(solver, height, 30);
    added(solver, {{height, 16}, {width, -9}}, Equal, 6);
    solver.solve();
    EXPECT_EQ(solver.value(width), 54);
}

TEST(LayoutSolver, SumsUpTermsOfOneVariable) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    added(solver, {{x, 1}, {x, 0.5}, {x, 0.5}}, Equal, -8);
    solver.solve();
    EXPECT_EQ(solver.value(x), 4);
}

TEST(LayoutSolver, TermsThatCancelOutLeaveTheConstantAlone) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    added(solver, {{x, 0.1}, {x, 0.2}, {x, -0.3}}, Equal, 0);
    EXPECT_TRUE(solver.solve().conflicts.empty());
    const SolverConstraint never = added(solver, {{x, 1}, {x, -1}}, Equal, 3);
    const SolverOutcome outcome = solver.solve();
    ASSERT_EQ(outcome.conflicts.size(), 1U);
    EXPECT_EQ(outcome.conflicts[0].members, std::vector{never});
}

TEST(LayoutSolver, ManyWeakConstraintsNeverOutweighAStrongOne) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    exactly(solver, x, 1, 250.5F);
    for (int count = 0; count < 2000; ++count)
        exactly(solver, x, 9'000'000, 250);
    solver.solve();
    EXPECT_EQ(solver.value(x), 1);
}

TEST(LayoutSolver, LargeErrorOfAWeakConstraintNeverBuysASmallOneOfAStrong) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverVariable y = solver.makeVariable();
    added(solver, {{x, 1}, {y, -1000}}, Equal, 0);
    exactly(solver, x, 0.001, 2);
    exactly(solver, y, 1000, 1);
    solver.solve();
    EXPECT_NEAR(solver.value(x), 0.001, 1e-6);
    EXPECT_NEAR(solver.value(y), 0.000001, 1e-6);
}

TEST(LayoutSolver, PrioritiesNextToEachOtherAreStrictToo) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    exactly(solver, x, 5, 749);
    exactly(solver, x, 7, std::nextafter(749.0F, 750.0F));
    solver.solve();
    EXPECT_EQ(solver.value(x), 7);
}

TEST(LayoutSolver, EqualPrioritiesMakeTheSumOfErrorsSmall) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    exactly(solver, x, 10, 500);
    exactly(solver, x, 20, 500);
    exactly(solver, x, 90, 500);
    solver.solve();
    EXPECT_EQ(solver.value(x), 20);
}

TEST(LayoutSolver, ErrorsAreCountedInTheUnitsOfTheSum) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    exactly(solver, x, 10, 500);
    added(solver, {{x, 3}}, Equal, -60, 500);
    exactly(solver, x, 0, 500);
    solver.solve();
    EXPECT_EQ(solver.value(x), 20);
}

TEST(LayoutSolver, SatisfiedInequalitiesCostNothingHoweverFarFromTheirBound) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    atLeast(solver, x, 10, 900);
    atMost(solver, x, 400, 900);
    exactly(solver, x, 390, 1);
    solver.solve();
    EXPECT_EQ(solver.value(x), 390);
}

TEST(LayoutSolver, TiesKeepTheFirstVariableNearestToZero) {
    LayoutSolver solver;
    const SolverVariable first = solver.makeVariable();
    const SolverVariable second = solver.makeVariable();
    added(solver, {{first, 1}, {second, 1}}, Equal, -100);
    atLeast(solver, first, 10);
    atLeast(solver, second, 10);
    atMost(solver, second, 20, 250);
    atMost(solver, first, 20, 250);
    solver.solve();
    EXPECT_EQ(solver.value(first), 20);
    EXPECT_EQ(solver.value(second), 80);
}

TEST(LayoutSolver, TiesLeaveNoTraceOfWhatWasThereBefore) {
    LayoutSolver solver;
    const SolverVariable first = solver.makeVariable();
    const SolverVariable second = solver.makeVariable();
    added(solver, {{first, 1}, {second, -1}}, Equal, 40);
    solver.solve();
    EXPECT_EQ(solver.value(first), 0);
    EXPECT_EQ(solver.value(second), 40);
    const SolverConstraint held = exactly(solver, second, -7);
    solver.solve();
    EXPECT_EQ(solver.value(first), -47);
    EXPECT_EQ(solver.remove(held), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(solver.value(first), 0);
    EXPECT_EQ(solver.value(second), 40);
}

TEST(LayoutSolver, ConstantThatCarriesATiedVariableAcrossZeroBreaksTheTieAnew) {
    LayoutSolver solver;
    const SolverVariable first = solver.makeVariable();
    const SolverVariable second = solver.makeVariable();
    const SolverConstraint lower = added(solver, {{first, 1}, {second, 1}}, GreaterOrEqual, -10);
    added(solver, {{first, 1}, {second, 1}}, LessOrEqual, -30);
    atMost(solver, second, 5);
    solver.solve();
    EXPECT_EQ(solver.value(first), 5);
    EXPECT_EQ(solver.setConstant(lower, 10), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(solver.value(first), 0);
    EXPECT_EQ(solver.value(second), 0);
}

TEST(LayoutSolver, ConstantsChangeWithoutARebuild) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverVariable y = solver.makeVariable();
    const SolverConstraint base = exactly(solver, x, 10);
    added(solver, {{y, 1}, {x, -2}}, Equal, -1);
    solver.solve();
    const std::uint64_t pivots = solver.pivotCount();
    EXPECT_EQ(solver.setConstant(base, -50), SolverRefusal::None);
    EXPECT_EQ(solver.constant(base), -50);
    solver.solve();
    EXPECT_EQ(solver.value(x), 50);
    EXPECT_EQ(solver.value(y), 101);
    EXPECT_EQ(solver.pivotCount(), pivots);
}

TEST(LayoutSolver, ChangesTakeEffectOnlyWhenSolved) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint held = exactly(solver, x, 10);
    solver.solve();
    EXPECT_EQ(solver.setConstant(held, -20), SolverRefusal::None);
    EXPECT_EQ(solver.value(x), 10);
    EXPECT_EQ(solver.remove(held), SolverRefusal::None);
    exactly(solver, x, 30);
    solver.solve();
    EXPECT_EQ(solver.value(x), 30);
}

TEST(LayoutSolver, RemovedConstraintsComeBackWithTheirConstant) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint held = exactly(solver, x, 10);
    solver.solve();
    EXPECT_EQ(solver.remove(held), SolverRefusal::None);
    EXPECT_EQ(solver.setConstant(held, -15), SolverRefusal::None);
    EXPECT_FALSE(solver.isAdded(held));
    solver.solve();
    EXPECT_EQ(solver.value(x), 0);
    EXPECT_EQ(solver.error(held), 15);
    EXPECT_EQ(solver.add(held), SolverRefusal::None);
    EXPECT_EQ(solver.add(held), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(solver.value(x), 15);
}

TEST(LayoutSolver, RemovingWhatWonLetsTheWeakerHaveItsWay) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint strong = exactly(solver, x, 10, 800);
    exactly(solver, x, 99, 300);
    solver.solve();
    EXPECT_EQ(solver.value(x), 10);
    EXPECT_EQ(solver.remove(strong), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(solver.value(x), 99);
}

TEST(LayoutSolver, PriorityChangesWhoWins) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    exactly(solver, x, 10, 500);
    const SolverConstraint other = exactly(solver, x, 20, 400);
    solver.solve();
    EXPECT_EQ(solver.value(x), 10);
    EXPECT_EQ(solver.setPriority(other, 600), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(solver.value(x), 20);
    EXPECT_EQ(solver.setPriority(other, 1), SolverRefusal::None);
    EXPECT_EQ(solver.priority(other), 1);
    solver.solve();
    EXPECT_EQ(solver.value(x), 10);
    EXPECT_EQ(solver.setPriority(other, 1000), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(solver.value(x), 20);
}

TEST(LayoutSolver, TellsWhichVariablesChangedInTheOrderTheyWereMade) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverVariable y = solver.makeVariable();
    const SolverVariable z = solver.makeVariable();
    const SolverConstraint base = exactly(solver, z, 4);
    added(solver, {{x, 1}, {z, -1}}, Equal, 0);
    exactly(solver, y, 6);
    const SolverVariable v = solver.makeVariable();
    const SolverVariable w = solver.makeVariable();
    added(solver, {{w, 1}, {z, -1}}, Equal, 0);
    added(solver, {{v, 1}, {z, -1}}, Equal, 0);
    EXPECT_EQ(changedBy(solver), (std::vector{x, y, z, v, w}));
    EXPECT_EQ(changedBy(solver), std::vector<SolverVariable>());
    EXPECT_EQ(solver.setConstant(base, -5), SolverRefusal::None);
    EXPECT_EQ(changedBy(solver), (std::vector{x, z, v, w}));
    EXPECT_EQ(solver.setConstant(base, -6), SolverRefusal::None);
    EXPECT_EQ(solver.setConstant(base, -5), SolverRefusal::None);
    EXPECT_EQ(changedBy(solver), std::vector<SolverVariable>());
}

TEST(LayoutSolver, ValuesAreRoundedFinerThanAnyPixel) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    added(solver, {{x, 3}}, Equal, -1);
    solver.solve();
    EXPECT_EQ(solver.value(x), std::round((1 << 20) / 3.0) / (1 << 20));
}

TEST(LayoutSolver, RefusesWhatIsBeyondItsArithmeticAndChangesNothing) {
    constexpr double Infinity = std::numeric_limits<double>::infinity();
    constexpr double NotANumber = std::numeric_limits<double>::quiet_NaN();
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint held = exactly(solver, x, 10, 500);
    const auto refusal = [&](double coefficient, double constant, float priority) {
        const LinearTerm term{x, coefficient};
        const auto made = solver.makeConstraint({&term, 1}, Equal, constant, priority);
        EXPECT_EQ(static_cast<bool>(made.constraint), made.refusal == SolverRefusal::None);
        return made.refusal;
    };
    EXPECT_EQ(refusal(1, 1e7, 1000), SolverRefusal::None);
    EXPECT_EQ(refusal(1, NotANumber, 1000), SolverRefusal::NotFinite);
    EXPECT_EQ(refusal(1, -Infinity, 1000), SolverRefusal::NotFinite);
    EXPECT_EQ(refusal(1, -1.1e7, 1000), SolverRefusal::ConstantTooLarge);
    EXPECT_EQ(refusal(NotANumber, 0, 1000), SolverRefusal::NotFinite);
    EXPECT_EQ(refusal(1e-4, 0, 1000), SolverRefusal::CoefficientOutOfRange);
    EXPECT_EQ(refusal(-1001, 0, 1000), SolverRefusal::CoefficientOutOfRange);
    EXPECT_EQ(refusal(0, 0, 1000), SolverRefusal::None);
    EXPECT_EQ(refusal(1, 0, 0.5F), SolverRefusal::PriorityOutOfRange);
    EXPECT_EQ(refusal(1, 0, 1000.5F), SolverRefusal::PriorityOutOfRange);
    EXPECT_EQ(refusal(1, 0, static_cast<float>(NotANumber)), SolverRefusal::NotFinite);

    EXPECT_EQ(solver.setConstant(held, NotANumber), SolverRefusal::NotFinite);
    EXPECT_EQ(solver.setConstant(held, 2e7), SolverRefusal::ConstantTooLarge);
    EXPECT_EQ(solver.setPriority(held, 0), SolverRefusal::PriorityOutOfRange);
    solver.solve();
    EXPECT_EQ(solver.value(x), 10);
    EXPECT_EQ(solver.priority(held), 500);
}

TEST(LayoutSolver, NamesOfWhatIsGoneNameNothing) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint held = exactly(solver, x, 10);
    solver.solve();
    EXPECT_EQ(solver.destroy(x), SolverRefusal::StillInUse);
    EXPECT_EQ(solver.destroy(held), SolverRefusal::None);
    EXPECT_EQ(solver.destroy(held), SolverRefusal::UnknownConstraint);
    EXPECT_EQ(solver.destroy(x), SolverRefusal::None);
    EXPECT_EQ(solver.destroy(x), SolverRefusal::UnknownVariable);

    const SolverVariable y = solver.makeVariable();
    const SolverConstraint other = exactly(solver, y, 3);
    solver.solve();
    EXPECT_EQ(solver.value(x), 0);
    EXPECT_EQ(solver.value(y), 3);
    EXPECT_EQ(solver.add(held), SolverRefusal::UnknownConstraint);
    EXPECT_EQ(solver.remove(held), SolverRefusal::UnknownConstraint);
    EXPECT_EQ(solver.setConstant(held, 1), SolverRefusal::UnknownConstraint);
    EXPECT_EQ(solver.setPriority(held, 1), SolverRefusal::UnknownConstraint);
    EXPECT_EQ(solver.describe(held), "");
    EXPECT_EQ(solver.error(held), 0);
    EXPECT_TRUE(solver.isAdded(other));
    EXPECT_FALSE(solver.isAdded(SolverConstraint()));
    const LinearTerm term{x};
    EXPECT_EQ(solver.makeConstraint({&term, 1}, Equal, 0).refusal, SolverRefusal::UnknownVariable);
}

TEST(LayoutSolver, VariablesComeAndGoWhileOthersStay) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    exactly(solver, x, 10);
    for (int round = 0; round < 200; ++round) {
        const SolverVariable y = solver.makeVariable();
        const SolverVariable z = solver.makeVariable();
        const SolverConstraint above = added(solver, {{y, 1}, {x, -1}}, Equal, -round);
        const SolverConstraint beside = added(solver, {{z, 2}, {y, -1}}, GreaterOrEqual, 0);
        solver.solve();
        ASSERT_EQ(solver.value(y), 10 + round);
        ASSERT_EQ(solver.value(z), (10 + round) / 2.0);
        for (const SolverConstraint constraint : {above, beside})
            ASSERT_EQ(solver.destroy(constraint), SolverRefusal::None);
        for (const SolverVariable variable : {y, z})
            ASSERT_EQ(solver.destroy(variable), SolverRefusal::None);
    }
    EXPECT_EQ(solver.describe(), "c2: v1 - 10 = 0\nv1 = 10\n");
}

TEST(LayoutSolver, DescribesItself) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverVariable y = solver.makeVariable();
    added(solver, {{x, 1}, {y, -2}}, GreaterOrEqual, 8, 750);
    exactly(solver, y, 10);
    exactly(solver, y, 12);
    const SolverConstraint idle = atMost(solver, x, -0.5, 749.5F);
    atMost(solver, x, 9);
    added(solver, {}, Equal, 2, 1);
    EXPECT_EQ(solver.remove(idle), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(solver.describe(),
              "c3: v1 - 2 v2 + 8 >= 0 @750, off by 3\n"
              "c4: v2 - 10 = 0\n"
              "c5: v2 - 12 = 0, left out, off by 2\n"
              "c6: v1 + 0.5 <= 0 @749.5, not added\n"
              "c7: v1 - 9 <= 0\n"
              "c8: 2 = 0 @1, off by 2\n"
              "v1 = 9\n"
              "v2 = 10\n");
}

TEST(LayoutSolver, MovesWithAllItHolds) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint held = exactly(solver, x, 10);
    LayoutSolver moved = std::move(solver);
    moved.solve();
    EXPECT_EQ(moved.value(x), 10);
    EXPECT_TRUE(moved.isAdded(held));
}

} // namespace
