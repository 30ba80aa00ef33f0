#include "orvo/console/Paragraph.h"

#include <gtest/gtest.h>

#include <sstream>
#include <string>

namespace orvo {
namespace {

std::string printed(const Terminal::Settings& settings,
                    std::string_view text,
                    Terminal::Style style = Terminal::Style::Plain) {
    std::ostringstream output;
    std::ostringstream error;
    printParagraph(Terminal(output, error, settings), text, style);
    EXPECT_EQ(error.str(), "");
    return output.str();
}

TEST(Paragraph, IsNoWiderThanTheTerminal) {
    const Terminal::Settings settings{.outputIsTerminal = true, .width = 20};
    EXPECT_EQ(printed(settings, "one two three four five"), "  one two three four\n  five\n");
    EXPECT_EQ(printed(settings, "one two three fours"), "  one two three\n  fours\n");
}

TEST(Paragraph, IsAtMostAHundredColumnsWide) {
    std::string text;
    for (int word = 0; word < 40; ++word)
        text += "abcd ";
    const auto lines = printed({.outputIsTerminal = true, .width = 400}, text);
    EXPECT_EQ(lines.find('\n'), 96U) << "two blanks and nineteen words, with a blank between";
}

TEST(Paragraph, IsOneLineInAPipe) {
    const std::string text(300, 'a');
    EXPECT_EQ(printed({.width = 20}, text + "\n" + text), "  " + text + " " + text + "\n");
}

TEST(Paragraph, EachLineHasTheStyle) {
    const Terminal::Settings settings{.outputIsTerminal = true, .usesStyles = true, .width = 20};
    std::ostringstream nowhere;
    const Terminal terminal(nowhere, nowhere, settings);
    const auto faint = [&](const char* text) {
        return terminal.styled(text, Terminal::Style::Faint);
    };
    EXPECT_EQ(printed(settings, "one two three four five", Terminal::Style::Faint),
              "  " + faint("one two three four") + "\n  " + faint("five") + "\n");
}

TEST(Paragraph, BlanksAreNone) {
    EXPECT_EQ(printed({.outputIsTerminal = true}, ""), "");
    EXPECT_EQ(printed({}, " \n\t "), "");
}

} // namespace
} // namespace orvo
