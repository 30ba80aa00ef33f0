#pragma once

#include "orvo/CommandContext.h"
#include "orvo/HandOff.h"
#include "orvo/window/IncidentPage.h"

namespace orvo {

/// Tells a person what was handed over: the line with its incidents in full, a list of incidents,
/// or the favourites.
class HandOffPrinter {
public:
    explicit HandOffPrinter(CommandContext& context)
        : _context(context) {}

    /// Nil, or why it could not be told.
    [[nodiscard]] std::shared_ptr<NSError> print(const HandOff::Content& content);

private:
    enum class Length { Whole, Short };

    [[nodiscard]] std::shared_ptr<NSError> printFavorites();
    void printLine(const IncidentPage& page) const;
    void printIncidents(const IncidentPage& page) const;
    void printIncident(const IncidentPage::Incident& incident, Length length) const;
    void printParagraphs(const std::string& text, Terminal::Style style) const;

    CommandContext& _context;
};

} // namespace orvo
