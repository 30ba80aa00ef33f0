#pragma once

#include "platform/favorites/TransitStorageAffectedEntity.h"
#include "platform/foundation/NSCoding.h"
#include "platform/geoservices/FeedTransitIncident.h"
#include "platform/geoservices/TransitIncident.h"
#include "platform/protobuf/ProtoMessage.h"

#include <optional>
#include <string>

namespace orvo {

/// A storable copy of an incident. It answers what the incident answered, and carries the details
/// of a feed's incident.
class TransitStorageIncident final : public ProtoMessage<TransitStorageIncident>,
                                     public virtual TransitIncident,
                                     public virtual NSSecureCoding {
public:
    [[nodiscard]] static std::shared_ptr<TransitStorageIncident>
    initWithIncident(const std::shared_ptr<TransitIncident>& incident);

    [[nodiscard]] std::uint64_t muid() const override { return _muid; }
    [[nodiscard]] std::shared_ptr<NSDate> startDate() const override {
        return date(_startDate, StartDateBit);
    }
    [[nodiscard]] std::shared_ptr<NSDate> endDate() const override {
        return date(_endDate, EndDateBit);
    }
    [[nodiscard]] bool isBlockingIncident() const override { return _blockingIncident; }
    [[nodiscard]] std::optional<std::string> title() const override { return _title; }
    [[nodiscard]] std::optional<std::string> summary() const override { return _summary; }
    [[nodiscard]] std::optional<std::string> fullDescription() const override {
        return _fullDescription;
    }
    [[nodiscard]] std::optional<std::string> messageForRoutePlanning() const override {
        return _messageForRoutePlanning;
    }
    [[nodiscard]] std::optional<std::string> messageForRouteStepping() const override {
        return _messageForRouteStepping;
    }
    [[nodiscard]] std::optional<std::string> messageForNonRoutable() const override {
        return _messageForNonRoutable;
    }
    [[nodiscard]] std::int32_t iconType() const override { return _iconType; }
    [[nodiscard]] std::shared_ptr<NSDate> creationDate() const override {
        return date(_creationDate, CreationDateBit);
    }
    [[nodiscard]] std::shared_ptr<NSDate> lastUpdated() const override {
        return date(_lastUpdated, LastUpdatedBit);
    }
    [[nodiscard]] std::shared_ptr<NSArray> affectedEntities() const override;
    /// Nothing for an incident that came from no feed.
    [[nodiscard]] std::optional<FeedTransitIncident::Details> details() const;

    /// Archived as the message's bytes under one key; nil where the coder does not hold them.
    [[nodiscard]] static std::shared_ptr<TransitStorageIncident> initWithCoder(NSCoder& coder);
    void encodeWithCoder(NSCoder& coder) const override;

    [[nodiscard]] static auto schema() {
        using Self = TransitStorageIncident;
        return std::tuple{
            ProtoScalarField<Self, std::uint64_t>{1, "muid", &Self::_muid, MuidBit},
            ProtoScalarField<Self, double>{2, "startDate", &Self::_startDate, StartDateBit},
            ProtoScalarField<Self, double>{3, "endDate", &Self::_endDate, EndDateBit},
            ProtoScalarField<Self, bool>{
                4, "blockingIncident", &Self::_blockingIncident, BlockingIncidentBit},
            ProtoStringField<Self>{5, "title", &Self::_title},
            ProtoStringField<Self>{6, "summary", &Self::_summary},
            ProtoStringField<Self>{7, "fullDescription", &Self::_fullDescription},
            ProtoStringField<Self>{8, "messageForRoutePlanning", &Self::_messageForRoutePlanning},
            ProtoStringField<Self>{9, "messageForRouteStepping", &Self::_messageForRouteStepping},
            ProtoStringField<Self>{10, "messageForNonRoutable", &Self::_messageForNonRoutable},
            ProtoScalarField<Self, std::int32_t>{11, "iconType", &Self::_iconType, IconTypeBit},
            ProtoScalarField<Self, double>{
                12, "creationDate", &Self::_creationDate, CreationDateBit},
            ProtoScalarField<Self, double>{13, "lastUpdated", &Self::_lastUpdated, LastUpdatedBit},
            ProtoRepeatedField<Self, TransitStorageAffectedEntity>{
                14, "affectedEntities", &Self::_affectedEntities},
            ProtoScalarField<Self, bool>{
                15, "hasAffectedEntities", &Self::_hasAffectedEntities, HasAffectedEntitiesBit},
            ProtoStringField<Self>{16, "feed", &Self::_feed},
            ProtoScalarField<Self, std::int32_t>{17, "severity", &Self::_severity, SeverityBit},
            ProtoScalarField<Self, std::int32_t>{18, "effect", &Self::_effect, EffectBit},
            ProtoScalarField<Self, std::int32_t>{19, "cause", &Self::_cause, CauseBit},
            ProtoScalarField<Self, bool>{20, "isPartOfLine", &Self::_isPartOfLine, IsPartOfLineBit},
            ProtoScalarField<Self, bool>{21, "isUnknown", &Self::_isUnknown, IsUnknownBit},
            ProtoStringField<Self>{22, "spokenTitle", &Self::_spokenTitle},
            ProtoStringField<Self>{23, "link", &Self::_link},
            ProtoStringField<Self>{24, "timeZone", &Self::_timeZone}};
    }

private:
    friend class ProtoMessage<TransitStorageIncident>;

    enum Bits : std::uint32_t {
        MuidBit = 1U << 0U,
        StartDateBit = 1U << 1U,
        EndDateBit = 1U << 2U,
        BlockingIncidentBit = 1U << 3U,
        IconTypeBit = 1U << 4U,
        CreationDateBit = 1U << 5U,
        LastUpdatedBit = 1U << 6U,
        HasAffectedEntitiesBit = 1U << 7U,
        SeverityBit = 1U << 8U,
        EffectBit = 1U << 9U,
        CauseBit = 1U << 10U,
        IsPartOfLineBit = 1U << 11U,
        IsUnknownBit = 1U << 12U,
    };

    [[nodiscard]] std::shared_ptr<NSDate> date(double secondsSinceReferenceDate,
                                               std::uint32_t bit) const;
    void assignDate(double& field, const std::shared_ptr<NSDate>& date, std::uint32_t bit);
    void takeAffectedEntities(const std::shared_ptr<NSArray>& entities);
    void takeDetails(const FeedTransitIncident::Details& details);

    std::uint64_t _muid = 0;
    double _startDate = 0; // dates in seconds since the reference date
    double _endDate = 0;
    bool _blockingIncident = false;
    std::optional<std::string> _title;
    std::optional<std::string> _summary;
    std::optional<std::string> _fullDescription;
    std::optional<std::string> _messageForRoutePlanning;
    std::optional<std::string> _messageForRouteStepping;
    std::optional<std::string> _messageForNonRoutable;
    std::int32_t _iconType = 0;
    double _creationDate = 0;
    double _lastUpdated = 0;
    std::vector<std::shared_ptr<TransitStorageAffectedEntity>> _affectedEntities;
    bool _hasAffectedEntities = false; // a list that is empty, not nil
    std::optional<std::string> _feed;  // present where there are details
    std::int32_t _severity = 0;
    std::int32_t _effect = 0;
    std::int32_t _cause = 0;
    bool _isPartOfLine = false;
    bool _isUnknown = false;
    std::optional<std::string> _spokenTitle;
    std::optional<std::string> _link;
    std::optional<std::string> _timeZone;
};

} // namespace orvo
