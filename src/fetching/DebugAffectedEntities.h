#pragma once

#include "platform/geoservices/TransitIncidentAffectedEntity.h"

namespace orvo {

/// What a made-up incident concerns: a whole line. Immutable.
class DebugAffectedEntities final : public virtual TransitIncidentAffectedEntity {
public:
    [[nodiscard]] static std::shared_ptr<DebugAffectedEntities> initWithMuid(std::uint64_t muid);

    [[nodiscard]] std::uint64_t muid() const override { return _muid; }
    [[nodiscard]] bool hasNextStopIDs() const override { return false; }
    [[nodiscard]] std::shared_ptr<NSOrderedSet> nextStopIDs() const override { return nullptr; }

private:
    std::uint64_t _muid = 0;
};

} // namespace orvo
