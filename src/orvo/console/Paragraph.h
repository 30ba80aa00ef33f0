#pragma once

#include "orvo/console/Terminal.h"

#include <string_view>

namespace orvo {

/// Prints a text to the terminal's output as one paragraph, two blanks in: at most 100 columns wide
/// and no wider than the terminal, in a pipe one line. Nothing for a text of blanks.
void printParagraph(const Terminal& terminal, std::string_view text, Terminal::Style style);

} // namespace orvo
