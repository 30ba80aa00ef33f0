#include "orvo/HandOffPrinter.h"

#include "orvo/FavoritesListCommand.h"
#include "orvo/HandOffPage.h"
#include "orvo/console/DisplayText.h"
#include "orvo/console/Paragraph.h"
#include "orvo/console/PeriodText.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <ostream>

namespace orvo {

namespace {

/// The names of the lines that an incident concerns, as far as they are known here.
std::string affectedLines(const IncidentPage::Incident& incident) {
    std::vector<std::string> names;
    for (const auto& line : incident.lines)
        names.push_back(line.name);
    if (incident.otherLines == 0)
        return fmt::format("{}", fmt::join(names, ", "));
    return fmt::format("{} and {} more", fmt::join(names, ", "), incident.otherLines);
}

} // namespace

std::shared_ptr<NSError> HandOffPrinter::print(const HandOff::Content& content) {
    const auto page = incidentPageOf(content, _context);
    if (!page)
        return printFavorites();
    if (page->line)
        printLine(*page);
    else
        printIncidents(*page);
    return nullptr;
}

std::shared_ptr<NSError> HandOffPrinter::printFavorites() {
    std::shared_ptr<NSError> error;
    std::vector<FavoritesStore::Entry> entries;
    if (const auto store = CommandContext::favorites(FavoritesStore::Access::Read, error))
        entries = store->entries(&error);
    if (error)
        return error;
    if (!entries.empty()) {
        (void)FavoritesListCommand().run(Arguments(), _context);
        return nullptr;
    }
    const auto& terminal = _context.terminal();
    terminal.output() << terminal.styled("No favourite lines yet", Terminal::Style::Bold) << '\n'
                      << "  Find a line with:  orvo lines SEARCH\n"
                         "  Add it with:       orvo favorites add LINE\n";
    return nullptr;
}

void HandOffPrinter::printLine(const IncidentPage& page) const {
    const auto& terminal = _context.terminal();
    const auto& line = *page.line;
    terminal.output() << terminal.styled(line.name, Terminal::Style::Bold)
                      << (line.detail.empty() ? "" : " · ") << line.detail << '\n';
    if (page.incidents.empty())
        printParagraphs("Good service", Terminal::Style::Good);
    const char* gap = "";
    for (const auto& incident : page.incidents) {
        terminal.output() << gap;
        printIncident(incident, Length::Whole);
        gap = "\n";
    }
}

void HandOffPrinter::printIncidents(const IncidentPage& page) const {
    const auto& terminal = _context.terminal();
    const auto count = page.incidents.size();
    terminal.output() << terminal.styled(
                             fmt::format("{} {}", count, count == 1 ? "incident" : "incidents"),
                             Terminal::Style::Bold)
                      << '\n';
    for (const auto& incident : page.incidents) {
        terminal.output() << '\n';
        printIncident(incident, Length::Short);
    }
}

void HandOffPrinter::printIncident(const IncidentPage::Incident& incident, Length length) const {
    printParagraphs(incident.title, Terminal::Style::Advisory);
    if (!incident.isUnknown)
        printParagraphs(
            PeriodText::period(incident.start, incident.end, _context.now(), incident.timeZone),
            Terminal::Style::Faint);
    if (const auto lines = affectedLines(incident); !lines.empty())
        printParagraphs("Lines: " + lines, Terminal::Style::Faint);
    printParagraphs(length == Length::Whole ? incident.text : incident.summary,
                    Terminal::Style::Plain);
    if (incident.link)
        printParagraphs(*incident.link, Terminal::Style::Faint);
}

void HandOffPrinter::printParagraphs(const std::string& text, Terminal::Style style) const {
    const auto& terminal = _context.terminal();
    for (std::size_t start = 0; start < text.size();) {
        const auto end = std::min(text.find('\n', start), text.size());
        const auto paragraph =
            DisplayText::oneLine(std::string_view(text).substr(start, end - start));
        if (paragraph.empty())
            terminal.output() << '\n';
        else
            printParagraph(terminal, paragraph, style);
        start = end + 1;
    }
}

} // namespace orvo
