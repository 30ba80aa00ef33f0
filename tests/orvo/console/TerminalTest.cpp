#include "orvo/console/Terminal.h"

#include <gtest/gtest.h>

#include <sstream>

namespace orvo {
namespace {

class TerminalTest : public ::testing::Test {
protected:
    Terminal terminal(Terminal::Settings settings) { return {output, error, settings}; }

    std::ostringstream output;
    std::ostringstream error;
};

TEST_F(TerminalTest, ErrorsGoToTheErrorOutputWithTheirCure) {
    terminal({}).error("there is no feed city", "See: orvo feeds list");
    EXPECT_EQ(output.str(), "");
    EXPECT_EQ(error.str(), "orvo: there is no feed city\nSee: orvo feeds list\n");
}

TEST_F(TerminalTest, AnotherProgramSpeaksInItsOwnName) {
    terminal({.program = "orvo-transit-widget"}).error("no");
    EXPECT_EQ(error.str(), "orvo-transit-widget: no\n");
}

TEST_F(TerminalTest, WarningsSayThatTheyAreNone) {
    terminal({}).warning("old");
    EXPECT_EQ(error.str(), "orvo: warning: old\n");
}

TEST_F(TerminalTest, ProgressIsForPeopleOnly) {
    terminal({.errorIsTerminal = false}).progress("50 %");
    EXPECT_EQ(error.str(), "");
}

TEST_F(TerminalTest, ProgressReplacesItselfAndGoesBeforeTheNextLine) {
    const auto shown = terminal({.errorIsTerminal = true});
    shown.progress("50 %");
    shown.error("broken");
    shown.endProgress();
    EXPECT_EQ(error.str(), "\r\x1b[K50 %\r\x1b[Korvo: broken\n");
}

TEST_F(TerminalTest, ProgressNeverWraps) {
    terminal({.errorIsTerminal = true, .width = 20}).progress(std::string(50, 'x'));
    EXPECT_EQ(error.str(), "\r\x1b[K" + std::string(18, 'x') + "…");
}

TEST_F(TerminalTest, StylesAreLeftOutWhereNobodySeesThem) {
    EXPECT_EQ(terminal({}).styled("x", Terminal::Style::Bold), "x");
    EXPECT_EQ(terminal({.usesStyles = true}).styled("x", Terminal::Style::Bold), "\x1b[1mx\x1b[0m");
    EXPECT_EQ(terminal({.usesStyles = true}).styled("x", Terminal::Style::Plain), "x");
}

TEST_F(TerminalTest, ATinyWidthIsNotBelieved) {
    EXPECT_EQ(terminal({.width = 0}).settings().width, 20U);
}

} // namespace
} // namespace orvo
