#pragma once

#include "platform/foundation/NSObject.h"

#include <functional>

namespace orvo {

/// Runs what happens alongside a transition. Main thread.
class UIViewControllerTransitionCoordinator : public virtual NSObject {
public:
    using Block = std::function<void()>;

    /// `animation` runs with the transition, `completion`, unless empty, after it. Answers whether
    /// the animation runs.
    virtual bool animateAlongsideTransition_completion(Block animation, Block completion) = 0;
};

} // namespace orvo
