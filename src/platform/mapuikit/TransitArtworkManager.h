#pragma once

#include "platform/mapuikit/IconManager.h"

namespace orvo {

/// Draws transit artwork with an icon manager.
class TransitArtworkManager : public virtual NSObject {
public:
    /// `iconManager` may be nil.
    [[nodiscard]] static std::shared_ptr<TransitArtworkManager>
    initWithIconManager(std::shared_ptr<IconManager> iconManager);

    [[nodiscard]] const std::shared_ptr<IconManager>& iconManager() const noexcept {
        return _iconManager;
    }

private:
    std::shared_ptr<IconManager> _iconManager;
};

} // namespace orvo
