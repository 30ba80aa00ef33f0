#include "print/TextPrinter.h"

#include "orvo/console/DisplayText.h"

#include <algorithm>
#include <charconv>
#include <fmt/format.h>
#include <map>

namespace orvo {

namespace {

constexpr std::size_t Gap = 2;
constexpr std::size_t WidestText = 100;

/// The fixed images in one column: their shapes, as colours alone say nothing.
struct ImageMark {
    const char* text;
    Terminal::Style style;
};

ImageMark markOfImage(const std::string& name) {
    static const std::map<std::string, ImageMark, std::less<>> marks{
        {"good-v2", {"✓", Terminal::Style::Good}},
        {"good-alt-v2", {"✓", Terminal::Style::Plain}},
        {"advisories-v2", {"!", Terminal::Style::Plain}},
        {"WidgetGenericTransit", {"#", Terminal::Style::Plain}},
    };
    const auto found = marks.find(name);
    return found == marks.end() ? ImageMark{"?", Terminal::Style::Plain} : found->second;
}

/// `2;R;G;B`, as a terminal takes a colour.
std::string colourCode(const std::string& digits) {
    unsigned number = 0;
    (void)std::from_chars(digits.data(), digits.data() + digits.size(), number, 16);
    return fmt::format("2;{};{};{}", number >> 16U & 0xFFU, number >> 8U & 0xFFU, number & 0xFFU);
}

std::string coloured(const std::string& text, const PrintedShield& shield) {
    if (!shield.background)
        return fmt::format("\x1b[7m {} \x1b[0m", text);
    return fmt::format("\x1b[48;{};38;{}m {} \x1b[0m",
                       colourCode(*shield.background),
                       colourCode(shield.foreground),
                       text);
}

} // namespace

std::string TextPrinter::text(const PrintedWidget& widget) const {
    std::string text =
        _terminal.styled("compact:", Terminal::Style::Faint) + "\n" + rows({widget.summary});
    if (!widget.expanded.empty())
        text += "\n" + _terminal.styled("expanded:", Terminal::Style::Faint) + "\n" +
                rows(widget.expanded);
    return text;
}

TextPrinter::Mark TextPrinter::shields(const std::vector<PrintedShield>& shields) const {
    Mark mark;
    for (const auto& shield : shields) {
        const auto text = DisplayText::oneLine(shield.text);
        if (mark.width > 0) {
            mark.text += ' ';
            mark.width += 1;
        }
        mark.text +=
            _terminal.settings().usesStyles ? coloured(text, shield) : fmt::format("[{}]", text);
        mark.width += DisplayText::width(text) + 2;
    }
    return mark;
}

TextPrinter::Mark TextPrinter::artwork(const PrintedRow& row) const {
    if (!row.artwork || row.artworkHidden || row.kind == PrintedRow::Kind::Summary)
        return {};
    if (!row.artwork->image)
        return shields(row.artwork->shields);
    const auto mark = markOfImage(*row.artwork->image);
    const bool isDimmed = row.artwork->alpha < 1;
    return {_terminal.styled(mark.text, isDimmed ? Terminal::Style::Faint : mark.style),
            DisplayText::width(mark.text)};
}

std::string TextPrinter::rows(const std::vector<PrintedRow>& rows) const {
    std::size_t artworkWidth = 0;
    for (const auto& one : rows)
        artworkWidth = std::max(artworkWidth, artwork(one).width);
    const auto digits = fmt::format("{}", rows.size() - 1).size();
    std::string text;
    for (std::size_t i = 0; i < rows.size(); ++i)
        text += row(rows[i], fmt::format("{:>{}}", i, digits), artworkWidth);
    return text;
}

std::string
TextPrinter::row(const PrintedRow& row, const std::string& number, std::size_t artworkWidth) const {
    const auto mark = artwork(row);
    const auto column = artworkWidth == 0 ? 0 : artworkWidth + Gap;
    const auto indent = number.size() + Gap + column;
    std::string text = paragraph(row.primaryText.value_or(""), Terminal::Style::Bold, indent);
    // The first line's indent is where number and artwork stand.
    const std::string before = _terminal.styled(number, Terminal::Style::Faint) +
                               std::string(Gap, ' ') + mark.text +
                               std::string(column - mark.width, ' ');
    text = text.empty() ? before + "\n" : before + text.substr(indent);
    if (row.kind == PrintedRow::Kind::Summary && !row.artwork->shields.empty())
        text += std::string(indent, ' ') + shields(row.artwork->shields).text + "\n";
    text += paragraph(row.secondaryText.value_or(""), Terminal::Style::Plain, indent);
    if (row.opens)
        text += paragraph("→ " + row.opens->text(), Terminal::Style::Faint, indent);
    return text;
}

std::string
TextPrinter::paragraph(const std::string& text, Terminal::Style style, std::size_t indent) const {
    const auto& settings = _terminal.settings();
    std::size_t columns = std::string::npos;
    if (settings.outputIsTerminal) {
        const auto available = std::min(settings.width, WidestText);
        columns = available > indent ? available - indent : 1;
    }
    std::string lines;
    for (const auto& line : DisplayText::wrap(DisplayText::oneLine(text), columns))
        lines += std::string(indent, ' ') + _terminal.styled(line, style) + "\n";
    return lines;
}

} // namespace orvo
