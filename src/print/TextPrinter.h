#pragma once

#include "orvo/console/Terminal.h"
#include "print/WidgetPrinter.h"

namespace orvo {

/// For people: the compact row, then the expanded rows, each with the number that `--open` takes.
///
///     expanded:
///     0  [M1]  Delays on M1 and M2
///              Signal failure at Central Station
///              → com.zentu.Orvo.Transit.Incident: line 9983648328448782976
///
/// Shields have their colours, and what the widget dims is faint, where the terminal shows styles.
/// On a terminal lines are broken to fit; in a pipe each text is one line.
class TextPrinter final : public WidgetPrinter {
public:
    explicit TextPrinter(Terminal terminal)
        : _terminal(std::move(terminal)) {}

    [[nodiscard]] std::string text(const PrintedWidget& widget) const override;

private:
    /// Text and how many columns it takes, styles not counted.
    struct Mark {
        std::string text;
        std::size_t width = 0;
    };

    [[nodiscard]] Mark shields(const std::vector<PrintedShield>& shields) const;
    [[nodiscard]] Mark artwork(const PrintedRow& row) const;
    [[nodiscard]] std::string rows(const std::vector<PrintedRow>& rows) const;
    [[nodiscard]] std::string
    row(const PrintedRow& row, const std::string& number, std::size_t artworkWidth) const;
    /// Broken to fit behind an indent.
    [[nodiscard]] std::string
    paragraph(const std::string& text, Terminal::Style style, std::size_t indent) const;

    Terminal _terminal;
};

} // namespace orvo
