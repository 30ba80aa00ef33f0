#include "platform/mapuikit/TransitIncidentStringProvider.h"

namespace orvo {

namespace {

/// White space of ASCII and the separators that Unicode adds to it (no-break space not: it joins on
/// purpose).
std::optional<std::string> onOneLine(const std::optional<std::string>& text) {
    if (!text)
        return std::nullopt;
    std::string line;
    bool blankPending = false;
    for (std::size_t i = 0; i < text->size(); ++i) {
        const auto c = static_cast<unsigned char>((*text)[i]);
        const bool isLineSeparator =
            text->compare(i, 3, "\u2028") == 0 || text->compare(i, 3, "\u2029") == 0;
        if (c == ' ' || (c >= '\t' && c <= '\r') || isLineSeparator) {
            blankPending = !line.empty();
            i += isLineSeparator ? 2 : 0;
            continue;
        }
        if (blankPending)
            line += ' ';
        blankPending = false;
        line += static_cast<char>(c);
    }
    return line;
}

} // namespace

std::shared_ptr<TransitIncidentStringProvider> TransitIncidentStringProvider::sharedProvider() {
    return provider().get();
}

EnvironmentSlot<std::shared_ptr<TransitIncidentStringProvider>>&
TransitIncidentStringProvider::provider() {
    static EnvironmentSlot<std::shared_ptr<TransitIncidentStringProvider>> slot(
        [] { return std::make_shared<TransitIncidentStringProvider>(); });
    return slot;
}

std::optional<std::string> TransitIncidentStringProvider::cellTitleForIncident(
    const std::shared_ptr<TransitIncident>& incident) const {
    return incident ? onOneLine(incident->title()) : std::nullopt;
}

std::optional<std::string> TransitIncidentStringProvider::cellSecondaryTextForIncident(
    const std::shared_ptr<TransitIncident>& incident) const {
    return incident ? onOneLine(incident->summary()) : std::nullopt;
}

} // namespace orvo
