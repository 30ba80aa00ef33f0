#include "platform/favorites/TransitStorageIncident.h"

#include "platform/favorites/_MessageCoding.h"

namespace orvo {

std::shared_ptr<TransitStorageIncident>
TransitStorageIncident::initWithIncident(const std::shared_ptr<TransitIncident>& incident) {
    if (!incident)
        return nullptr;
    auto storage = std::make_shared<TransitStorageIncident>();
    storage->assign(storage->_muid, incident->muid(), MuidBit);
    storage->assignDate(storage->_startDate, incident->startDate(), StartDateBit);
    storage->assignDate(storage->_endDate, incident->endDate(), EndDateBit);
    storage->assign(
        storage->_blockingIncident, incident->isBlockingIncident(), BlockingIncidentBit);
    storage->_title = incident->title();
    storage->_summary = incident->summary();
    storage->_fullDescription = incident->fullDescription();
    storage->_messageForRoutePlanning = incident->messageForRoutePlanning();
    storage->_messageForRouteStepping = incident->messageForRouteStepping();
    storage->_messageForNonRoutable = incident->messageForNonRoutable();
    storage->assign(storage->_iconType, incident->iconType(), IconTypeBit);
    storage->assignDate(storage->_creationDate, incident->creationDate(), CreationDateBit);
    storage->assignDate(storage->_lastUpdated, incident->lastUpdated(), LastUpdatedBit);
    storage->takeAffectedEntities(incident->affectedEntities());
    if (const auto* feed = dynamic_cast<const FeedTransitIncident*>(incident.get()))
        storage->takeDetails(feed->details());
    else if (const auto* stored = dynamic_cast<const TransitStorageIncident*>(incident.get()))
        if (const auto details = stored->details())
            storage->takeDetails(*details);
    return storage;
}

std::shared_ptr<NSDate> TransitStorageIncident::date(double seconds, std::uint32_t bit) const {
    return hasBit(bit) ? NSDate::dateWithTimeIntervalSinceReferenceDate(seconds) : nullptr;
}

void TransitStorageIncident::assignDate(double& field,
                                        const std::shared_ptr<NSDate>& date,
                                        std::uint32_t bit) {
    if (date)
        assign(field, date->timeIntervalSinceReferenceDate(), bit);
}

void TransitStorageIncident::takeAffectedEntities(const std::shared_ptr<NSArray>& entities) {
    if (!entities)
        return;
    assign(_hasAffectedEntities, true, HasAffectedEntitiesBit);
    for (const auto& entity : typed<TransitIncidentAffectedEntity>(entities))
        _affectedEntities.push_back(TransitStorageAffectedEntity::initWithAffectedEntity(*entity));
}

void TransitStorageIncident::takeDetails(const FeedTransitIncident::Details& details) {
    _feed = details.feed;
    assign(_severity, static_cast<std::int32_t>(details.severity), SeverityBit);
    assign(_effect, static_cast<std::int32_t>(details.effect), EffectBit);
    assign(_cause, static_cast<std::int32_t>(details.cause), CauseBit);
    assign(_isPartOfLine, details.isPartOfLine, IsPartOfLineBit);
    assign(_isUnknown, details.isUnknown, IsUnknownBit);
    _spokenTitle = details.spokenTitle;
    _link = details.link;
    _timeZone = details.timeZone;
}

std::shared_ptr<NSArray> TransitStorageIncident::affectedEntities() const {
    return _hasAffectedEntities || !_affectedEntities.empty() ? NSArray::arrayOf(_affectedEntities)
                                                              : nullptr;
}

std::optional<FeedTransitIncident::Details> TransitStorageIncident::details() const {
    if (!_feed)
        return std::nullopt;
    return FeedTransitIncident::Details{.feed = *_feed,
                                        .severity = static_cast<IncidentSeverity>(_severity),
                                        .effect = static_cast<IncidentEffect>(_effect),
                                        .cause = static_cast<IncidentCause>(_cause),
                                        .isPartOfLine = _isPartOfLine,
                                        .isUnknown = _isUnknown,
                                        .spokenTitle = _spokenTitle,
                                        .link = _link,
                                        .timeZone = _timeZone};
}

std::shared_ptr<TransitStorageIncident> TransitStorageIncident::initWithCoder(NSCoder& coder) {
    return decodedMessage<TransitStorageIncident>(coder);
}

void TransitStorageIncident::encodeWithCoder(NSCoder& coder) const {
    encodeMessage(*this, coder);
}

} // namespace orvo
