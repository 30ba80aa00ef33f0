#include "orvo/window/IncidentPage.h"

#include "orvo/console/DisplayText.h"
#include "orvo/console/PeriodText.h"
#include "orvo/window/WindowTexts.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/foundation/NSArray.h"

#include <algorithm>
#include <unordered_set>

namespace orvo {

namespace {

/// The summary is looked for at the beginning however the lines of the two are broken.
std::string wholeText(const std::string& summary, const std::string& description) {
    if (description.empty() || summary.empty() ||
        DisplayText::oneLine(description).starts_with(DisplayText::oneLine(summary)))
        return description.empty() ? summary : description;
    return summary + "\n\n" + description;
}

void addLines(IncidentPage::Incident& result,
              const TransitStorageIncident& incident,
              const std::optional<LineMark>& line,
              const ScheduleStore* schedules) {
    std::unordered_set<std::uint64_t> muids;
    for (const auto& entity : typed<TransitIncidentAffectedEntity>(incident.affectedEntities())) {
        const auto muid = entity->muid();
        if (!muids.insert(muid).second || muids.size() > IncidentPage::MostNamedLines)
            continue;
        if (line && line->muid == muid)
            result.lines.push_back(*line);
        else if (const auto known = schedules ? schedules->line(muid) : std::nullopt)
            result.lines.push_back(LineMark::ofLine(*known));
    }
    result.otherLines = result.lines.empty() ? 0 : muids.size() - result.lines.size();
}

IncidentPage::Incident incidentOf(const TransitStorageIncident& incident,
                                  const std::optional<LineMark>& line,
                                  const ScheduleStore* schedules) {
    IncidentPage::Incident result;
    result.title = DisplayText::oneLine(incident.title().value_or(""));
    result.start = PeriodText::secondsOf(incident.startDate());
    result.end = PeriodText::secondsOf(incident.endDate());
    result.summary = incident.summary().value_or("");
    result.text = wholeText(result.summary, incident.fullDescription().value_or(""));
    if (const auto details = incident.details()) {
        result.isUnknown = details->isUnknown;
        result.timeZone = details->timeZone;
        result.link = details->link;
    }
    addLines(result, incident, line, schedules);
    return result;
}

void addLine(std::string& text, const std::string& line) {
    if (!line.empty())
        text += line + "\n";
}

std::string shieldsIn(const IncidentPage::Incident& incident) {
    std::string text;
    for (const auto& line : incident.lines) {
        const auto shield = line.shieldText();
        text += (text.empty() ? "[" : " [") + (shield.empty() ? line.title : shield) + "]";
    }
    if (incident.otherLines > 0)
        text += " " + WindowTexts::moreLines(incident.otherLines);
    return text;
}

} // namespace

std::string IncidentPage::Incident::period(double now) const {
    return isUnknown ? std::string() : WindowTexts::period(start, end, now, timeZone);
}

bool IncidentPage::Incident::isCurrent(double now) const {
    return (!start || *start <= now) && (!end || now < *end);
}

std::optional<double> IncidentPage::Incident::nextPeriodChange(double now) const {
    return isUnknown ? std::nullopt : PeriodText::nextChange(start, end, now, timeZone);
}

std::vector<std::string> IncidentPage::Incident::paragraphs() const {
    std::vector<std::string> paragraphs;
    for (std::size_t at = 0; at < text.size();) {
        const auto lineEnd = std::min(text.find('\n', at), text.size());
        auto paragraph = DisplayText::oneLine(std::string_view(text).substr(at, lineEnd - at));
        if (!paragraph.empty())
            paragraphs.push_back(std::move(paragraph));
        at = lineEnd + 1;
    }
    return paragraphs;
}

bool IncidentPage::Incident::canOpenLink() const {
    return link && (link->starts_with("https://") || link->starts_with("http://"));
}

IncidentPage IncidentPage::ofLine(const TransitStorageLineItem& line,
                                  const ScheduleStore* schedules) {
    IncidentPage page;
    page.line = LineMark::ofLine(line, schedules);
    for (const auto& incident : typed<TransitStorageIncident>(line.incidents()))
        page.incidents.push_back(incidentOf(*incident, page.line, schedules));
    return page;
}

IncidentPage
IncidentPage::ofIncidents(const std::vector<std::shared_ptr<TransitStorageIncident>>& incidents,
                          const ScheduleStore* schedules) {
    IncidentPage page;
    for (const auto& incident : incidents)
        page.incidents.push_back(incidentOf(*incident, std::nullopt, schedules));
    return page;
}

void IncidentPage::putCurrentFirst(double now) {
    std::stable_partition(incidents.begin(), incidents.end(), [now](const Incident& incident) {
        return incident.isCurrent(now);
    });
}

std::string IncidentPage::heading() const {
    if (!line)
        return WindowTexts::incidents(incidents.size());
    return line->name + (line->name.empty() || line->detail.empty() ? "" : " · ") + line->detail;
}

std::string IncidentPage::shown(double now) const {
    std::string text;
    if (line) {
        const auto shield = line->pictureText();
        addLine(text, (shield.empty() ? "" : "[" + shield + "] ") + line->title);
        addLine(text, line->detail);
        if (incidents.empty())
            addLine(text, WindowTexts::text("GoodService"));
    } else {
        addLine(text, heading());
    }
    for (const auto& incident : incidents) {
        text += "\n";
        addLine(text, incident.title);
        addLine(text, incident.period(now));
        addLine(text, shieldsIn(incident));
        for (const auto& paragraph : incident.paragraphs())
            addLine(text, paragraph);
        addLine(text, incident.link.value_or(""));
    }
    return text;
}

} // namespace orvo
