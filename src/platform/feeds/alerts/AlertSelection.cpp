#include "platform/feeds/alerts/AlertSelection.h"

#include "platform/feeds/alerts/ByteScan.h"
#include "platform/feeds/alerts/EffectFilter.h"
#include "platform/feeds/alerts/EntityReader.h"
#include "platform/feeds/alerts/HeaderFingerprint.h"
#include "platform/feeds/alerts/SelectorResolver.h"
#include "platform/feeds/alerts/SelectorShapes.h"
#include "platform/feeds/alerts/WireCursor.h"
#include "platform/foundation/SeededStringHash.h"
#include "platform/geoservices/FeedTransitIncident.h"

#include <algorithm>
#include <bit>
#include <limits>
#include <set>
#include <string>
#include <utility>

namespace orvo {

namespace {

bool hasBlankEnds(std::string_view id) {
    return id.front() <= ' ' || id.back() <= ' ';
}

/// What a look at one alert shows.
struct Glance {
    bool isAlert = false;
    bool mayBeNamed = false;
    bool isBroken = false;
    std::int32_t effect = static_cast<std::int32_t>(IncidentEffect::UnknownEffect);
    std::int32_t severity = static_cast<std::int32_t>(IncidentSeverity::Unknown);
};

} // namespace

/// What selectors may name to matter. It says "no" to most after a look at a few bytes.
class AlertSelection::Wanted {
public:
    void add(const ScheduleLine& line) {
        _shapes.want(line.routeId);
        _routes.insert(line.routeId);
        _agencies.insert(line.agencyId);
        _types.insert(basicRouteType(line.routeType));
    }

    void look(std::string_view selectorBytes, Glance& glance) {
        AlertSelector selector;
        const std::string_view route = _shapes.routeOf(selectorBytes);
        if (!route.empty())
            glance.mayBeNamed = glance.mayBeNamed || mayHaveRoute(route);
        else if (EntityReader::readSelector(selectorBytes, selector))
            glance.mayBeNamed = glance.mayBeNamed || mayBeNamedBy(selector);
        else
            glance.isBroken = true;
    }

    /// Over selectors that would change nothing.
    const char* skim(const char* from, const char* end) const noexcept {
        std::size_t unlimited = std::numeric_limits<std::size_t>::max();
        return _shapes.skim(from, end, unlimited);
    }

    [[nodiscard]] const SelectorShapes& shapes() const noexcept { return _shapes; }

private:
    [[nodiscard]] bool mayHaveRoute(std::string_view route) const {
        return _routes.contains(route) || hasBlankEnds(route);
    }

    [[nodiscard]] bool mayBeNamedBy(const AlertSelector& selector) const {
        const std::string_view route = SelectorResolver::routeOf(selector);
        if (!route.empty())
            return mayHaveRoute(route);
        if (!selector.stopId.empty())
            return true;
        if (!selector.agencyId.empty())
            return _agencies.contains(selector.agencyId) || hasBlankEnds(selector.agencyId);
        return selector.routeType && _types.contains(basicRouteType(*selector.routeType));
    }

    SelectorShapes _shapes;
    std::set<std::string, std::less<>> _routes;
    std::set<std::string, std::less<>> _agencies;
    std::set<int> _types;
};

/// Which entities are chosen, and what ties them to others: hashes that are the same for entities
/// that may be one incident.
class AlertSelection::Ties {
public:
    void addKey(std::uint64_t key) { _keys.push_back(key); }
    [[nodiscard]] std::size_t keyCount() const { return _keys.size(); }
    void dropKeys(std::size_t count) { _keys.resize(count); }
    void endEntity(bool isChosen) {
        _isChosen.push_back(isChosen);
        _endOfKeys.push_back(_keys.size());
    }

    [[nodiscard]] std::size_t count() const { return _isChosen.size(); }
    void truncate(std::size_t count) {
        _isChosen.resize(count);
        _endOfKeys.resize(count);
        _keys.resize(firstKey(count));
    }
    [[nodiscard]] bool isChosen(std::size_t entity) const { return _isChosen[entity]; }

    /// Chooses whatever shares a key with a chosen one, and so on.
    void spread() {
        if (!reachesOthers())
            return;
        Owners owners;
        owners.reserve(_keys.size());
        std::vector<std::size_t> pending;
        for (std::size_t entity = 0; entity < _isChosen.size(); ++entity) {
            forEachKey(entity, [&](std::uint64_t key) { owners.emplace_back(key, entity); });
            if (_isChosen[entity])
                pending.push_back(entity);
        }
        std::sort(owners.begin(), owners.end());
        while (!pending.empty()) {
            const std::size_t entity = pending.back();
            pending.pop_back();
            forEachKey(entity, [&](std::uint64_t key) { chooseOwners(key, owners, pending); });
        }
    }

private:
    using Owners = std::vector<std::pair<std::uint64_t, std::size_t>>;

    [[nodiscard]] std::size_t firstKey(std::size_t entity) const {
        return entity == 0 ? 0 : _endOfKeys[entity - 1];
    }

    template <class Visit>
    void forEachKey(std::size_t entity, const Visit& visit) const {
        for (std::size_t key = firstKey(entity); key < _endOfKeys[entity]; ++key)
            visit(_keys[key]);
    }

