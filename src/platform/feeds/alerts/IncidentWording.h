#pragma once

#include "platform/feeds/alerts/ConcernedLines.h"
#include "platform/feeds/alerts/Incident.h"
#include "platform/feeds/alerts/IncidentWords.h"
#include "platform/feeds/alerts/LanguagePreference.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// The texts of an incident as a person reads them. Clean and capped.
struct IncidentTexts {
    std::string title;                          ///< on one line, never blank
    std::optional<std::string> summary;         ///< on one line; nothing when it would repeat
    std::optional<std::string> fullDescription; ///< nothing without one, or where the summary is it
    bool isSummaryWhole = false;                ///< the summary is all of the description
    std::optional<std::string> spokenTitle; ///< nothing when it is as the title, or there is none
    std::optional<std::string> link;        ///< an http or https address
};

/// Chooses and composes texts for one person.
class IncidentWording {
public:
    /// @param person the person's language, a BCP-47 tag
    /// @param agency the agency's; empty where the schedule does not say
    IncidentWording(std::string_view person, std::string_view agency);

    /// The header is the title; where it is blank, or only the name of one of the lines, the effect
    /// in words. The description's first paragraph is the summary, without a header that it
    /// repeats; where there is none, cause and effect in words.
    [[nodiscard]] IncidentTexts
    textsOf(const Incident& incident, const ConcernedLines& lines, IncidentCause cause) const;

    /// Whether the title may turn out to be only the name of a line, if it has no longer one.
    /// @param nameLength of its short and its long name together, in bytes
    [[nodiscard]] bool mayBeOnlyName(const Incident& incident, std::size_t nameLength) const;

    /// The first paragraph of the description, on one line, without the header where it begins with
    /// it; the next paragraph where that was all. Empty when nothing else is said.
    ///
    /// A view into the description, or into `room` where it was written anew.
    [[nodiscard]] static std::string_view
    summaryOf(std::string_view description, std::string_view header, std::string& room);

private:
    LanguagePreference _preference;
    IncidentWords _words;
};

} // namespace orvo
