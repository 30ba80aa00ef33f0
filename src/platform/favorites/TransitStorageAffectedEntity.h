#pragma once

#include "platform/geoservices/TransitIncidentAffectedEntity.h"
#include "platform/protobuf/ProtoMessage.h"

namespace orvo {

/// A stop's identifier as a message.
class TransitStorageStop final : public ProtoMessage<TransitStorageStop> {
public:
    [[nodiscard]] const std::optional<std::string>& stopID() const noexcept { return _stopID; }
    void setStopID(std::optional<std::string> stopID) { _stopID = std::move(stopID); }

    [[nodiscard]] static auto schema() {
        return std::tuple{
            ProtoStringField<TransitStorageStop>{1, "stopID", &TransitStorageStop::_stopID}};
    }

private:
    friend class ProtoMessage<TransitStorageStop>;
    std::optional<std::string> _stopID;
};

/// A storable copy of what an incident concerns.
class TransitStorageAffectedEntity final : public ProtoMessage<TransitStorageAffectedEntity>,
                                           public virtual TransitIncidentAffectedEntity {
public:
    [[nodiscard]] static std::shared_ptr<TransitStorageAffectedEntity>
    initWithAffectedEntity(const TransitIncidentAffectedEntity& entity);

    [[nodiscard]] std::uint64_t muid() const override { return _muid; }
    [[nodiscard]] bool hasNextStopIDs() const override { return _hasNextStopIDs; }
    [[nodiscard]] std::shared_ptr<NSOrderedSet> nextStopIDs() const override;

    [[nodiscard]] static auto schema() {
        using Self = TransitStorageAffectedEntity;
        return std::tuple{
            ProtoScalarField<Self, std::uint64_t>{1, "muid", &Self::_muid, 1},
            ProtoScalarField<Self, bool>{2, "hasNextStopIDs", &Self::_hasNextStopIDs, 2},
            ProtoRepeatedField<Self, TransitStorageStop>{3, "nextStopIDs", &Self::_nextStopIDs}};
    }

private:
    friend class ProtoMessage<TransitStorageAffectedEntity>;

    std::uint64_t _muid = 0;
    bool _hasNextStopIDs = false;
    std::vector<std::shared_ptr<TransitStorageStop>> _nextStopIDs;
};

} // namespace orvo