    /// Mostly no other entity has a key of a chosen one; that is seen without sorting all keys.
    [[nodiscard]] bool reachesOthers() const {
        constexpr std::size_t SlotsPerKey = 64;
        std::vector<std::uint64_t> chosenKeys;
        for (std::size_t entity = 0; entity < _isChosen.size(); ++entity)
            if (_isChosen[entity])
                forEachKey(entity, [&](std::uint64_t key) { chosenKeys.push_back(key); });
        const std::uint64_t slotMask = std::bit_ceil(chosenKeys.size() * SlotsPerKey + 1) - 1;
        std::vector<bool> slots(slotMask + 1);
        for (const std::uint64_t key : chosenKeys)
            slots[key & slotMask] = true;
        std::vector<std::uint64_t> candidates; // few, and looked for exactly
        std::size_t key = 0;
        for (std::size_t entity = 0; entity < _isChosen.size(); ++entity) {
            const std::size_t end = _endOfKeys[entity];
            for (; key < end; ++key)
                if (slots[_keys[key] & slotMask] && !_isChosen[entity])
                    candidates.push_back(_keys[key]);
        }
        std::ranges::sort(candidates);
        return !candidates.empty() && std::ranges::any_of(chosenKeys, [&](std::uint64_t chosen) {
            return std::ranges::binary_search(candidates, chosen);
        });
    }

    void chooseOwners(std::uint64_t key, const Owners& owners, std::vector<std::size_t>& pending) {
        if (!_spreadKeys.insert(key).second)
            return;
        auto owner = std::lower_bound(owners.begin(), owners.end(), std::pair(key, std::size_t{0}));
        for (; owner != owners.end() && owner->first == key; ++owner) {
            if (_isChosen[owner->second])
                continue;
            _isChosen[owner->second] = true;
            pending.push_back(owner->second);
        }
    }

    std::vector<std::uint64_t> _keys;    // of all entities, one after the other
    std::vector<std::size_t> _endOfKeys; // of each entity
    std::vector<bool> _isChosen;
    SeededNumberSet _spreadKeys;
};

namespace {

template <class Ties>
void addHeaderKeys(std::string_view translations, Ties& ties) {
    WireCursor cursor(translations);
    while (cursor.next()) {
        if (cursor.key() != WireCursor::bytes(1))
            continue;
        WireCursor translation(cursor.bytes());
        while (translation.next())
            if (translation.key() == WireCursor::bytes(1))
                ties.addKey(headerFingerprint(translation.bytes()));
    }
}

template <class Wanted, class Ties>
void lookAtAlert(std::string_view alert, Wanted& wanted, Ties& ties, Glance& glance) {
    WireCursor cursor(alert);
    while (cursor.next()) {
        switch (cursor.key()) {
        case WireCursor::bytes(5):
            wanted.look(cursor.bytes(), glance);
            [[fallthrough]];
        case WireCursor::bytes(1): // mostly the selectors come behind the periods
            cursor.skipWith(
                [&](const char* from, const char* end) noexcept { return wanted.skim(from, end); });
            break;
        case WireCursor::number(7):
            EntityReader::readEffect(cursor.number(), glance.effect);
            break;
        case WireCursor::number(14):
            EntityReader::readSeverity(cursor.number(), glance.severity);
            break;
        case WireCursor::bytes(10):
            addHeaderKeys(cursor.bytes(), ties);
            break;
        default:
            glance.isBroken = glance.isBroken || cursor.field() == 5;
        }
    }
    glance.isBroken = glance.isBroken || cursor.failed();
}

} // namespace

AlertSelection::AlertSelection(const LineIndex& index,
                               const std::vector<std::uint64_t>& lines,
                               bool stepFree)
    : _wanted(std::make_unique<Wanted>())
    , _ties(std::make_unique<Ties>())
    , _stepFree(stepFree) {
    for (const std::uint64_t muid : lines)
        if (const ScheduleLine* const line = index.line(muid))
            _wanted->add(*line);
}

AlertSelection::~AlertSelection() = default;

void AlertSelection::look(std::string_view entity) {
    const std::size_t keysBefore = _ties->keyCount();
    std::string_view id;
    Glance glance;
    WireCursor cursor(entity);
    while (cursor.next()) {
        switch (cursor.key()) {
        case WireCursor::bytes(1):
            id = cursor.bytes();
            break;
        case WireCursor::bytes(5):
            glance.isAlert = true;
            lookAtAlert(cursor.bytes(), *_wanted, *_ties, glance);
            break;
        default:
            glance.isBroken = glance.isBroken || cursor.field() == 5;
        }
    }
    glance.isBroken = glance.isBroken || cursor.failed();
    const bool mayBeIncident =
        glance.isAlert && !reasonAgainstIncident(glance.effect, glance.severity, _stepFree);
    if (!mayBeIncident) {
        _ties->dropKeys(keysBefore);
    } else {
        if (_ties->keyCount() == keysBefore)
            _ties->addKey(headerFingerprint({})); // alerts without a header are alike
        if (!id.empty())
            _ties->addKey(~ByteScan::quickHash(id));
    }
    _ties->endEntity(glance.isBroken || (mayBeIncident && glance.mayBeNamed));
}

std::size_t AlertSelection::count() const noexcept {
    return _ties->count();
}

void AlertSelection::truncate(std::size_t count) {
    _ties->truncate(count);
}

void AlertSelection::choose() {
    _ties->spread();
}

bool AlertSelection::isChosen(std::size_t entity) const {
    return _ties->isChosen(entity);
}

const SelectorShapes& AlertSelection::shapes() const noexcept {
    return _wanted->shapes();
}

} // namespace orvo
