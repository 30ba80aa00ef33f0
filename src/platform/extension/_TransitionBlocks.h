#pragma once

#include "platform/uikit/UIViewControllerTransitionCoordinator.h"

#include <vector>

namespace orvo {

/// Collects what a controller wants to happen along with a change of its size.
class _TransitionBlocks final : public UIViewControllerTransitionCoordinator {
public:
    /// False once the animations have run.
    bool animateAlongsideTransition_completion(Block animation, Block completion) override;

    /// Each once, in the order given.
    void runAnimations();
    void runCompletions();

private:
    std::vector<Block> _animations;
    std::vector<Block> _completions;
    bool _hasBegun = false;
};

} // namespace orvo
