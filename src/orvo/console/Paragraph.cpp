#include "orvo/console/Paragraph.h"

#include "orvo/console/DisplayText.h"

#include <algorithm>
#include <ostream>
#include <string>

namespace orvo {

namespace {

constexpr std::size_t WidestParagraph = 100;
constexpr std::string_view Indentation = "  ";

} // namespace

void printParagraph(const Terminal& terminal, std::string_view text, Terminal::Style style) {
    const auto& settings = terminal.settings();
    const std::size_t columns = settings.outputIsTerminal
                                    ? std::min(settings.width, WidestParagraph) - Indentation.size()
                                    : std::string::npos;
    for (const auto& line : DisplayText::wrap(DisplayText::oneLine(text), columns))
        terminal.output() << Indentation << terminal.styled(line, style) << '\n';
}

} // namespace orvo
