#include "orvo/IncidentReportPrinter.h"

#include "orvo/console/DisplayText.h"
#include "orvo/console/Paragraph.h"
#include "orvo/console/PeriodText.h"

#include <algorithm>
#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

bool isComing(const IncidentReport::Incident& incident, double now) {
    return incident.start && *incident.start > now;
}

} // namespace

void IncidentReportPrinter::print(const IncidentReport& report, Lines which) const {
    std::size_t leftOut = 0;
    const char* gap = "";
    for (const auto& line : report.lines) {
        if (which == Lines::WithIncidents && line.incidents.empty()) {
            ++leftOut;
            continue;
        }
        _terminal.output() << gap;
        printLine(line, report.at);
        gap = "\n";
    }
    if (leftOut > 0)
        _terminal.output() << fmt::format(
            "{}{} {}: good service\n", gap, leftOut, leftOut == 1 ? "other line" : "other lines");
}

void IncidentReportPrinter::printLine(const IncidentReport::Line& line, double now) const {
    const std::string system = DisplayText::oneLine(line.system);
    _terminal.output() << _terminal.styled(DisplayText::oneLine(line.name), Terminal::Style::Bold)
                       << (system.empty() ? "" : " · ") << system << '\n';
    const auto comes = [&](const auto& incident) {
        return isComing(incident, now);
    };
    if (std::ranges::all_of(line.incidents, comes))
        printParagraph(_terminal, "Good service", Terminal::Style::Good);
    for (const auto& incident : line.incidents) {
        if (!comes(incident))
            printIncident(incident, now);
    }
    for (const auto& incident : line.incidents) {
        if (comes(incident))
            printIncident(incident, now);
    }
}

void IncidentReportPrinter::printIncident(const IncidentReport::Incident& incident,
                                          double now) const {
    const bool coming = isComing(incident, now);
    printParagraph(_terminal,
                   coming ? "Coming: " + incident.title : incident.title,
                   coming ? Terminal::Style::Faint : Terminal::Style::Advisory);
    printParagraph(
        _terminal, incident.summary, coming ? Terminal::Style::Faint : Terminal::Style::Plain);
    if (!incident.isUnknown)
        printParagraph(_terminal,
                       PeriodText::period(incident.start, incident.end, now, incident.timeZone),
                       Terminal::Style::Faint);
}

} // namespace orvo
