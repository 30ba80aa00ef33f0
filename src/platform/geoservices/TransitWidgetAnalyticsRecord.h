#pragma once

#include "platform/geoservices/TransitIncidentAnalyticsItem.h"

#include <cstdint>
#include <memory>
#include <vector>

namespace orvo {

/// What one widget session was like.
class TransitWidgetAnalyticsRecord final : public virtual NSObject {
public:
    [[nodiscard]] bool initiallyExpanded() const noexcept { return _initiallyExpanded; }
    void setInitiallyExpanded(bool expanded) noexcept { _initiallyExpanded = expanded; }
    [[nodiscard]] bool everExpanded() const noexcept { return _everExpanded; }
    void setEverExpanded(bool expanded) noexcept { _everExpanded = expanded; }
    [[nodiscard]] std::int64_t transitMessageType() const noexcept { return _transitMessageType; }
    void setTransitMessageType(std::int64_t type) noexcept { _transitMessageType = type; }
    [[nodiscard]] std::int64_t tappedItemIndex() const noexcept { return _tappedItemIndex; }
    void setTappedItemIndex(std::int64_t index) noexcept { _tappedItemIndex = index; }
    [[nodiscard]] const std::vector<std::shared_ptr<TransitIncidentAnalyticsItem>>&
    transitIncidentItems() const noexcept {
        return _transitIncidentItems;
    }
    void addTransitIncidentItem(std::shared_ptr<TransitIncidentAnalyticsItem> item) {
        _transitIncidentItems.push_back(std::move(item));
    }

private:
    bool _initiallyExpanded = false;
    bool _everExpanded = false;
    std::int64_t _transitMessageType = 0;
    std::int64_t _tappedItemIndex = 0;
    std::vector<std::shared_ptr<TransitIncidentAnalyticsItem>> _transitIncidentItems;
};

} // namespace orvo
