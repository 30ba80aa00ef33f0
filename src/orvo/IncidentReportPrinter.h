#pragma once

#include "orvo/IncidentReport.h"
#include "orvo/console/Terminal.h"

namespace orvo {

/// Prints reports for people: each line with what is current and, fainter, what is coming.
class IncidentReportPrinter {
public:
    enum class Lines {
        Each,
        WithIncidents, ///< the others are counted in one line at the end
    };

    explicit IncidentReportPrinter(const Terminal& terminal)
        : _terminal(terminal) {}

    void print(const IncidentReport& report, Lines which) const;

private:
    void printLine(const IncidentReport::Line& line, double now) const;
    void printIncident(const IncidentReport::Incident& incident, double now) const;

    const Terminal& _terminal;
};

} // namespace orvo
