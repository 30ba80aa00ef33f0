#pragma once

#include "platform/foundation/NSObject.h"
#include "platform/foundation/NSOrderedSet.h"

#include <cstdint>

namespace orvo {

/// What an incident concerns: a line, or some stops of it.
class TransitIncidentAffectedEntity : public virtual NSObject {
public:
    /// The line's.
    [[nodiscard]] virtual std::uint64_t muid() const = 0;
    [[nodiscard]] virtual bool hasNextStopIDs() const = 0;
    /// The stops' identifiers, `NSString`s; nil when the whole line is concerned.
    [[nodiscard]] virtual std::shared_ptr<NSOrderedSet> nextStopIDs() const = 0;
};

} // namespace orvo
