#include "platform/uikit/solver/LinearConstraint.h"

#include <gtest/gtest.h>

namespace {

using namespace orvo;

TEST(LinearConstraint, HandlesAreOrderedAsTheirBearersWereMade) {
    const SolverVariable early{.index = 9, .serial = 3};
    const SolverVariable late{.index = 2, .serial = 4};
    EXPECT_LT(early, late);
    EXPECT_EQ(early, (SolverVariable{.index = 9, .serial = 3}));
    EXPECT_NE(early, (SolverVariable{.index = 9, .serial = 5}));
}

TEST(LinearConstraint, EmptyHandleNamesNothing) {
    EXPECT_FALSE(SolverConstraint());
    EXPECT_TRUE((SolverConstraint{.index = 0, .serial = 1}));
}

TEST(LinearConstraint, EachRefusalIsASentence) {
    EXPECT_EQ(describe(SolverRefusal::None), "");
    for (const SolverRefusal refusal : {SolverRefusal::UnknownVariable,
                                        SolverRefusal::UnknownConstraint,
                                        SolverRefusal::NotFinite,
                                        SolverRefusal::ConstantTooLarge,
                                        SolverRefusal::CoefficientOutOfRange,
                                        SolverRefusal::PriorityOutOfRange,
                                        SolverRefusal::StillInUse}) {
        EXPECT_GT(describe(refusal).size(), 20U);
        EXPECT_EQ(describe(refusal).back(), '.');
    }
}

} // namespace
