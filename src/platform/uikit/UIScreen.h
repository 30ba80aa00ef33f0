#pragma once

#include "platform/foundation/NSObject.h"

namespace orvo {

/// The screen that the program shows itself on.
class UIScreen final : public virtual NSObject {
public:
    [[nodiscard]] static std::shared_ptr<UIScreen> mainScreen();

    /// Pixels a point, of the traits of the system.
    [[nodiscard]] double scale() const;
};

} // namespace orvo
