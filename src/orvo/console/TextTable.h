#pragma once

#include "orvo/console/Terminal.h"

#include <string>
#include <vector>

namespace orvo {

/// Rows under headings. On a terminal the columns are aligned and the table fits the width: the
/// widest columns that may shrink are cut with `…`. Where even that is too wide, every row is a
/// block of its own: a line for each column, its text wrapped beside the heading. In a pipe every
/// row is one line of texts with tabs between, uncut and without headings, so that other programs
/// can read it.
class TextTable {
public:
    struct Column {
        std::string heading;
        enum class Alignment { Left, Right } alignment = Alignment::Left;
        bool mayShrink = true;
    };

    explicit TextTable(std::vector<Column> columns);

    /// One text a column; line breaks and control characters in it become blanks.
    void addRow(std::vector<std::string> cells);
    [[nodiscard]] bool isEmpty() const noexcept { return _rows.empty(); }

    void print(const Terminal& terminal) const;

private:
    [[nodiscard]] std::vector<std::size_t> widths(std::size_t available) const;
    void printAligned(const Terminal& terminal, const std::vector<std::size_t>& widths) const;
    void printBlocks(const Terminal& terminal) const;

    std::vector<Column> _columns;
    std::vector<std::vector<std::string>> _rows;
};

} // namespace orvo
