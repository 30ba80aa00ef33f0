#pragma once

#include "platform/geoservices/TransitLine.h"

namespace orvo {

/// A line with what is known of its service now.
class TransitLineItem : public virtual TransitLine {
public:
    /// The line's `TransitIncident`s, most important first; may be nil or empty.
    [[nodiscard]] virtual std::shared_ptr<NSArray> incidents() const = 0;
    /// Whether the incidents are older than their time to live.
    [[nodiscard]] virtual bool isIncidentsTTLExpired() const = 0;
    /// Whether incidents were asked for and answered.
    [[nodiscard]] virtual bool hasIncidentComponent() const = 0;
    [[nodiscard]] virtual bool hasEncyclopedicInfo() const = 0;
    [[nodiscard]] virtual std::shared_ptr<NSObject> encyclopedicInfo() const = 0;
};

} // namespace orvo
