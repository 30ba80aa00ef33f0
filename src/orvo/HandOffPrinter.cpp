#include "orvo/HandOffPrinter.h"

#include "orvo/FavoritesListCommand.h"
#include "orvo/console/DisplayText.h"
#include "orvo/console/PeriodText.h"
#include "platform/foundation/NSArray.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <ostream>
#include <unordered_set>

namespace orvo {

namespace {

constexpr std::size_t WidestText = 100;
constexpr std::size_t MostNamedLines = 12;

std::optional<double> secondsOf(const std::shared_ptr<NSDate>& date) {
    return date ? std::optional(date->timeIntervalSince1970()) : std::nullopt;
}

/// The description where there is one, with the summary before it unless it begins so anyway,
/// however the lines of the two are broken.
std::string wholeText(const TransitStorageIncident& incident) {
    const auto summary = incident.summary().value_or("");
    const auto description = incident.fullDescription().value_or("");
    if (description.empty() || summary.empty() ||
        DisplayText::oneLine(description).starts_with(DisplayText::oneLine(summary)))
        return description.empty() ? summary : description;
    return summary + "\n\n" + description;
}

} // namespace

std::shared_ptr<NSError> HandOffPrinter::print(const HandOff::Content& content) {
    if (const auto* line = std::get_if<HandOff::Line>(&content))
        printLine(*line->line);
    else if (const auto* incidents = std::get_if<HandOff::Incidents>(&content))
        printIncidents(*incidents);
    else
        return printFavorites();
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

void HandOffPrinter::printLine(const TransitStorageLineItem& line) {
    const auto& terminal = _context.terminal();
    const auto system = line.system() ? line.system()->name().value_or("") : "";
    terminal.output() << terminal.styled(DisplayText::oneLine(line.name().value_or("")),
                                         Terminal::Style::Bold)
                      << (system.empty() ? "" : " · ") << DisplayText::oneLine(system) << '\n';
    _line = &line;
    const auto incidents = typed<TransitStorageIncident>(line.incidents());
    if (incidents.empty())
        printParagraphs("Good service", Terminal::Style::Good);
    for (std::size_t i = 0; i < incidents.size(); ++i) {
        if (i > 0)
            terminal.output() << '\n';
        printIncident(*incidents[i], Length::Whole);
    }
    _line = nullptr;
}

void HandOffPrinter::printIncidents(const HandOff::Incidents& incidents) {
    const auto& terminal = _context.terminal();
    const std::size_t count = incidents.incidents.size();
    terminal.output() << terminal.styled(
                             fmt::format("{} {}", count, count == 1 ? "incident" : "incidents"),
                             Terminal::Style::Bold)
                      << '\n';
    for (const auto& incident : incidents.incidents) {
        terminal.output() << '\n';
        printIncident(*incident, Length::Short);
    }
}

void HandOffPrinter::printIncident(const TransitStorageIncident& incident, Length length) {
    const auto details = incident.details();
    printParagraphs(incident.title().value_or(""), Terminal::Style::Advisory);
    if (!details || !details->isUnknown)
        printParagraphs(PeriodText::period(secondsOf(incident.startDate()),
                                           secondsOf(incident.endDate()),
                                           _context.now(),
                                           details ? details->timeZone : std::nullopt),
                        Terminal::Style::Faint);
    if (const auto lines = affectedLines(incident); !lines.empty())
        printParagraphs("Lines: " + lines, Terminal::Style::Faint);
    printParagraphs(length == Length::Whole ? wholeText(incident) : incident.summary().value_or(""),
                    Terminal::Style::Plain);
    if (details && details->link)
        printParagraphs(*details->link, Terminal::Style::Faint);
}

std::string HandOffPrinter::affectedLines(const TransitStorageIncident& incident) {
    std::unordered_set<std::uint64_t> muids;
    std::vector<std::string> names;
    for (const auto& entity : typed<TransitIncidentAffectedEntity>(incident.affectedEntities())) {
        if (!muids.insert(entity->muid()).second || muids.size() > MostNamedLines)
            continue;
        if (auto name = lineName(entity->muid()))
            names.push_back(DisplayText::oneLine(*name));
    }
    const auto others = muids.size() - names.size();
    if (others == 0 || names.empty())
        return fmt::format("{}", fmt::join(names, ", "));
    return fmt::format("{} and {} more", fmt::join(names, ", "), others);
}

std::optional<std::string> HandOffPrinter::lineName(std::uint64_t muid) {
    if (_line && _line->muid() == muid)
        return _line->name();
    std::shared_ptr<NSError> unreadable; // names are a help; without them the rest is still told
    const auto schedules = _context.schedules(unreadable);
    const auto line = schedules ? schedules->line(muid) : std::nullopt;
    return line ? std::optional(line->name()) : std::nullopt;
}

void HandOffPrinter::printParagraphs(const std::string& text, Terminal::Style style) const {
    const auto& settings = _context.terminal().settings();
    const std::size_t columns =
        settings.outputIsTerminal ? std::min(settings.width, WidestText) - 2 : std::string::npos;
    auto& output = _context.terminal().output();
    for (std::size_t start = 0; start < text.size();) {
        const auto end = std::min(text.find('\n', start), text.size());
        const auto lines = DisplayText::wrap(
            DisplayText::oneLine(std::string_view(text).substr(start, end - start)), columns);
        for (const auto& line : lines)
            output << "  " << _context.terminal().styled(line, style) << '\n';
        if (lines.empty())
            output << '\n';
        start = end + 1;
    }
}

} // namespace orvo
