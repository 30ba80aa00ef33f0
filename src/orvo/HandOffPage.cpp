#include "orvo/HandOffPage.h"

namespace orvo {

std::optional<IncidentPage> incidentPageOf(const HandOff::Content& content,
                                           CommandContext& context) {
    if (std::holds_alternative<HandOff::Favorites>(content))
        return std::nullopt;
    std::shared_ptr<NSError> unreadable; // names are a help; without them the rest is still told
    const auto schedules = context.schedules(unreadable);
    const auto* const line = std::get_if<HandOff::Line>(&content);
    auto page = line ? IncidentPage::ofLine(*line->line, schedules.get())
                     : IncidentPage::ofIncidents(std::get<HandOff::Incidents>(content).incidents,
                                                 schedules.get());
    page.putCurrentFirst(context.now());
    return page;
}

} // namespace orvo
