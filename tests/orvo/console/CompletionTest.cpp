#include "orvo/console/Completion.h"

#include "orvo/console/CompletionParts.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;

ProgramSpec sampleProgram() {
    return {"orvo",
            "",
            {{.path = {"feeds", "check"},
              .summary = "It's checked",
              .description = "",
              .operands = {{.name = "NAME",
                            .help = "",
                            .count = OperandSpec::Count::Any,
                            .completes = Completes::Feed}},
              .options = {{.name = "file",
                           .value = "PATH",
                           .help = "a [file]: any",
                           .completes = Completes::File}}},
             {.path = {"feeds", "list"}, .summary = "Lists", .description = ""},
             {.path = {"lines"}, .summary = "Finds", .description = ""}}};
}

TEST(Completion, WordsOfAGroupStandOnce) {
    const auto words = Completion::wordsAfter(sampleProgram(), {});
    ASSERT_EQ(words.size(), 2U);
    EXPECT_EQ(words[0].first, "feeds");
    EXPECT_EQ(words[1], std::pair(std::string("lines"), std::string("Finds")));
    EXPECT_EQ(Completion::wordsAfter(sampleProgram(), {"feeds"}).size(), 2U);
}

TEST(Completion, QuotesSurviveInAShell) {
    EXPECT_EQ(Completion::quoted("It's"), "'It'\\''s'");
}

TEST(Completion, EveryShellAsksTheProgramForThisMachinesNames) {
    for (const auto& shell : Completion::shells())
        EXPECT_THAT(Completion::script(sampleProgram(), shell), HasSubstr("feeds")) << shell;
    EXPECT_THAT(Completion::script(sampleProgram(), "bash"), HasSubstr("*) _orvo_words feeds ;;"));
    EXPECT_THAT(Completion::script(sampleProgram(), "fish"),
                HasSubstr("'__orvo_from 0 feeds check' -f -a '(__orvo_words feeds)'"));
    EXPECT_THAT(Completion::script(sampleProgram(), "zsh"), HasSubstr("'*:NAME:->feeds'"));
}

TEST(Completion, BracketsAndColonsOfTheHelpAreNoSyntaxForZsh) {
    EXPECT_THAT(Completion::script(sampleProgram(), "zsh"),
                HasSubstr("'--file[a \\[file\\]\\: any]:PATH:_files'"));
}

} // namespace
} // namespace orvo
