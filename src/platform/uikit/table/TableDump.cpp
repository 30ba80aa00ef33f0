#include "platform/uikit/table/TableDump.h"

#include "platform/uikit/table/UITableView.h"

#include <cstdio>

namespace orvo {

namespace {

std::string number(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.6g", value == 0 ? 0 : value);
    return text;
}

std::string marksOf(const UITableViewCell& cell) {
    std::string marks;
    if (const auto& line = cell._separator()) {
        marks += " line";
        if (line->insets.leading != 0 || line->insets.trailing != 0)
            marks += " " + number(line->insets.leading) + "…" + number(line->insets.trailing);
    }
    if (cell.isHighlighted())
        marks += " pressed";
    if (cell.isSelected())
        marks += " selected";
    if (cell.isFocused())
        marks += " focused";
    return marks;
}

} // namespace

std::string dumpTable(const UITableView& table) {
    const auto& frame = table.frame();
    std::string text = "table " + number(frame.size.width) + " " + number(frame.size.height) +
                       " from " + number(table.contentOffset().y) + " of " +
                       number(table.contentSize().height) + "\n";
    for (const auto& path : table.indexPathsForVisibleRows()) {
        const auto cell = table.cellForRowAtIndexPath(*path);
        if (!cell)
            continue;
        text += "  " + std::to_string(path->section()) + "-" + std::to_string(path->row()) + " " +
                cell->className() + " " + number(cell->frame().origin.y) + " " +
                number(cell->frame().size.height) + marksOf(*cell) + "\n";
    }
    return text;
}

} // namespace orvo
