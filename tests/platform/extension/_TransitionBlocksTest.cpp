#include "platform/extension/_TransitionBlocks.h"

#include <gtest/gtest.h>

#include <string>

namespace orvo {
namespace {

class TransitionBlocksTest : public ::testing::Test {
protected:
    UIViewControllerTransitionCoordinator::Block note(const std::string& word) {
        return [this, word] {
            said += word + ' ';
        };
    }

    std::shared_ptr<_TransitionBlocks> blocks = std::make_shared<_TransitionBlocks>();
    std::string said;
};

TEST_F(TransitionBlocksTest, AnimationsRunFirstAndCompletionsAfterEachOnceInTheOrderGiven) {
    EXPECT_TRUE(blocks->animateAlongsideTransition_completion(note("a"), note("x")));
    EXPECT_TRUE(blocks->animateAlongsideTransition_completion(note("b"), note("y")));
    EXPECT_EQ(said, "");
    blocks->runAnimations();
    blocks->runAnimations();
    EXPECT_EQ(said, "a b ");
    blocks->runCompletions();
    blocks->runCompletions();
    EXPECT_EQ(said, "a b x y ");
}

TEST_F(TransitionBlocksTest, EitherMayBeEmpty) {
    EXPECT_TRUE(blocks->animateAlongsideTransition_completion({}, note("x")));
    EXPECT_TRUE(blocks->animateAlongsideTransition_completion(note("a"), {}));
    blocks->runAnimations();
    blocks->runCompletions();
    EXPECT_EQ(said, "a x ");
}

TEST_F(TransitionBlocksTest, WhatComesAfterTheAnimationsHasRunToItsEndOnly) {
    blocks->runAnimations();
    EXPECT_FALSE(blocks->animateAlongsideTransition_completion(note("late"), note("x")));
    blocks->runAnimations();
    blocks->runCompletions();
    EXPECT_EQ(said, "x ");
}

TEST_F(TransitionBlocksTest, AnAnimationThatAsksForAnotherIsTooLateForIt) {
    bool runs = true;
    static_cast<void>(blocks->animateAlongsideTransition_completion(
        [&] { runs = blocks->animateAlongsideTransition_completion(note("inner"), note("x")); },
        {}));
    blocks->runAnimations();
    EXPECT_FALSE(runs);
    blocks->runCompletions();
    EXPECT_EQ(said, "x ");
}

} // namespace
} // namespace orvo
