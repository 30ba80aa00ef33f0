#pragma once

#include "orvo/CommandContext.h"
#include "orvo/HandOff.h"
#include "orvo/window/IncidentPage.h"

#include <optional>

namespace orvo {

/// What is told of a line or a list that was handed over, with the lines named by the schedules of
/// the profile in use, as far as these can be read. Nothing for the favourites.
[[nodiscard]] std::optional<IncidentPage> incidentPageOf(const HandOff::Content& content,
                                                         CommandContext& context);

} // namespace orvo
