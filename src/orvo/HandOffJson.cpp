#include "orvo/HandOffJson.h"

#include "orvo/IncidentReport.h"
#include "orvo/JsonParts.h"
#include "platform/foundation/NSArray.h"

#include <fmt/format.h>
#include <unordered_set>

namespace orvo {

namespace {

std::optional<std::string> kindOf(const std::optional<HandOff::Content>& content) {
    if (!content)
        return std::nullopt;
    if (std::holds_alternative<HandOff::Line>(*content))
        return "line";
    return std::holds_alternative<HandOff::Incidents>(*content) ? "incidents" : "favorites";
}

void addLine(JsonWriter& json, const TransitStorageLineItem* line, const ScheduleStore* schedules) {
    json.key("line");
    if (!line) {
        json.null();
        return;
    }
    json.beginObject();
    IncidentReport::addMembers(json, IncidentReport::lineOf(*line, schedules));
    json.endObject();
}

/// The numbers of the lines that it concerns, each once.
void addAffectedLines(JsonWriter& json, const TransitStorageIncident& incident) {
    std::unordered_set<std::uint64_t> told;
    json.key("lines").beginArray();
    for (const auto& entity : typed<TransitIncidentAffectedEntity>(incident.affectedEntities())) {
        if (told.insert(entity->muid()).second)
            json.value(fmt::format("{}", entity->muid()));
    }
    json.endArray();
}

void addIncidents(JsonWriter& json,
                  const std::vector<std::shared_ptr<TransitStorageIncident>>& incidents) {
    json.key("incidents").beginArray();
    for (const auto& incident : incidents) {
        const auto details = incident->details();
        json.beginObject();
        IncidentReport::addMembers(json, IncidentReport::incidentOf(*incident));
        json.key("description").value(incident->fullDescription());
        json.key("link").value(details ? details->link : std::nullopt);
        addAffectedLines(json, *incident);
        json.endObject();
    }
    json.endArray();
}

} // namespace

std::string HandOffJson::text() const {
    const auto* line = content ? std::get_if<HandOff::Line>(&*content) : nullptr;
    const auto* list = content ? std::get_if<HandOff::Incidents>(&*content) : nullptr;
    JsonWriter json;
    json.beginObject();
    JsonParts::addTime(json, "received", receivedAt);
    json.key("kind").value(kindOf(content));
    addLine(json, line ? line->line.get() : nullptr, schedules);
    if (line)
        addIncidents(json, typed<TransitStorageIncident>(line->line->incidents()));
    else
        addIncidents(
            json, list ? list->incidents : std::vector<std::shared_ptr<TransitStorageIncident>>());
    JsonParts::addError(json, error);
    return json.endObject().text();
}

} // namespace orvo
