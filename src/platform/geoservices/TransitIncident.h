#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSObject.h"

#include <cstdint>
#include <optional>
#include <string>

namespace orvo {

/// One service incident. Texts and dates may be nil; a missing date leaves that side of the period
/// open.
class TransitIncident : public virtual NSObject {
public:
    /// The same incident has the same number in every line that it concerns and at every fetch.
    [[nodiscard]] virtual std::uint64_t muid() const = 0;
    [[nodiscard]] virtual std::shared_ptr<NSDate> startDate() const = 0;
    [[nodiscard]] virtual std::shared_ptr<NSDate> endDate() const = 0;
    /// Whether nothing runs.
    [[nodiscard]] virtual bool isBlockingIncident() const = 0;
    [[nodiscard]] virtual std::optional<std::string> title() const = 0;
    [[nodiscard]] virtual std::optional<std::string> summary() const = 0;
    [[nodiscard]] virtual std::optional<std::string> fullDescription() const = 0;
    [[nodiscard]] virtual std::optional<std::string> messageForRoutePlanning() const = 0;
    [[nodiscard]] virtual std::optional<std::string> messageForRouteStepping() const = 0;
    [[nodiscard]] virtual std::optional<std::string> messageForNonRoutable() const = 0;
    [[nodiscard]] virtual std::int32_t iconType() const = 0;
    [[nodiscard]] virtual std::shared_ptr<NSDate> creationDate() const = 0;
    [[nodiscard]] virtual std::shared_ptr<NSDate> lastUpdated() const = 0;
    /// `TransitIncidentAffectedEntity` objects.
    [[nodiscard]] virtual std::shared_ptr<NSArray> affectedEntities() const = 0;
};

} // namespace orvo
