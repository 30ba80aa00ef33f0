#pragma once

#include "platform/geoservices/FeedTransitIncident.h"

#include <optional>
#include <string>
#include <string_view>

namespace orvo {

/// The texts about incidents that are composed here and not published by an agency: short, calm,
/// in sentence case. In the person's language where there is a table for it, else in English.
class IncidentWords {
public:
    /// @param language a BCP-47 tag
    explicit IncidentWords(std::string_view language);

    /// `Detour`.
    [[nodiscard]] std::string effect(IncidentEffect effect) const;
    /// `Detour due to construction work`; only the effect where the feed tells no cause.
    [[nodiscard]] std::string effect_cause(IncidentEffect effect, IncidentCause cause) const;

    [[nodiscard]] std::string statusUnknown() const;
    /// `Metro, last known 35 minutes ago`: the system's name, which may be empty, and how long ago
    /// anything was known, in seconds; nothing when that never was.
    [[nodiscard]] std::string lastKnown(std::string_view systemName,
                                        std::optional<double> age) const;
    [[nodiscard]] std::string sourceFailed() const;
    [[nodiscard]] std::string selectorLost() const;
    [[nodiscard]] std::string lineDeparted() const;
    [[nodiscard]] std::string scheduleUnread() const;
    [[nodiscard]] std::string nothingToAsk() const;

    struct Table;

private:
    const Table* _table;
};

} // namespace orvo
