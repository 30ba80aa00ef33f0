#include "platform/extension/_TransitionBlocks.h"

#include <utility>

namespace orvo {

bool _TransitionBlocks::animateAlongsideTransition_completion(Block animation, Block completion) {
    if (completion)
        _completions.push_back(std::move(completion));
    if (_hasBegun)
        return false;
    if (animation)
        _animations.push_back(std::move(animation));
    return true;
}

void _TransitionBlocks::runAnimations() {
    _hasBegun = true;
    for (const auto& animation : std::exchange(_animations, {}))
        animation();
}

void _TransitionBlocks::runCompletions() {
    for (const auto& completion : std::exchange(_completions, {}))
        completion();
}

} // namespace orvo
