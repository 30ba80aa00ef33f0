#include "platform/uikit/solver/DualSimplex.h"

#include <gtest/gtest.h>

namespace {

using namespace orvo;
using Scope = DualSimplex::Scope;
using Outcome = DualSimplex::Outcome;
using enum LinearRelation;

/// One variable, 0, and what it should be.
class DualSimplexTest : public testing::Test {
protected:
    DualSimplexTest() {
        basis.reserve(8);
        basis.insertVariable(0, 1);
    }
    void want(SimplexBasis::Symbol symbol, LinearRelation relation, double target, float priority) {
        const SimplexBasis::Term term[] = {{0, 1}};
        basis.insertConstraint(symbol, term, relation, target, priority, symbol + 1);
    }

    SimplexBasis basis;
    DualSimplex simplex;
};

TEST_F(DualSimplexTest, BringsAConstraintToItsTargetByItsVariable) {
    want(1, Equal, 7, 500);
    EXPECT_EQ(simplex.run(basis, Scope::All), Outcome::Solved);
    EXPECT_EQ(basis[0].value, 7);
    EXPECT_FALSE(basis[1].isBasic);
    EXPECT_TRUE(simplex.didWork());
}

TEST_F(DualSimplexTest, WeakerConstraintPaysItself) {
    want(1, Equal, 7, 500);
    want(2, GreaterOrEqual, 9, 400);
    EXPECT_EQ(simplex.run(basis, Scope::All), Outcome::Solved);
    EXPECT_EQ(basis[0].value, 7);
    EXPECT_TRUE(basis[2].isBasic);
    EXPECT_EQ(basis[2].side, SimplexBasis::Side::Below);
}

TEST_F(DualSimplexTest, StrongerConstraintPushesOutTheWeaker) {
    want(1, Equal, 7, 500);
    EXPECT_EQ(simplex.run(basis, Scope::All), Outcome::Solved);
    want(2, GreaterOrEqual, 9, 600);
    EXPECT_EQ(simplex.run(basis, Scope::All), Outcome::Solved);
    EXPECT_EQ(basis[0].value, 9);
    EXPECT_FALSE(basis[2].isBasic);
    EXPECT_EQ(basis[1].side, SimplexBasis::Side::Above);
}

TEST_F(DualSimplexTest, DoesNothingWhereNothingIsWrong) {
    want(1, LessOrEqual, 7, 1000);
    EXPECT_EQ(simplex.run(basis, Scope::All), Outcome::Solved);
    EXPECT_FALSE(simplex.didWork());
    EXPECT_EQ(basis.pivotCount(), 0U);
}

TEST_F(DualSimplexTest, RequiredOnlyLeavesTheOthersForLater) {
    want(1, Equal, 7, 999);
    want(2, LessOrEqual, -1, 1000);
    EXPECT_EQ(simplex.run(basis, Scope::RequiredOnly), Outcome::Solved);
    EXPECT_EQ(basis[0].value, -1);
    EXPECT_TRUE(basis.isWrong(1));
    EXPECT_EQ(simplex.run(basis, Scope::All), Outcome::Solved);
    EXPECT_EQ(basis[0].value, -1);
    EXPECT_FALSE(basis.isWrong(1));
}

TEST_F(DualSimplexTest, ImpossibleRowIsMadeOfWhatContradictsIt) {
    want(1, GreaterOrEqual, 7, 1000);
    want(2, LessOrEqual, 6, 1000);
    EXPECT_EQ(simplex.run(basis, Scope::All), Outcome::Impossible);
    const SimplexBasis::Symbol row = simplex.impossibleRow();
    const auto place = basis.tableau().firstInRow(row);
    EXPECT_EQ(row + basis.tableau()[place].column, 1U + 2U);
}

TEST_F(DualSimplexTest, PassesOverColumnsThatWouldMagnifyRounding) {
    basis.insertVariable(5, 9);
    const SimplexBasis::Term terms[] = {{0, 100}, {5, 0.01}};
    basis.insertConstraint(1, terms, Equal, 50, 1000, 10);
    EXPECT_EQ(simplex.run(basis, Scope::All), Outcome::Solved);
    EXPECT_EQ(basis[0].value, 0.5);
    EXPECT_EQ(basis[5].value, 0);
}

} // namespace
