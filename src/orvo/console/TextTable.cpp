#include "orvo/console/TextTable.h"

#include "orvo/console/DisplayText.h"

#include <algorithm>
#include <numeric>
#include <ostream>

namespace orvo {

namespace {

constexpr std::size_t Gap = 2;
constexpr std::size_t NarrowestColumn = 6;

std::size_t totalWidth(const std::vector<std::size_t>& widths) {
    const std::size_t gaps = Gap * (widths.empty() ? 0 : widths.size() - 1);
    return std::accumulate(widths.begin(), widths.end(), gaps);
}

} // namespace

TextTable::TextTable(std::vector<Column> columns)
    : _columns(std::move(columns)) {}

void TextTable::addRow(std::vector<std::string> cells) {
    cells.resize(_columns.size());
    for (auto& cell : cells)
        cell = DisplayText::oneLine(cell);
    _rows.push_back(std::move(cells));
}

std::vector<std::size_t> TextTable::widths(std::size_t available) const {
    std::vector<std::size_t> widths;
    for (std::size_t i = 0; i < _columns.size(); ++i) {
        std::size_t width = DisplayText::width(_columns[i].heading);
        for (const auto& row : _rows)
            width = std::max(width, DisplayText::width(row[i]));
        widths.push_back(width);
    }
    while (totalWidth(widths) > available) {
        std::size_t widest = widths.size();
        for (std::size_t i = 0; i < widths.size(); ++i) {
            if (_columns[i].mayShrink && widths[i] > NarrowestColumn &&
                (widest == widths.size() || widths[i] > widths[widest]))
                widest = i;
        }
        if (widest == widths.size())
            break;
        --widths[widest];
    }
    return widths;
}

void TextTable::print(const Terminal& terminal) const {
    auto& output = terminal.output();
    if (!terminal.settings().outputIsTerminal) {
        for (const auto& row : _rows) {
            for (std::size_t i = 0; i < row.size(); ++i)
                output << (i == 0 ? "" : "\t") << row[i];
            output << '\n';
        }
        return;
    }
    const auto widths = this->widths(terminal.settings().width);
    if (totalWidth(widths) <= terminal.settings().width)
        printAligned(terminal, widths);
    else
        printBlocks(terminal);
}

void TextTable::printAligned(const Terminal& terminal,
                             const std::vector<std::size_t>& widths) const {
    auto& output = terminal.output();
    const auto line = [&](const std::vector<std::string>& cells, Terminal::Style style) {
        std::string text;
        for (std::size_t i = 0; i < cells.size(); ++i) {
            const std::string cell = DisplayText::cut(cells[i], widths[i]);
            const std::string padding(widths[i] - DisplayText::width(cell), ' ');
            const bool right = _columns[i].alignment == Column::Alignment::Right;
            text +=
                (i == 0 ? "" : std::string(Gap, ' ')) + (right ? padding + cell : cell + padding);
        }
        text.erase(text.find_last_not_of(' ') + 1);
        output << terminal.styled(text, style) << '\n';
    };
    std::vector<std::string> headings;
    for (const auto& column : _columns)
        headings.push_back(column.heading);
    line(headings, Terminal::Style::Faint);
    for (const auto& row : _rows)
        line(row, Terminal::Style::Plain);
}

void TextTable::printBlocks(const Terminal& terminal) const {
    constexpr std::size_t NarrowestText = 8;
    auto& output = terminal.output();
    std::size_t indent = 0;
    for (const auto& column : _columns)
        indent = std::max(indent, DisplayText::width(column.heading) + Gap);
    const std::size_t columns =
        std::max(terminal.settings().width, indent + NarrowestText) - indent;
    const char* gap = "";
    for (const auto& row : _rows) {
        output << gap;
        for (std::size_t i = 0; i < row.size(); ++i) {
            std::string before = _columns[i].heading;
            before.append(indent - DisplayText::width(before), ' ');
            for (const auto& line : DisplayText::wrap(row[i], columns)) {
                output << terminal.styled(before, Terminal::Style::Faint) << line << '\n';
                before.assign(indent, ' ');
            }
        }
        gap = "\n";
    }
}

} // namespace orvo
