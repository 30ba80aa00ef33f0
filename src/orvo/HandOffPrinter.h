#pragma once

#include "orvo/CommandContext.h"
#include "orvo/HandOff.h"

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
    void printLine(const TransitStorageLineItem& line);
    void printIncidents(const HandOff::Incidents& incidents);
    void printIncident(const TransitStorageIncident& incident, Length length);
    void printParagraphs(const std::string& text, Terminal::Style style) const;
    /// The names of the lines that an incident concerns, as far as they are known here.
    [[nodiscard]] std::string affectedLines(const TransitStorageIncident& incident);
    [[nodiscard]] std::optional<std::string> lineName(std::uint64_t muid);

    CommandContext& _context;
    const TransitStorageLineItem* _line = nullptr; ///< the one being printed
};

} // namespace orvo
