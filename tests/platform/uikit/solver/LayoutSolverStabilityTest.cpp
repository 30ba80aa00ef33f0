// Systems on which methods of this kind are known to go round in circles, and what rounding does.

#include "platform/uikit/solver/Additions.h"
#include "platform/uikit/solver/CellSystem.h"

#include <gtest/gtest.h>

#include <cmath>
#include <memory>
#include <random>
#include <vector>

namespace {

using namespace orvo;
using namespace orvo::test;
using enum LinearRelation;

/// A linear programme: rows of coefficients with their upper bounds, all variables at least zero;
/// and what is to be small.
struct Programme {
    std::vector<std::vector<double>> rows;
    std::vector<double> bounds;
    std::vector<double> costs;
};

std::vector<LinearTerm> termsOf(const std::vector<SolverVariable>& variables,
                                const std::vector<double>& coefficients) {
    std::vector<LinearTerm> terms;
    for (std::size_t index = 0; index < variables.size(); ++index)
        terms.push_back({variables[index], coefficients[index]});
    return terms;
}

/// The least cost, with the rows added all at once or one by one, in either order.
std::vector<double> solutionsOf(const Programme& programme) {
    std::vector<double> costs;
    for (const bool oneByOne : {false, true}) {
        for (const bool costsFirst : {false, true}) {
            LayoutSolver solver;
            std::vector<SolverVariable> variables;
            for (std::size_t index = 0; index < programme.costs.size(); ++index)
                variables.push_back(solver.makeVariable());
            const auto add = [&](const std::vector<double>& row, double bound, float priority) {
                const auto made =
                    solver.makeConstraint(termsOf(variables, row), LessOrEqual, -bound, priority);
                EXPECT_EQ(solver.add(made.constraint), SolverRefusal::None);
                EXPECT_FALSE(oneByOne && solver.solve().isStalled);
            };
            if (costsFirst)
                add(programme.costs, -1e5, 1);
            for (const SolverVariable variable : variables)
                atLeast(solver, variable, 0);
            for (std::size_t row = 0; row < programme.rows.size(); ++row)
                add(programme.rows[row], programme.bounds[row], 1000);
            if (!costsFirst)
                add(programme.costs, -1e5, 1);
            EXPECT_FALSE(solver.solve().isStalled);
            double cost = 0;
            for (std::size_t index = 0; index < variables.size(); ++index)
                cost += programme.costs[index] * solver.value(variables[index]);
            costs.push_back(cost);
        }
    }
    return costs;
}

void expectLeastCost(const Programme& programme, double expected) {
    for (const double cost : solutionsOf(programme))
        EXPECT_NEAR(cost, expected, 1e-4);
}

TEST(LayoutSolverStability, EndsWhereTheFirstKnownCycleBegins) { // Beale 1955
    expectLeastCost({.rows = {{0.25, -60, -0.04, 9}, {0.5, -90, -0.02, 3}, {0, 0, 1, 0}},
                     .bounds = {0, 0, 1},
                     .costs = {-0.75, 150, -0.02, 6}},
                    -0.05);
}

TEST(LayoutSolverStability, EndsOnTheSmallestCyclingProgramme) { // Marshall and Suurballe 1969
    expectLeastCost({.rows = {{0.6, -6.4, 4.8}, {0.2, -1.8, 0.6}, {0.4, -1.6, 0.2}, {0, 1, 0}},
                     .bounds = {0, 0, 0, 1},
                     .costs = {-0.4, -0.4, 1.8}},
                    -2);
}

TEST(LayoutSolverStability, EndsOnTheTextbookCycle) { // Chvátal 1983
    expectLeastCost({.rows = {{0.5, -5.5, -2.5, 9}, {0.5, -1.5, -0.5, 1}, {1, 0, 0, 0}},
                     .bounds = {0, 0, 1},
                     .costs = {-10, 57, 9, 24}},
                    -1);
}

TEST(LayoutSolverStability, FindsTheFarCornerOfASquashedCube) { // Klee and Minty 1972
    expectLeastCost({.rows = {{1, 0, 0, 0, 0},
                              {4, 1, 0, 0, 0},
                              {8, 4, 1, 0, 0},
                              {16, 8, 4, 1, 0},
                              {32, 16, 8, 4, 1}},
                     .bounds = {5, 25, 125, 625, 3125},
                     .costs = {-16, -8, -4, -2, -1}},
                    -3125);
}

/// Rows and columns of a square each sum up to one: every corner is degenerate many times over.
TEST(LayoutSolverStability, AssignsWorkersToTasksThoughEveryCornerIsDegenerate) {
    constexpr std::size_t Size = 6;
    LayoutSolver solver;
    std::vector<SolverVariable> square;
    for (std::size_t index = 0; index < Size * Size; ++index) {
        square.push_back(solver.makeVariable());
        atLeast(solver, square.back(), 0);
    }
    std::vector<LinearTerm> costs;
    for (std::size_t line = 0; line < Size; ++line) {
        std::vector<LinearTerm> row;
        std::vector<LinearTerm> column;
        for (std::size_t other = 0; other < Size; ++other) {
            row.push_back({square[line * Size + other], 1});
            column.push_back({square[other * Size + line], 1});
            // Dear everywhere but where each worker has the task that is theirs.
            costs.push_back({square[line * Size + other], (line + 2) % Size == other ? 1.0 : 4.0});
        }
        for (const auto& terms : {row, column})
            EXPECT_EQ(solver.add(solver.makeConstraint(terms, Equal, -1).constraint),
                      SolverRefusal::None);
    }
    EXPECT_EQ(solver.add(solver.makeConstraint(costs, LessOrEqual, 100, 7).constraint),
              SolverRefusal::None);
    const SolverOutcome outcome = solver.solve();
    EXPECT_FALSE(outcome.isStalled);
    EXPECT_TRUE(outcome.conflicts.empty());
    for (std::size_t index = 0; index < square.size(); ++index)
        EXPECT_EQ(solver.value(square[index]), (index / Size + 2) % Size == index % Size ? 1 : 0)
            << index;
}

/// One solver that is changed all the time and one that is made anew now and then agree.
TEST(LayoutSolverStability, TensOfThousandsOfChangesLeaveNoDrift) {
    std::mt19937 random(7);
    LayoutSolver solver;
    CellSystem cell(solver);
    const auto length = [&](double most) {
        return most * static_cast<double>(random() % 100'003) / 100'003;
    };
    bool hasImage = true;
    for (int turn = 0; turn < 20'000; ++turn) {
        const double width = 200 + length(300);
        const double height = 40 + length(200);
        const double gutter = length(70);
        for (const auto& [constraint, value] : {std::pair{cell.rowWidth, width},
                                                std::pair{cell.rowHeight, height},
                                                std::pair{cell.gutterWidth, gutter}})
            ASSERT_EQ(solver.setConstant(constraint, -value), SolverRefusal::None);
        if (random() % 3 == 0) {
            hasImage = !hasImage;
            ASSERT_EQ(solver.remove(hasImage ? cell.trailingAtContent : cell.trailingAtGutter),
                      SolverRefusal::None);
            ASSERT_EQ(solver.add(hasImage ? cell.trailingAtGutter : cell.trailingAtContent),
                      SolverRefusal::None);
        }
        const SolverOutcome outcome = solver.solve();
        ASSERT_FALSE(outcome.isStalled);
        ASSERT_TRUE(outcome.conflicts.empty());
        if (turn % 500 != 0)
            continue;
        LayoutSolver fresh;
        CellSystem expected(fresh);
        for (const auto& [constraint, value] : {std::pair{expected.rowWidth, width},
                                                std::pair{expected.rowHeight, height},
                                                std::pair{expected.gutterWidth, gutter}})
            ASSERT_EQ(fresh.setConstant(constraint, -value), SolverRefusal::None);
        if (!hasImage) {
            ASSERT_EQ(fresh.remove(expected.trailingAtGutter), SolverRefusal::None);
            ASSERT_EQ(fresh.add(expected.trailingAtContent), SolverRefusal::None);
        }
        fresh.solve();
        for (int item = 0; item < CellSystem::Items; ++item) {
            for (int edge = 0; edge < 4; ++edge)
                ASSERT_NEAR(cell.value(CellSystem::Item(item), CellSystem::Edge(edge)),
                            expected.value(CellSystem::Item(item), CellSystem::Edge(edge)),
                            1e-6)
                    << "turn " << turn;
        }
    }
}

TEST(LayoutSolverStability, ThirdsAndSeventhsOfThirdsStayExactEnough) {
    LayoutSolver solver;
    std::vector<SolverVariable> chain = {solver.makeVariable()};
    const SolverConstraint first = exactly(solver, chain[0], 1);
    for (int link = 0; link < 40; ++link) {
        chain.push_back(solver.makeVariable());
        const double factor = link % 2 == 0 ? 7 : 3;
        added(solver,
              {{chain.back(), factor}, {chain[chain.size() - 2], link % 2 == 0 ? -3.0 : -7.0}},
              Equal,
              0);
    }
    for (int turn = 1; turn <= 5000; ++turn) {
        ASSERT_EQ(solver.setConstant(first, -turn / 9.0), SolverRefusal::None);
        solver.solve();
    }
    EXPECT_NEAR(solver.value(chain.back()), 5000 / 9.0, 1e-6);
}

/// Each exchange multiplies the rounding of all before it, unless somebody looks.
TEST(LayoutSolverStability, WhatIsRequiredHoldsAfterThousandsOfExchangesOfOddCoefficients) {
    constexpr std::size_t Count = 12;
    for (std::uint32_t seed = 0; seed < 40; ++seed) {
        std::mt19937 random(seed);
        const auto share = [&] {
            return static_cast<double>(random() % 10'007) / 10'007;
        };
        LayoutSolver solver;
        std::vector<SolverVariable> variables;
        for (std::size_t index = 0; index < Count; ++index)
            variables.push_back(solver.makeVariable());
        std::vector<SolverConstraint> made;
        for (std::size_t index = 0; index < 2 * Count; ++index) {
            std::vector<LinearTerm> terms;
            const std::size_t first = random() % Count;
            for (std::size_t term = 0; term < 3; ++term)
                terms.push_back({variables[(first + term * (1 + random() % 2)) % Count],
                                 std::pow(100.0, share() - 0.5) * (random() % 2 == 0 ? 1 : -1)});
            const auto one = solver.makeConstraint(terms,
                                                   static_cast<LinearRelation>(random() % 3),
                                                   -100 * share(),
                                                   random() % 2 == 0 ? 500 : 1000);
            if (one.refusal == SolverRefusal::None) // two of one variable may nearly cancel out
                made.push_back(one.constraint);
        }
        for (int turn = 0; turn < 400; ++turn) {
            const SolverConstraint other = made[random() % made.size()];
            ASSERT_EQ(solver.isAdded(other) ? solver.remove(other) : solver.add(other),
                      SolverRefusal::None);
            if (solver.solve().isStalled)
                continue;
            for (const SolverConstraint constraint : made) {
                const bool mustHold = solver.priority(constraint) == 1000 &&
                                      solver.isAdded(constraint) && !solver.isDropped(constraint);
                ASSERT_LT(mustHold ? solver.error(constraint) : 0, 1e-3) << solver.describe();
            }
        }
    }
}

/// The values of large constants are rounded coarsely; what that leaves behind must not add up.
TEST(LayoutSolverStability, HundredsOfThousandsOfLargeConstantsLeaveNoTrace) {
    LayoutSolver solver;
    const SolverVariable x = solver.makeVariable();
    const SolverConstraint held = added(solver, {{x, 0.003}}, Equal, -0.1);
    std::mt19937 random(9);
    for (int turn = 0; turn < 400'000; ++turn) {
        const double large = 9e6 * static_cast<double>(random() % 1'000'003) / 1'000'003;
        ASSERT_EQ(solver.setConstant(held, -large), SolverRefusal::None);
        solver.solve();
    }
    ASSERT_EQ(solver.setConstant(held, -0.1), SolverRefusal::None);
    solver.solve();
    EXPECT_NEAR(solver.value(x), 0.1 / 0.003, 2e-5);
}

TEST(LayoutSolverStability, CoefficientsOfWildlyDifferentSizesComeToAnEnd) {
    std::mt19937 random(3);
    for (int round = 0; round < 300; ++round) {
        LayoutSolver solver;
        std::vector<SolverVariable> variables;
        for (int count = 0; count < 8; ++count)
            variables.push_back(solver.makeVariable());
        std::vector<SolverConstraint> made;
        for (int count = 0; count < 16; ++count) {
            std::vector<LinearTerm> terms;
            for (int term = 0; term < 3; ++term)
                terms.push_back({variables[random() % 8],
                                 std::pow(10.0, static_cast<double>(random() % 61) / 10 - 3)});
            const auto one = solver.makeConstraint(terms,
                                                   static_cast<LinearRelation>(random() % 3),
                                                   static_cast<double>(random() % 20'000'000) - 1e7,
                                                   random() % 3 == 0 ? 1000 : 500);
            if (one.refusal != SolverRefusal::None)
                continue; // terms of one variable add up
            made.push_back(one.constraint);
            ASSERT_EQ(solver.add(one.constraint), SolverRefusal::None);
            solver.solve();
        }
        for (const SolverConstraint constraint : made) {
            ASSERT_EQ(solver.remove(constraint), SolverRefusal::None);
            solver.solve();
        }
        for (const SolverVariable variable : variables)
            ASSERT_EQ(solver.value(variable), 0);
    }
}

/// A thousand rows below one another, each as high as the one above and a little more.
TEST(LayoutSolverStability, LongChainsAreSolvedToo) {
    LayoutSolver solver;
    SolverVariable above = solver.makeVariable();
    const SolverConstraint top = exactly(solver, above, 5);
    const int rows = 1000;
    for (int row = 0; row < rows; ++row) {
        const SolverVariable below = solver.makeVariable();
        added(solver, {{below, 1}, {above, -1}}, GreaterOrEqual, -10);
        atMost(solver, below, 0, 250);
        above = below;
    }
    solver.solve();
    EXPECT_EQ(solver.value(above), 5 + 10 * rows);
    EXPECT_EQ(solver.setConstant(top, -6), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(solver.value(above), 6 + 10 * rows);
}

} // namespace
