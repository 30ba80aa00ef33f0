#pragma once

#include "platform/geoservices/TransitIncidentAffectedEntity.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace orvo {

/// A line that an incident of a feed concerns, or some stops of it. Immutable. An incident may
/// concern hundreds of lines that nobody asks about: the stops' identifiers lie in one list of the
/// incident, and are boxed only when asked for.
class FeedAffectedEntity final : public virtual TransitIncidentAffectedEntity {
public:
    using Stops = std::shared_ptr<const std::vector<std::string>>;

    /// The stops are those of the list from `firstStop` to before `endStop`; with none of them the
    /// whole line is concerned, or trips of it.
    [[nodiscard]] static std::shared_ptr<FeedAffectedEntity> initWithMuid_stops_firstStop_endStop(
        std::uint64_t muid, Stops stops, std::size_t firstStop, std::size_t endStop);

    [[nodiscard]] std::uint64_t muid() const override { return _muid; }
    [[nodiscard]] bool hasNextStopIDs() const override { return _firstStop < _endStop; }
    [[nodiscard]] std::shared_ptr<NSOrderedSet> nextStopIDs() const override;

private:
    std::uint64_t _muid = 0;
    Stops _stops;
    std::size_t _firstStop = 0;
    std::size_t _endStop = 0;
};

} // namespace orvo
