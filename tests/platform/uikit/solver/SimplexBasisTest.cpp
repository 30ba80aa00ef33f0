#include "platform/uikit/solver/SimplexBasis.h"

#include <gtest/gtest.h>

#include <vector>

namespace {

using namespace orvo;
using Side = SimplexBasis::Side;
using enum LinearRelation;

/// Variables 0 and 1; constraint 2 says that their sum should be 10, constraint 3 that twice the
/// first should be at least 4.
class SimplexBasisTest : public testing::Test {
protected:
    SimplexBasisTest() {
        basis.reserve(8);
        basis.insertVariable(0, 1);
        basis.insertVariable(1, 2);
        const SimplexBasis::Term sum[] = {{0, 1}, {1, 1}};
        basis.insertConstraint(2, sum, Equal, 10, 500, 3);
        const SimplexBasis::Term twice[] = {{0, 2}};
        basis.insertConstraint(3, twice, GreaterOrEqual, 4, 1000, 4);
    }

    [[nodiscard]] SimplexBasis::Place place(SimplexBasis::Symbol row,
                                            SimplexBasis::Symbol column) const {
        auto at = basis.tableau().firstInRow(row);
        while (basis.tableau()[at].column != column)
            at = basis.tableau()[at].nextInRow;
        return at;
    }

    SimplexBasis basis;
};

TEST_F(SimplexBasisTest, NewConstraintsStandInTheBasisAndPayNothing) {
    EXPECT_TRUE(basis[2].isBasic);
    EXPECT_EQ(basis[2].value, 0);
    EXPECT_EQ(basis[2].side, Side::At);
    EXPECT_EQ(basis[3].side, Side::Above);
    EXPECT_TRUE(basis.isWrong(2));
    EXPECT_TRUE(basis.isWrong(3));
    EXPECT_FALSE(basis.isRequired(2));
    EXPECT_TRUE(basis.isRequired(3));
    EXPECT_FALSE(basis.isRequired(0));
}

TEST_F(SimplexBasisTest, PivotMovesTheRowToItsTargetAndAllThatDependOnTheColumn) {
    basis.pivot(place(2, 0), Side::Above);
    EXPECT_FALSE(basis[2].isBasic);
    EXPECT_EQ(basis[2].value, 10);
    EXPECT_EQ(basis[0].value, 10);
    EXPECT_EQ(basis[1].value, 0);
    EXPECT_EQ(basis[3].value, 20);
    EXPECT_FALSE(basis.isWrong(3));
    EXPECT_EQ(basis.pivotCount(), 1U);
}

TEST_F(SimplexBasisTest, TargetsOutsideTheBasisMoveWhatFollowsFromThem) {
    basis.pivot(place(2, 0), Side::Above);
    basis.setTarget(2, 1);
    EXPECT_EQ(basis[0].value, 1);
    EXPECT_EQ(basis[3].value, 2);
    EXPECT_TRUE(basis.isWrong(3));
}

TEST_F(SimplexBasisTest, PricesOfAColumnAreThoseOfItsRowsByLevel) {
    basis.setSide(2, Side::Below); // 10 short, and rising lessens it
    std::vector<double> prices(basis.levelCapacity(), 0);
    ASSERT_EQ(basis.levels().size(), 1U);
    basis.addColumnPrices(1, prices);
    EXPECT_EQ(prices[basis.levels()[0]], -1);
    EXPECT_FALSE(basis.isWrong(2));
    basis.forgetSides();
    prices.assign(prices.size(), 0);
    basis.addColumnPrices(1, prices);
    EXPECT_EQ(prices[basis.levels()[0]], 0);
    EXPECT_TRUE(basis.isWrong(2));
}

TEST_F(SimplexBasisTest, OnlyTheForbiddenSideHasAPrice) {
    EXPECT_EQ(basis.price(3, Side::Above), 0);
    EXPECT_EQ(basis.price(3, Side::Below), -1);
    EXPECT_EQ(basis.price(2, Side::Above), 1);
    EXPECT_EQ(basis.price(2, Side::Below), -1);
    EXPECT_EQ(basis.price(2, Side::At), 0);
    EXPECT_EQ(basis.price(0, Side::Above), 0);
}

TEST_F(SimplexBasisTest, LevelsAreInOrderOfPriorityAndGoWithTheirLastConstraint) {
    const SimplexBasis::Term term[] = {{1, 1}};
    basis.insertConstraint(4, term, Equal, 1, 750, 5);
    basis.insertConstraint(5, term, Equal, 2, 250, 6);
    basis.insertConstraint(6, term, Equal, 3, 500, 7);
    ASSERT_EQ(basis.levels().size(), 3U);
    EXPECT_EQ(basis.levels()[0], basis[4].level);
    EXPECT_EQ(basis.levels()[1], basis[2].level);
    EXPECT_EQ(basis.levels()[2], basis[5].level);
    EXPECT_EQ(basis[6].level, basis[2].level);
    EXPECT_TRUE(basis.eraseConstraint(6));
    EXPECT_EQ(basis.levels().size(), 3U);
    EXPECT_TRUE(basis.eraseConstraint(2));
    EXPECT_EQ(basis.levels().size(), 2U);
}

TEST_F(SimplexBasisTest, ErasingWhatHoldsSomethingLetsItGo) {
    basis.pivot(place(3, 0), Side::Above);
    EXPECT_EQ(basis[0].value, 2);
    EXPECT_FALSE(basis.needsForgetting());
    EXPECT_TRUE(basis.eraseConstraint(3));
    EXPECT_TRUE(basis.needsForgetting());
    EXPECT_EQ(basis[0].value, 0);
    EXPECT_FALSE(basis[0].isBasic);
    EXPECT_FALSE(basis[3].isPresent);
}

TEST_F(SimplexBasisTest, ErasingWhatHeldNothingNeedsNoForgetting) {
    EXPECT_TRUE(basis.eraseConstraint(3));
    EXPECT_FALSE(basis.needsForgetting());
}

TEST_F(SimplexBasisTest, VariablesGoOnlyWhenNothingDependsOnThem) {
    EXPECT_FALSE(basis.eraseVariable(1));
    EXPECT_TRUE(basis.eraseConstraint(2));
    EXPECT_TRUE(basis.eraseVariable(1));
    EXPECT_FALSE(basis[1].isPresent);
}

TEST_F(SimplexBasisTest, RefreshedValuesFollowFromTheTargetsAlone) {
    basis.pivot(place(2, 1), Side::Above);
    basis.pivot(place(3, 0), Side::Above);
    const double before = basis[1].value;
    basis.refreshValues();
    EXPECT_EQ(basis[1].value, before);
    EXPECT_EQ(before, 8);
}

TEST_F(SimplexBasisTest, TouchedVariablesAreThoseThatMoved) {
    basis.clearTouched();
    basis.pivot(place(3, 0), Side::Above);
    EXPECT_EQ(basis.touched(), (std::vector<SimplexBasis::Symbol>{0}));
}

TEST_F(SimplexBasisTest, SignsAreWatchedFromWhenTheyWereRemembered) {
    basis.pivot(place(3, 0), Side::Above);
    basis.rememberSigns();
    basis.setTarget(3, 6);
    EXPECT_FALSE(basis.takeSignChange());
    basis.setTarget(3, -6);
    EXPECT_TRUE(basis.takeSignChange());
    EXPECT_FALSE(basis.takeSignChange());
}

} // namespace
