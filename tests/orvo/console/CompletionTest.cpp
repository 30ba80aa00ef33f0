#include "orvo/console/Completion.h"

#include "orvo/console/CompletionParts.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::StartsWith;

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

/// One whose help takes the words of the others.
ProgramSpec helpfulProgram() {
    auto program = sampleProgram();
    program.commands.push_back({.path = {"help"},
                                .summary = "Explains",
                                .description = "",
                                .operands = {{.name = "COMMAND",
                                              .help = "",
                                              .count = OperandSpec::Count::Any,
                                              .completes = Completes::Command}}});
    return program;
}

TEST(Completion, TheWordsOfACommandAreOfferedOneAfterTheOther) {
    EXPECT_THAT(
        Completion::script(helpfulProgram(), "bash"),
        HasSubstr(
            "        *) case \"${operands[*]}\" in\n"
            "            '') COMPREPLY=($(compgen -W 'feeds lines help' -- \"$current\")) ;;\n"
            "            'feeds') COMPREPLY=($(compgen -W 'check list' -- \"$current\")) ;;\n"
            "            esac ;;\n"));
    EXPECT_THAT(Completion::script(helpfulProgram(), "fish"),
                AllOf(HasSubstr("-n '__orvo_after 0 help' -a lines -d 'Finds'\n"),
                      HasSubstr("-n '__orvo_after 0 help feeds' -a list -d 'Lists'\n")));
    EXPECT_THAT(Completion::script(helpfulProgram(), "zsh"),
                AllOf(HasSubstr("'*:COMMAND:->commands'"), HasSubstr("$state == commands")));
}

TEST(Completion, NobodyAsksForCommandsWhereNoWordIsOne) {
    for (const auto& shell : Completion::shells())
        EXPECT_THAT(Completion::script(sampleProgram(), shell),
                    AllOf(Not(HasSubstr("operands[*]")),
                          Not(HasSubstr("== commands")),
                          Not(HasSubstr("after 0 lines"))))
            << shell;
}

TEST(Completion, SuggestionsAreOfferedAsWordsAre) {
    const ProgramSpec program{"p",
                              "",
                              {{.path = {"set"},
                                .summary = "",
                                .description = "",
                                .operands = {{.name = "KEY",
                                              .help = "",
                                              .completes = Completes::Suggestion,
                                              .words = {"a.b", "a.c"}}}}}};
    EXPECT_THAT(Completion::script(program, "bash"),
                HasSubstr("0) COMPREPLY=($(compgen -W 'a.b a.c' -- \"$current\")) ;;"));
    EXPECT_THAT(Completion::script(program, "zsh"), HasSubstr("':KEY:(a.b a.c)'"));
    EXPECT_THAT(Completion::script(program, "fish"), HasSubstr("set' -f -a 'a.b a.c'\n"));
}

TEST(Completion, BracketsAndColonsOfTheHelpAreNoSyntaxForZsh) {
    EXPECT_THAT(Completion::script(sampleProgram(), "zsh"),
                HasSubstr("'--file[a \\[file\\]\\: any]:PATH:_files'"));
}

TEST(Completion, BashTakesNamesOfFilesAsTheyAre) {
    EXPECT_THAT(Completion::script(sampleProgram(), "bash"),
                HasSubstr("--file) mapfile -t COMPREPLY < <(compgen -f -- \"$current\");"));
}

TEST(Completion, GroupsAreThePathsAboveAnyCommand) {
    using Paths = std::set<std::vector<std::string>>;
    EXPECT_EQ(Completion::groupsOf(sampleProgram()), (Paths{{}, {"feeds"}}));
    const ProgramSpec deep{"p", "", {{.path = {"a", "b", "c"}, .summary = "", .description = ""}}};
    EXPECT_EQ(Completion::groupsOf(deep), (Paths{{}, {"a"}, {"a", "b"}}));
}

/// A program that is one command.
ProgramSpec onlyCommand() {
    return {"some-program",
            "",
            {{.path = {},
              .summary = "Does it",
              .description = "",
              .options = {{.name = "form",
                           .value = "FORM",
                           .help = "how",
                           .completes = Completes::Word,
                           .words = {"text", "json"}},
                          {.name = "quick", .value = "", .help = "soon"}}}}};
}

TEST(Completion, AProgramThatIsOneCommandHasOptionsAndNoWordsBeforeThem) {
    EXPECT_THAT(Completion::groupsOf(onlyCommand()), IsEmpty());
    EXPECT_THAT(Completion::wordsAfter(onlyCommand(), {}), IsEmpty());
    EXPECT_THAT(
        Completion::script(onlyCommand(), "bash"),
        HasSubstr("--form) COMPREPLY=($(compgen -W 'text json' -- \"$current\")); return ;;"));
    EXPECT_THAT(Completion::script(onlyCommand(), "zsh"),
                HasSubstr("'--form[how]:FORM:(text json)'"));
    EXPECT_THAT(Completion::script(onlyCommand(), "fish"),
                HasSubstr("complete -c some-program -l form -d 'how' -r -f -a 'text json'\n"
                          "complete -c some-program -l quick -d 'soon' -f\n"));
}

TEST(Completion, SaysWhatItIsForAndWhatWroteIt) {
    EXPECT_THAT(Completion::script(sampleProgram(), "bash"),
                StartsWith("# bash completion for orvo, written by `orvo completion bash`\n"));
    EXPECT_THAT(
        Completion::script(onlyCommand(), "fish"),
        StartsWith(
            "# fish completion for some-program, written by `some-program --completion fish`\n"));
    EXPECT_THAT(Completion::script(onlyCommand(), "zsh"), StartsWith("#compdef some-program\n"));
}

TEST(Completion, ScriptsOfSeveralProgramsShareNoFunction) {
    for (const auto& shell : Completion::shells())
        EXPECT_THAT(Completion::script(onlyCommand(), shell), Not(HasSubstr("orvo"))) << shell;
    EXPECT_THAT(Completion::script(onlyCommand(), "bash"),
                HasSubstr("\ncomplete -F _some_program some-program\n"));
    EXPECT_THAT(Completion::script(onlyCommand(), "zsh"), HasSubstr("\n_some-program \"$@\"\n"));
}

} // namespace
} // namespace orvo
