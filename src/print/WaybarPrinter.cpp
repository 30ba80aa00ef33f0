#include "print/WaybarPrinter.h"

#include "orvo/console/DisplayText.h"
#include "orvo/console/JsonWriter.h"

#include <fmt/format.h>

namespace orvo {

namespace {

const char* nameOf(ServiceState state) {
    switch (state) {
    case ServiceState::NoFavorites:
        return "no-favorites";
    case ServiceState::Good:
        return "good";
    case ServiceState::Advisories:
        return "advisories";
    case ServiceState::Unavailable:
        break;
    }
    return "unavailable";
}

/// In one line, with what means something in markup written out.
std::string escaped(const std::string& text) {
    std::string markup;
    for (const char c : DisplayText::oneLine(text)) {
        switch (c) {
        case '&':
            markup += "&amp;";
            break;
        case '<':
            markup += "&lt;";
            break;
        case '>':
            markup += "&gt;";
            break;
        case '"':
            markup += "&quot;";
            break;
        case '\'':
            markup += "&apos;";
            break;
        default:
            markup += c;
        }
    }
    return markup;
}

std::string markupOf(const PrintedShield& shield) {
    const auto text = escaped(shield.text);
    if (!shield.background)
        return fmt::format("[{}]", text);
    return fmt::format("<span background=\"#{}\" foreground=\"#{}\"> {} </span>",
                       *shield.background,
                       shield.foreground,
                       text);
}

std::string shieldsOf(const PrintedRow& row) {
    std::string markup;
    if (!row.artwork || row.artworkHidden)
        return markup;
    for (const auto& shield : row.artwork->shields)
        markup += (markup.empty() ? "" : " ") + markupOf(shield);
    return markup;
}

void appendLine(std::string& markup, const std::string& line) {
    if (!line.empty())
        markup += (markup.empty() ? "" : "\n") + line;
}

/// Its title beside an item's shield, or above a summary's.
void appendRow(std::string& markup, const PrintedRow& row) {
    std::string title = escaped(row.primaryText.value_or(""));
    if (!title.empty())
        title = "<b>" + title + "</b>";
    const auto shields = shieldsOf(row);
    const bool isSummary = row.kind == PrintedRow::Kind::Summary;
    const char* gap = shields.empty() || title.empty() ? "" : " ";
    appendLine(markup, isSummary ? title : shields + gap + title);
    appendLine(markup, isSummary ? shields : escaped(row.secondaryText.value_or("")));
}

std::string tooltipOf(const PrintedWidget& widget) {
    std::string markup;
    if (widget.expanded.empty())
        appendRow(markup, widget.summary);
    for (const auto& row : widget.expanded)
        appendRow(markup, row);
    return markup;
}

} // namespace

std::string WaybarPrinter::text(const PrintedWidget& widget) const {
    JsonWriter json(JsonWriter::Layout::OneLine);
    json.beginObject();
    json.key("text").value(escaped(widget.summary.primaryText.value_or("")));
    json.key("alt").value(nameOf(widget.state));
    json.key("tooltip").value(tooltipOf(widget));
    json.key("class").value(nameOf(widget.state));
    json.key("percentage").value(std::int64_t{widget.clearPercentage});
    json.endObject();
    return json.text();
}

} // namespace orvo
