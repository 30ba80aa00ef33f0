#include "platform/feeds/alerts/EntityReader.h"

#include "platform/feeds/alerts/ByteScan.h"
#include "platform/feeds/alerts/SelectorShapes.h"
#include "platform/feeds/alerts/WireCursor.h"
#include "platform/foundation/Text.h"

#include <utility>

namespace orvo {

namespace {

namespace EntityField {
constexpr std::uint32_t Id = 1;
constexpr std::uint32_t IsDeleted = 2;
constexpr std::uint32_t Alert = 5;
} // namespace EntityField

namespace AlertField {
constexpr std::uint32_t ActivePeriod = 1;
constexpr std::uint32_t CommunicationPeriod = 2;
constexpr std::uint32_t ImpactPeriod = 3;
constexpr std::uint32_t InformedEntity = 5;
constexpr std::uint32_t Cause = 6;
constexpr std::uint32_t Effect = 7;
constexpr std::uint32_t Link = 8;
constexpr std::uint32_t Header = 10;
constexpr std::uint32_t Description = 11;
constexpr std::uint32_t SpokenHeader = 12;
constexpr std::uint32_t Severity = 14;
} // namespace AlertField

constexpr std::uint64_t LastCause = 12;
constexpr std::uint64_t LastEffect = 11;
constexpr std::uint64_t LastSeverity = 4;
constexpr std::size_t MostTranslations = 200;
constexpr std::size_t UsualTranslations = 2; // room is made for so many at once
constexpr std::size_t UsualPeriods = 4;

bool isText(std::string_view bytes) {
    return ByteScan::isASCII(bytes) || Text::isValidUTF8(bytes);
}

/// Takes a number from 1 to `last`.
bool takeListed(std::uint64_t number, std::uint64_t last, std::int32_t& taken) noexcept {
    if (number < 1 || number > last)
        return false;
    taken = static_cast<std::int32_t>(number);
    return true;
}

bool readCause(std::uint64_t number, std::int32_t& cause) noexcept {
    return takeListed(number, LastCause, cause);
}

bool isBytes(const WireCursor& cursor) {
    return cursor.key() == WireCursor::bytes(cursor.field());
}

bool readTrip(std::string_view bytes, AlertSelector& selector) {
    WireCursor cursor(bytes);
    while (cursor.next()) {
        switch (cursor.key()) {
        case WireCursor::bytes(1):
            selector.tripId = cursor.bytes();
            break;
        case WireCursor::bytes(2):
            selector.namesDeparture = !cursor.bytes().empty();
            break;
        case WireCursor::bytes(5):
            selector.tripRouteId = cursor.bytes();
            break;
        default:
            // Which trip, or of which line, is then not known: the selector may mean any.
            if (cursor.field() <= 2 || cursor.field() == 5)
                return false;
            break;
        }
    }
    return !cursor.failed();
}

bool isEmpty(const AlertSelector& selector) {
    return selector.agencyId.empty() && selector.routeId.empty() && selector.stopId.empty() &&
           selector.tripId.empty() && selector.tripRouteId.empty() && !selector.routeType &&
           !selector.namesDeparture;
}

} // namespace

AlertReading EntityReader::read(std::string_view entity) {
    _statistics.add(AlertCount::Entities);
    AlertReading reading;
    _room.release();
    _selectors.clear();
    _selectorFields = {};
    _mayPassOver = _passedOver != nullptr;
    std::string_view id;
    bool isDeleted = false;
    WireCursor cursor(entity);
    while (cursor.next()) {
        switch (cursor.field()) {
        case EntityField::Id:
            if (isBytes(cursor) && isText(cursor.bytes()))
                id = cursor.bytes();
            else
                _statistics.add(AlertCount::UnreadableIds);
            break;
        case EntityField::IsDeleted:
            if (cursor.key() == WireCursor::number(EntityField::IsDeleted))
                isDeleted = cursor.number() != 0;
            else
                _statistics.add(AlertCount::UnreadableNumbers);
            break;
        case EntityField::Alert:
            if (reading.alert)
                readPassedOver(*reading.alert);
            else
                reading.alert.emplace(&_room);
            if (isBytes(cursor)) {
                readAlert(cursor.bytes(), reading);
            } else {
                _statistics.add(AlertCount::UnreadableAlerts);
                reading.mayConcernAnyLine = true;
            }
            break;
        default:
            break;
        }
    }
    if (cursor.failed()) {
        _statistics.add(AlertCount::UnreadableEntities);
        reading.mayConcernAnyLine = true;
    }
    if (isDeleted) {
        _statistics.add(AlertCount::DeletedEntities);
        return {};
    }
    if (reading.alert) {
        _statistics.add(AlertCount::Alerts);
        reading.alert->id = id;
        reading.alert->selectors = _selectors;
        reading.alert->selectorFields = _selectorFields;
    } else if (!cursor.failed()) {
        _statistics.add(AlertCount::OtherEntities);
    }
    return reading;
}

void EntityReader::readAlert(std::string_view bytes, AlertReading& reading) {
    WireCursor cursor(bytes);
    for (const char* begin = cursor.position(); cursor.next(); begin = cursor.position()) {
        const std::size_t selectors = _selectors.size();
        readAlertField(cursor, reading);
        if (!_mayPassOver)
            continue;
        if (_selectors.size() > selectors) // one that was refused may not come back
            addSelectorFields(begin, cursor.position());
        // Mostly the selectors come behind the periods.
        if (cursor.field() == AlertField::InformedEntity ||
            cursor.field() == AlertField::ActivePeriod)
            passOver(cursor, *reading.alert);
    }
    if (cursor.failed()) {
        _statistics.add(AlertCount::UnreadableAlerts);
        reading.mayConcernAnyLine = true;
    }
}

void EntityReader::passOver(WireCursor& cursor, Alert& alert) {
    const char* const begin = cursor.position();
    cursor.skipWith([&](const char* from, const char* end) noexcept {
        return _passedOver->skim(from, end, _repeatsLeft);
    });
    if (cursor.position() == begin)
        return;
    addSelectorFields(begin, cursor.position());
    alert.hasUnreadSelectors = true;
}

/// An entity with a second alert, which is a mistake, has its selectors in two places.
void EntityReader::readPassedOver(Alert& alert) {
    if (std::exchange(alert.hasUnreadSelectors, false)) {
        _selectors.clear();
        readSelectors(_selectorFields, _selectors);
    }
    _selectorFields = {};
    _mayPassOver = false;
}

void EntityReader::addSelectorFields(const char* begin, const char* end) {
    if (!_selectorFields.empty())
        begin = _selectorFields.data();
    _selectorFields = {begin, static_cast<std::size_t>(end - begin)};
}

void EntityReader::readAlertField(const WireCursor& field, AlertReading& reading) {
    Alert& alert = *reading.alert;
    switch (field.field()) {
    case AlertField::ActivePeriod:
        return readPeriod(field, alert.activePeriods);
    case AlertField::CommunicationPeriod:
        return readPeriod(field, alert.communicationPeriods);
    case AlertField::ImpactPeriod:
        return readPeriod(field, alert.impactPeriods);
    case AlertField::InformedEntity:
        return takeSelector(field, reading);
    case AlertField::Cause:
        return readNumber(field, readCause, alert.cause);
    case AlertField::Effect:
        return readNumber(field, readEffect, alert.effect);
    case AlertField::Severity:
        return readNumber(field, readSeverity, alert.severity);
    case AlertField::Link:
        return readTexts(field, alert.link);
    case AlertField::Header:
        return readTexts(field, alert.header);
    case AlertField::Description:
        return readTexts(field, alert.description);
    case AlertField::SpokenHeader:
        return readTexts(field, alert.spokenHeader);
    default:
        return;
    }
}

void EntityReader::readPeriod(const WireCursor& field, AlertPeriods& periods) {
    if (periods.empty())
        periods.reserve(UsualPeriods);
    AlertPeriod period;
    if (!isBytes(field) || !takeOne())
        return addUnreadPeriod(periods);
    WireCursor cursor(field.bytes());
    while (cursor.next()) {
        if (cursor.key() == WireCursor::number(1))
            period.start = cursor.number();
        else if (cursor.key() == WireCursor::number(2))
            period.end = cursor.number();
        else if (cursor.field() <= 2)
            _statistics.add(AlertCount::UnreadablePeriods);
    }
    if (cursor.failed())
        return addUnreadPeriod(periods);
    periods.push_back(period);
}

/// One that cannot be read leaves open when the alert holds; dropped, it would end it, or bring an
/// older one back. Many in a row say no more than one.
void EntityReader::addUnreadPeriod(AlertPeriods& periods) {
    _statistics.add(AlertCount::UnreadablePeriods);
    if (periods.empty() || periods.back().start || periods.back().end)
        periods.emplace_back();
}

bool EntityReader::readSelector(std::string_view bytes, AlertSelector& selector) {
    WireCursor cursor(bytes);
    while (cursor.next()) {
        switch (cursor.key()) {
        case WireCursor::bytes(1):
            selector.agencyId = cursor.bytes();
            break;
        case WireCursor::bytes(2):
            selector.routeId = cursor.bytes();
            break;
        case WireCursor::number(3):
            selector.routeType = static_cast<std::int32_t>(cursor.number());
            break;
        case WireCursor::bytes(4):
            if (!readTrip(cursor.bytes(), selector))
                return false;
            break;
        case WireCursor::bytes(5):
            selector.stopId = cursor.bytes();
            break;
        default:
            if (cursor.field() <= 5)
                return false;
            break;
        }
    }
    if (cursor.failed())
        return false;
    return ByteScan::isASCII(bytes) ||
           (isText(selector.agencyId) && isText(selector.routeId) && isText(selector.stopId) &&
            isText(selector.tripId) && isText(selector.tripRouteId));
}

void EntityReader::takeSelector(const WireCursor& field, AlertReading& reading) {
    AlertSelector& selector = _selectors.emplace_back();
    const bool isRead = isBytes(field) && readSelector(field.bytes(), selector) && takeOne();
    if (isRead && !isEmpty(selector))
        return;
    _selectors.pop_back();
    if (isRead)
        return _statistics.add(AlertCount::EmptySelectors);
    reading.mayConcernAnyLine = true;
    _statistics.add(AlertCount::UnreadableSelectors);
}

void EntityReader::readSelectors(std::string_view fields, AlertSelectors& selectors) {
    WireCursor cursor(fields);
    while (cursor.next()) {
        AlertSelector selector;
        if (cursor.key() == WireCursor::bytes(AlertField::InformedEntity) &&
            readSelector(cursor.bytes(), selector) && !isEmpty(selector))
            selectors.push_back(selector);
    }
}

bool EntityReader::readEffect(std::uint64_t number, std::int32_t& effect) noexcept {
    return takeListed(number, LastEffect, effect);
}

bool EntityReader::readSeverity(std::uint64_t number, std::int32_t& severity) noexcept {
    return takeListed(number, LastSeverity, severity);
}

void EntityReader::readNumber(const WireCursor& field,
                              bool (*take)(std::uint64_t, std::int32_t&) noexcept,
                              std::int32_t& number) {
    if (field.key() != WireCursor::number(field.field()) || !take(field.number(), number))
        _statistics.add(AlertCount::UnreadableNumbers);
}

void EntityReader::readTexts(const WireCursor& field, AlertTexts& texts) {
    if (!isBytes(field))
        return _statistics.add(AlertCount::UnreadableTexts);
    WireCursor cursor(field.bytes());
    while (cursor.next()) {
        if (cursor.key() == WireCursor::bytes(1))
            readText(cursor.bytes(), texts);
        else if (cursor.field() == 1)
            _statistics.add(AlertCount::UnreadableTexts);
    }
    if (cursor.failed())
        _statistics.add(AlertCount::UnreadableTexts);
}

void EntityReader::readText(std::string_view bytes, AlertTexts& texts) {
    AlertText text;
    bool isBad = false;
    WireCursor cursor(bytes);
    while (cursor.next()) {
        if (cursor.field() > 2)
            continue;
        if (!isBytes(cursor) || !isText(cursor.bytes()))
            isBad = true;
        else if (cursor.field() == 1)
            text.text = cursor.bytes();
        else
            text.language = cursor.bytes();
    }
    if (isBad || cursor.failed())
        _statistics.add(AlertCount::UnreadableTexts);
    if (cursor.failed() || text.text.find_first_not_of(" \t\r\n") == std::string_view::npos)
        return;
    if (texts.empty())
        texts.reserve(UsualTranslations);
    if (texts.size() < MostTranslations && takeOne())
        texts.push_back(text);
    else
        _statistics.add(AlertCount::UnreadableTexts);
}

bool EntityReader::takeOne() noexcept {
    if (_repeatsLeft == 0)
        return false;
    --_repeatsLeft;
    return true;
}

} // namespace orvo
