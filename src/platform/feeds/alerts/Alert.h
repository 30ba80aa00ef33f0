#pragma once

#include <cstdint>
#include <memory_resource>
#include <optional>
#include <string_view>
#include <vector>

namespace orvo {

/// One text in one language. Views into the message's bytes; valid UTF-8, otherwise as published.
struct AlertText {
    std::string_view text;
    std::string_view language; ///< a BCP-47 tag; empty when untagged
};

/// A period as published: seconds since 1970, or milliseconds; missing where the feed has nothing.
struct AlertPeriod {
    std::optional<std::uint64_t> start;
    std::optional<std::uint64_t> end;
};

/// What one informed_entity names. An empty text is an absent field. Views into the message's
/// bytes.
struct AlertSelector {
    std::string_view agencyId;
    std::string_view routeId;
    std::string_view stopId;
    std::string_view tripId;
    std::string_view tripRouteId;
    std::optional<std::int32_t> routeType;
    bool namesDeparture = false; ///< a trip's start time is given
};

/// Where the lists of alerts lie. A feed has thousands, which are thrown away together: they share
/// one place that is given back whole.
using AlertRoom = std::pmr::polymorphic_allocator<>;
using AlertTexts = std::pmr::vector<AlertText>;
using AlertPeriods = std::pmr::vector<AlertPeriod>;
using AlertSelectors = std::pmr::vector<AlertSelector>;

/// One alert of a message, read but not judged. It is valid as long as the message's bytes are, and
/// the room.
struct Alert {
    explicit Alert(AlertRoom room = {})
        : activePeriods(room)
        , communicationPeriods(room)
        , impactPeriods(room)
        , selectors(room)
        , header(room)
        , description(room)
        , spokenHeader(room)
        , link(room) {}
    /// The same alert in another room, in which it takes no more than it needs.
    Alert(const Alert& other, AlertRoom room)
        : id(other.id)
        , activePeriods(other.activePeriods, room)
        , communicationPeriods(other.communicationPeriods, room)
        , impactPeriods(other.impactPeriods, room)
        , selectors(other.selectors, room)
        , hasUnreadSelectors(other.hasUnreadSelectors)
        , selectorFields(other.selectorFields)
        , cause(other.cause)
        , effect(other.effect)
        , severity(other.severity)
        , header(other.header, room)
        , description(other.description, room)
        , spokenHeader(other.spokenHeader, room)
        , link(other.link, room) {}

    std::string_view id; ///< the entity's; empty when it has none that can be read
    AlertPeriods activePeriods;
    AlertPeriods communicationPeriods;
    AlertPeriods impactPeriods;
    AlertSelectors selectors;        ///< those that were read
    bool hasUnreadSelectors = false; ///< whether others were passed over
    /// The fields of the alert among which all its selectors are, the read ones too: mostly nothing
    /// else. Empty for a reader that passes over none, and where they are in two places: then all
    /// of them were read.
    std::string_view selectorFields;
    std::int32_t cause = 1;    ///< a number of `IncidentCause`
    std::int32_t effect = 8;   ///< a number of `IncidentEffect`
    std::int32_t severity = 1; ///< a number of `IncidentSeverity`
    AlertTexts header;
    AlertTexts description;
    AlertTexts spokenHeader;
    AlertTexts link;
};

} // namespace orvo
