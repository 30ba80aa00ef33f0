#include "platform/uikit/solver/TieBreaker.h"

#include "platform/uikit/solver/DualSimplex.h"

#include <gtest/gtest.h>

#include <vector>

namespace {

using namespace orvo;
using Outcome = TieBreaker::Outcome;
using enum LinearRelation;

/// Variables 0 to 2 with constraints by number from 3.
class TieBreakerTest : public testing::Test {
protected:
    TieBreakerTest() {
        basis.reserve(16);
        for (const auto variable : variables)
            basis.insertVariable(variable, variable + 1);
    }
    void want(std::vector<SimplexBasis::Term> terms,
              LinearRelation relation,
              double target,
              float priority = 1000) {
        basis.insertConstraint(next, terms, relation, target, priority, next + 1);
        ++next;
    }
    [[nodiscard]] Outcome run() {
        EXPECT_EQ(DualSimplex().run(basis, DualSimplex::Scope::All), DualSimplex::Outcome::Solved);
        const Outcome outcome = TieBreaker().run(basis, variables);
        EXPECT_EQ(DualSimplex().run(basis, DualSimplex::Scope::All), DualSimplex::Outcome::Solved);
        return outcome;
    }
    [[nodiscard]] std::vector<double> values() const {
        return {basis[0].value, basis[1].value, basis[2].value};
    }

    std::vector<SimplexBasis::Symbol> variables = {0, 1, 2};
    SimplexBasis basis;
    SimplexBasis::Symbol next = 3;
};

TEST_F(TieBreakerTest, FindsOnlySolutionsUnique) {
    for (const SimplexBasis::Symbol variable : variables)
        want({{variable, 1}}, Equal, 5, 30);
    EXPECT_EQ(run(), Outcome::Unique);
    EXPECT_EQ(values(), (std::vector<double>{5, 5, 5}));
}

TEST_F(TieBreakerTest, EarlierVariablesComeNearerToZero) {
    want({{0, 1}, {1, 1}, {2, 1}}, Equal, 12);
    want({{2, 1}}, LessOrEqual, 7);
    EXPECT_EQ(run(), Outcome::Chosen);
    EXPECT_EQ(values(), (std::vector<double>{0, 5, 7}));
}

TEST_F(TieBreakerTest, ComesToZeroFromBelowToo) {
    want({{0, 1}, {1, 1}}, Equal, -12);
    want({{1, 1}}, GreaterOrEqual, -7);
    EXPECT_EQ(run(), Outcome::Chosen);
    EXPECT_EQ(values(), (std::vector<double>{-5, -7, 0}));
}

TEST_F(TieBreakerTest, NeverAddsToAnErrorHoweverWeak) {
    want({{0, 1}}, GreaterOrEqual, 8, 1);
    want({{0, 1}}, LessOrEqual, 20, 1);
    EXPECT_EQ(run(), Outcome::Chosen);
    EXPECT_EQ(values(), (std::vector<double>{8, 0, 0}));
}

TEST_F(TieBreakerTest, MovesAlongEqualSumsOfErrors) {
    want({{0, 1}}, Equal, 30, 100);
    want({{0, 1}}, Equal, 10, 100);
    EXPECT_EQ(run(), Outcome::Chosen);
    EXPECT_EQ(values(), (std::vector<double>{10, 0, 0}));
}

TEST_F(TieBreakerTest, HoldsAtZeroWhatIsThereAlready) {
    want({{0, 1}, {1, 1}}, Equal, 0);
    want({{1, 1}, {2, -1}}, Equal, 0);
    EXPECT_EQ(run(), Outcome::Chosen);
    EXPECT_EQ(values(), (std::vector<double>{0, 0, 0}));
}

} // namespace
