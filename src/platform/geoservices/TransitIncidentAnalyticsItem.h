#pragma once

#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>
#include <utility>

namespace orvo {

/// One incident that a widget session showed.
class TransitIncidentAnalyticsItem final : public virtual NSObject {
public:
    /// Decimal; nil at first.
    [[nodiscard]] const std::optional<std::string>& transitLineMuid() const noexcept {
        return _transitLineMuid;
    }
    void setTransitLineMuid(std::optional<std::string> muid) { _transitLineMuid = std::move(muid); }
    [[nodiscard]] const std::optional<std::string>& transitIncidentTitle() const noexcept {
        return _transitIncidentTitle;
    }
    void setTransitIncidentTitle(std::optional<std::string> title) {
        _transitIncidentTitle = std::move(title);
    }

private:
    std::optional<std::string> _transitLineMuid;
    std::optional<std::string> _transitIncidentTitle;
};

} // namespace orvo
