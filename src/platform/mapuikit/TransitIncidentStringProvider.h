#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/geoservices/TransitIncident.h"

#include <optional>
#include <string>

namespace orvo {

/// Gives an incident its texts in a list, each on one line: line breaks, tabs and repeated blanks
/// of ASCII and the two separators of Unicode become one blank, and none stands at either end. A
/// text of nothing else is empty, not nil. Any thread.
class TransitIncidentStringProvider : public virtual NSObject {
public:
    [[nodiscard]] static std::shared_ptr<TransitIncidentStringProvider> sharedProvider();
    /// What `sharedProvider()` answers.
    static EnvironmentSlot<std::shared_ptr<TransitIncidentStringProvider>>& provider();

    /// The title; nil for a nil incident or one without a title.
    [[nodiscard]] virtual std::optional<std::string>
    cellTitleForIncident(const std::shared_ptr<TransitIncident>& incident) const;
    /// The summary; nil for a nil incident or one without a summary.
    [[nodiscard]] virtual std::optional<std::string>
    cellSecondaryTextForIncident(const std::shared_ptr<TransitIncident>& incident) const;
};

} // namespace orvo
