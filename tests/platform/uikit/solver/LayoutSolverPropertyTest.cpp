// The solver beside a second one that tries every corner of the system in whole numbers.

#include "platform/uikit/solver/RandomSystem.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>

namespace {

using namespace orvo;
using orvo::test::ExactConstraint;
using orvo::test::ExactSolver;
using orvo::test::RandomSystem;

/// What is made in a solver, beside how it is said exactly.
struct Pair {
    LayoutSolver solver;
    std::vector<SolverVariable> variables;
    std::vector<SolverConstraint> constraints;
    std::vector<ExactConstraint> exact;

    explicit Pair(std::size_t count) {
        for (std::size_t index = 0; index < count; ++index)
            variables.push_back(solver.makeVariable());
    }

    void make(const ExactConstraint& given) {
        constraints.push_back(test::make(solver, variables, given));
        exact.push_back(given);
    }
    void add(std::size_t index) { EXPECT_EQ(solver.add(constraints[index]), SolverRefusal::None); }
};

/// What both solvers make of the constraints that are added.
void expectExact(const Pair& pair, const SolverOutcome& outcome, const std::string& where) {
    std::vector<ExactConstraint> added;
    std::vector<std::size_t> indices;
    for (std::size_t index = 0; index < pair.exact.size(); ++index) {
        if (pair.solver.isAdded(pair.constraints[index])) {
            added.push_back(pair.exact[index]);
            indices.push_back(index);
        }
    }
    const ExactSolver exact(pair.variables.size(), added);
    ASSERT_FALSE(outcome.isStalled) << where;
    for (std::size_t index = 0; index < pair.variables.size(); ++index)
        ASSERT_NEAR(pair.solver.value(pair.variables[index]), exact.values()[index], 2e-6)
            << where << " v" << index + 1 << "\n"
            << pair.solver.describe();

    std::vector<SolverConstraint> dropped;
    for (const std::size_t index : exact.dropped())
        dropped.push_back(pair.constraints[indices[index]]);
    std::vector<SolverConstraint> reported;
    for (const SolverConflict& conflict : outcome.conflicts)
        reported.push_back(conflict.dropped);
    ASSERT_EQ(reported, dropped) << where << "\n" << pair.solver.describe();

    for (const SolverConflict& conflict : outcome.conflicts) {
        std::vector<std::size_t> members;
        for (std::size_t index = 0; index < indices.size(); ++index) {
            if (std::count(conflict.members.begin(),
                           conflict.members.end(),
                           pair.constraints[indices[index]]) != 0)
                members.push_back(index);
        }
        ASSERT_EQ(members.size(), conflict.members.size()) << where;
        ASSERT_FALSE(exact.canHold(members)) << where << "\n" << pair.solver.describe();
        for (std::size_t left = 0; left < members.size(); ++left) {
            std::vector<std::size_t> others = members;
            others.erase(others.begin() + static_cast<std::ptrdiff_t>(left));
            ASSERT_TRUE(exact.canHold(others)) << where << "\n" << pair.solver.describe();
        }
    }
}

TEST(LayoutSolverProperty, SolvesSmallSystemsAsTheExactSolverDoes) {
    for (std::uint32_t seed = 1; seed <= 4000; ++seed) {
        RandomSystem random(seed);
        Pair pair(1 + random.pick(4));
        const std::size_t count = 1 + random.pick(7);
        for (std::size_t index = 0; index < count; ++index) {
            pair.make(random.constraint(pair.variables.size()));
            pair.add(index);
        }
        expectExact(pair, pair.solver.solve(), "seed " + std::to_string(seed));
        if (HasFatalFailure())
            return;
    }
}

/// One change by chance of what is there.
void change(Pair& pair, RandomSystem& random) {
    const std::size_t index = random.pick(pair.constraints.size());
    const SolverConstraint constraint = pair.constraints[index];
    SolverRefusal refusal = SolverRefusal::None;
    switch (random.pick(6)) {
    case 0:
        refusal = pair.solver.add(constraint);
        break;
    case 1:
        refusal = pair.solver.remove(constraint);
        break;
    case 2:
        pair.exact[index].priority = random.priority();
        refusal =
            pair.solver.setPriority(constraint, static_cast<float>(pair.exact[index].priority));
        break;
    case 3: // its place is used again by one that is made later
        refusal = pair.solver.destroy(constraint);
        pair.constraints.erase(pair.constraints.begin() + static_cast<std::ptrdiff_t>(index));
        pair.exact.erase(pair.exact.begin() + static_cast<std::ptrdiff_t>(index));
        pair.make(random.constraint(pair.variables.size()));
        pair.add(pair.constraints.size() - 1);
        break;
    default:
        pair.exact[index].constant = random.constant();
        refusal = pair.solver.setConstant(constraint,
                                          static_cast<double>(pair.exact[index].constant) / 2);
    }
    EXPECT_EQ(refusal, SolverRefusal::None);
}

TEST(LayoutSolverProperty, ChangesEndWhereTheExactSolverBegins) {
    for (std::uint32_t seed = 1; seed <= 150; ++seed) {
        RandomSystem random(seed);
        Pair pair(1 + random.pick(4));
        for (std::size_t index = 0; index < 7; ++index)
            pair.make(random.constraint(pair.variables.size()));
        for (int turn = 0; turn < 25; ++turn) {
            for (std::size_t count = 1 + random.pick(3); count > 0; --count)
                change(pair, random);
            expectExact(pair,
                        pair.solver.solve(),
                        "seed " + std::to_string(seed) + " turn " + std::to_string(turn));
            if (HasFatalFailure())
                return;
        }
    }
}

/// Where a system with as many variables as a screen has is too large for the exact solver, solving
/// it from nothing is what changes are held against.
void expectSameFromNothing(const Pair& pair, const SolverOutcome& outcome, std::uint32_t seed) {
    Pair fresh(pair.variables.size());
    for (std::size_t index = 0; index < pair.exact.size(); ++index) {
        fresh.make(pair.exact[index]);
        if (pair.solver.isAdded(pair.constraints[index]))
            fresh.add(index);
    }
    const SolverOutcome expected = fresh.solver.solve();
    ASSERT_FALSE(outcome.isStalled || expected.isStalled) << "seed " << seed;
    ASSERT_EQ(outcome.conflicts.size(), expected.conflicts.size()) << "seed " << seed;
    for (std::size_t index = 0; index < pair.variables.size(); ++index)
        ASSERT_NEAR(pair.solver.value(pair.variables[index]),
                    fresh.solver.value(fresh.variables[index]),
                    2e-6)
            << "seed " << seed << " v" << index + 1;
}

TEST(LayoutSolverProperty, ChangesOfLargeSystemsEndWhereSolvingFromNothingDoes) {
    for (std::uint32_t seed = 1; seed <= 40; ++seed) {
        RandomSystem random(seed);
        Pair pair(20 + random.pick(20));
        for (std::size_t index = 0; index < 60; ++index) {
            pair.make(random.constraint(pair.variables.size()));
            pair.add(index);
        }
        for (int turn = 0; turn < 20; ++turn) {
            change(pair, random);
            expectSameFromNothing(pair, pair.solver.solve(), seed);
            if (HasFatalFailure())
                return;
        }
    }
}

TEST(LayoutSolverProperty, OrderOfAddingMakesNoDifference) {
    for (std::uint32_t seed = 1; seed <= 300; ++seed) {
        RandomSystem random(seed);
        Pair forward(12);
        Pair shuffled(12);
        std::vector<std::size_t> order;
        for (std::size_t index = 0; index < 20; ++index) {
            const ExactConstraint given = random.constraint(12);
            forward.make(given);
            shuffled.make(given);
            forward.add(index);
            order.insert(order.begin() + static_cast<std::ptrdiff_t>(random.pick(index + 1)),
                         index);
        }
        for (const std::size_t index : order) {
            shuffled.add(index);
            if (random.pick(4) == 0)
                shuffled.solver.solve();
        }
        const SolverOutcome expected = forward.solver.solve();
        const SolverOutcome outcome = shuffled.solver.solve();
        ASSERT_TRUE(std::equal(expected.conflicts.begin(),
                               expected.conflicts.end(),
                               outcome.conflicts.begin(),
                               outcome.conflicts.end()))
            << "seed " << seed;
        ASSERT_EQ(forward.solver.describe(), shuffled.solver.describe()) << "seed " << seed;
    }
}

} // namespace
