#include "orvo/console/HelpText.h"

#include "orvo/console/DisplayText.h"

#include <gtest/gtest.h>

#include <sstream>

namespace orvo {
namespace {

ProgramSpec sampleProgram() {
    return {"orvo",
            "Keeps what the widget shows.",
            {{.path = {"feeds", "add"},
              .summary = "Adds a feed",
              .description = "A feed is a schedule with its alerts. Its name is yours to choose.",
              .operands = {{.name = "NAME", .help = "a short name"}},
              .options = {{.name = "alerts",
                           .value = "PATH|URL",
                           .help = "where the alerts are",
                           .takesSeveral = true}},
              .examples = {{"orvo feeds add city", "adds it"}}},
             {.path = {"feeds", "list"}, .summary = "Lists the feeds", .description = ""},
             {.path = {"lines"}, .summary = "Finds lines", .description = ""}}};
}

TEST(HelpText, NamesEveryCommandOnce) {
    const std::string text = HelpText::program(sampleProgram(), 80);
    EXPECT_NE(text.find("feeds add "), std::string::npos);
    EXPECT_NE(text.find("feeds list "), std::string::npos);
    EXPECT_NE(text.find("lines "), std::string::npos);
    EXPECT_NE(text.find("--at TIME"), std::string::npos);
}

TEST(HelpText, OfACommandHasItsUsageOptionsAndExamples) {
    const auto program = sampleProgram();
    const std::string text = HelpText::command(program, program.commands[0], 80);
    EXPECT_EQ(text.rfind("Usage: orvo feeds add NAME [OPTION]…\n\nAdds a feed.\n", 0), 0U);
    EXPECT_NE(text.find("  --alerts PATH|URL…  where the alerts are\n"), std::string::npos);
    EXPECT_NE(text.find("  orvo feeds add city\n      adds it\n"), std::string::npos);
    EXPECT_NE(text.find("--demo"), std::string::npos);
}

TEST(HelpText, OfAProgramOfOneCommandHasAllOptionsTogether) {
    const ProgramSpec program{"rows",
                              "",
                              {{.path = {},
                                .summary = "Shows rows",
                                .description = "",
                                .options = {{.name = "follow", .value = "", .help = "go on"}}}}};
    const std::string text = HelpText::command(program, program.commands[0], 80);
    EXPECT_EQ(text.rfind("Usage: rows [OPTION]…\n\nShows rows.\n\nOptions:\n  --follow", 0), 0U);
    EXPECT_NE(text.find("--demo"), std::string::npos);
    EXPECT_EQ(text.find("every command"), std::string::npos);
}

TEST(HelpText, OfAGroupHasItsCommandsOnly) {
    const std::string text = HelpText::group(sampleProgram(), {"feeds"}, 80);
    EXPECT_NE(text.find("orvo feeds add NAME"), std::string::npos);
    EXPECT_EQ(text.find("Finds lines"), std::string::npos);
}

TEST(HelpText, FitsTheWidth) {
    const auto program = sampleProgram();
    for (const std::size_t width : {40U, 60U, 80U}) {
        std::istringstream lines(HelpText::command(program, program.commands[0], width));
        for (std::string line; std::getline(lines, line);)
            EXPECT_LE(DisplayText::width(line), std::max<std::size_t>(width, 48)) << line;
    }
}

TEST(ProgramSpec, FindsCommandsByTheirWholePath) {
    const auto program = sampleProgram();
    EXPECT_EQ(program.command({"feeds", "list"}), &program.commands[1]);
    EXPECT_EQ(program.command({"feeds"}), nullptr);
    EXPECT_EQ(program.commandsBelow({"feeds"}).size(), 2U);
    EXPECT_TRUE(program.commandsBelow({"lines"}).empty());
}

} // namespace
} // namespace orvo
