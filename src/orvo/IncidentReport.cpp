#include "orvo/IncidentReport.h"

#include "fetching/DebugTransitLineItem.h"
#include "orvo/JsonParts.h"
#include "orvo/console/DisplayText.h"
#include "orvo/console/PeriodText.h"
#include "platform/favorites/StoredTransitLine.h"
#include "platform/favorites/TransitStorageIncident.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/geoservices/FeedTransitIncident.h"

#include <fmt/format.h>

namespace orvo {

namespace {

std::optional<FeedLineOrigin> originOf(const TransitLineItem& item,
                                       const ScheduleStore* schedules) {
    const auto* debug = dynamic_cast<const DebugTransitLineItem*>(&item);
    const auto wrapped = debug ? debug->wrappedLine() : nullptr;
    if (auto origin = StoredTransitLine::originOf(wrapped ? *wrapped : item))
        return origin;
    const auto line = schedules ? schedules->line(item.muid()) : std::nullopt;
    return line ? std::optional(FeedLineOrigin{line->feed, line->routeId}) : std::nullopt;
}

/// The description's paragraphs after the summary, in one line.
std::string reasonOf(const TransitIncident& incident) {
    const std::string description = incident.fullDescription().value_or("");
    const std::string summary = incident.summary().value_or("");
    const bool begins = description.rfind(summary, 0) == 0;
    return DisplayText::oneLine(description.substr(begins ? summary.size() : 0));
}

FeedTransitIncident::Details detailsOf(const TransitIncident& incident) {
    if (const auto* feedIncident = dynamic_cast<const FeedTransitIncident*>(&incident))
        return feedIncident->details();
    const auto* storage = dynamic_cast<const TransitStorageIncident*>(&incident);
    return storage ? storage->details().value_or(FeedTransitIncident::Details())
                   : FeedTransitIncident::Details();
}

} // namespace

IncidentReport::Incident IncidentReport::incidentOf(const TransitIncident& incident) {
    const auto details = detailsOf(incident);
    return {incident.muid(),
            incident.title().value_or(""),
            incident.summary().value_or(""),
            PeriodText::secondsOf(incident.startDate()),
            PeriodText::secondsOf(incident.endDate()),
            nameOf(details.severity),
            nameOf(details.effect),
            details.isPartOfLine,
            details.isUnknown,
            details.timeZone,
            details.isUnknown ? reasonOf(incident) : std::string()};
}

IncidentReport::Line IncidentReport::lineOf(const TransitLineItem& item,
                                            const ScheduleStore* schedules) {
    Line line;
    if (const auto origin = originOf(item, schedules)) {
        line.feed = origin->feed;
        line.routeId = origin->routeId;
    }
    line.muid = item.muid();
    line.name = item.name().value_or("");
    line.system = item.system() ? item.system()->name().value_or("") : "";
    for (const auto& incident : typed<TransitIncident>(item.incidents()))
        line.incidents.push_back(incidentOf(*incident));
    return line;
}

std::vector<IncidentReport::Line> IncidentReport::linesOf(const std::shared_ptr<NSArray>& items,
                                                          const ScheduleStore* schedules) {
    std::vector<Line> lines;
    for (const auto& item : typed<TransitLineItem>(items))
        lines.push_back(lineOf(*item, schedules));
    return lines;
}

void IncidentReport::addMembers(JsonWriter& json, const Line& line) {
    json.key("feed").value(line.feed);
    json.key("route_id").value(line.routeId);
    json.key("muid").value(fmt::format("{}", line.muid));
    json.key("name").value(line.name);
    json.key("system").value(line.system);
}

void IncidentReport::addMembers(JsonWriter& json, const Incident& incident) {
    json.key("muid").value(fmt::format("{}", incident.muid));
    json.key("title").value(incident.title);
    json.key("summary").value(incident.summary);
    JsonParts::addTime(json, "start", incident.start);
    JsonParts::addTime(json, "end", incident.end);
    json.key("severity").value(incident.severity);
    json.key("effect").value(incident.effect);
    json.key("part").value(incident.isPartOfLine);
    json.key("unknown").value(incident.isUnknown);
}

std::string IncidentReport::json() const {
    JsonWriter json;
    json.beginObject();
    JsonParts::addTime(json, "at", at);
    json.key("lines").beginArray();
    for (const auto& line : lines) {
        json.beginObject();
        addMembers(json, line);
        json.key("incidents").beginArray();
        for (const auto& incident : line.incidents) {
            json.beginObject();
            addMembers(json, incident);
            json.endObject();
        }
        json.endArray().endObject();
    }
    json.endArray();
    JsonParts::addError(json, error);
    return json.endObject().text();
}

} // namespace orvo
