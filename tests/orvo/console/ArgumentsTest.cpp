#include "orvo/console/Arguments.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

CommandSpec sampleCommand() {
    return {.path = {"feeds", "add"},
            .summary = "Adds a feed",
            .description = "",
            .operands = {{.name = "NAME", .help = ""}},
            .options = {{.name = "static", .value = "PATH", .help = ""},
                        {.name = "alerts", .value = "PATH", .help = "", .takesSeveral = true},
                        {.name = "json", .value = "", .help = ""},
                        {.name = "mode",
                         .value = "MODE",
                         .help = "",
                         .completes = Completes::Word,
                         .words = {"on", "off"}}},
            .examples = {}};
}

Arguments parsed(const std::vector<std::string>& words) {
    const auto command = sampleCommand();
    auto result = ArgumentParser(command).parse(words);
    if (const auto* error = std::get_if<UsageError>(&result)) {
        ADD_FAILURE() << error->message;
        return {};
    }
    return std::get<Arguments>(result);
}

UsageError refused(const std::vector<std::string>& words) {
    const auto command = sampleCommand();
    auto result = ArgumentParser(command).parse(words);
    if (const auto* error = std::get_if<UsageError>(&result))
        return *error;
    ADD_FAILURE() << "was accepted";
    return {};
}

TEST(ArgumentParser, ReadsOptionsBeforeBetweenAndAfterOperands) {
    for (const auto& words :
         std::vector<std::vector<std::string>>{{"--json", "--static", "a.zip", "city"},
                                               {"--static", "a.zip", "city", "--json"},
                                               {"city", "--json", "--static=a.zip"}}) {
        const auto arguments = parsed(words);
        EXPECT_EQ(arguments.operands(), std::vector<std::string>{"city"});
        EXPECT_EQ(arguments.value("static"), "a.zip");
        EXPECT_TRUE(arguments.has("json"));
        EXPECT_FALSE(arguments.has("alerts"));
    }
}

TEST(ArgumentParser, AnOptionForSeveralTakesAllWordsUpToTheNextOption) {
    const auto arguments = parsed({"city", "--alerts", "a", "b", "--static", "s", "--alerts", "c"});
    EXPECT_EQ(arguments.values("alerts"), (std::vector<std::string>{"a", "b", "c"}));
    EXPECT_EQ(arguments.value("alerts"), "c");
    EXPECT_EQ(arguments.operands(), std::vector<std::string>{"city"});
}

TEST(ArgumentParser, AValueMayBeEmptyOrBeginWithADashAfterTheEqualsSign) {
    EXPECT_EQ(parsed({"city", "--static="}).value("static"), "");
    EXPECT_EQ(parsed({"city", "--static=-x=y"}).value("static"), "-x=y");
    EXPECT_EQ(refused({"city", "--static", "-x"}).message, "--static needs a value");
    EXPECT_EQ(refused({"city", "--static"}).cure, "Write --static PATH.");
}

TEST(ArgumentParser, TwoDashesEndTheOptions) {
    EXPECT_EQ(parsed({"--", "--json"}).operands(), std::vector<std::string>{"--json"});
}

TEST(ArgumentParser, ASingleDashIsAnOperand) {
    EXPECT_EQ(parsed({"-"}).operands(), std::vector<std::string>{"-"});
}

TEST(ArgumentParser, TakesGlobalOptionsEverywhere) {
    const auto arguments = parsed({"--demo", "city", "--at", "2024-07-24T01:28:40Z"});
    EXPECT_TRUE(arguments.has("demo"));
    EXPECT_EQ(arguments.value("at"), "2024-07-24T01:28:40Z");
}

TEST(ArgumentParser, AnOptionMayBeShortenedWhileItIsClear) {
    EXPECT_EQ(parsed({"city", "--stat", "x"}).value("static"), "x");
    const auto error = refused({"city", "--a", "x"});
    EXPECT_EQ(error.message, "--a may mean several options");
    EXPECT_EQ(error.cure, "Choose one of --alerts, --at.");
}

TEST(ArgumentParser, NamesWhatWasProbablyMeant) {
    const auto error = refused({"city", "--sttaic", "x"});
    EXPECT_EQ(error.message, "there is no option --sttaic");
    EXPECT_EQ(error.cure, "Did you mean --static?");
    EXPECT_EQ(refused({"city", "--zzzzzz"}).cure, "See: orvo feeds add --help");
    EXPECT_EQ(refused({"city", "-j"}).message, "there is no option -j");
}

TEST(ArgumentParser, RefusesWhatIsMissingOrTooMuch) {
    EXPECT_EQ(refused({}).message, "NAME is missing");
    EXPECT_EQ(refused({}).cure, "Usage: orvo feeds add NAME [OPTION]…");
    EXPECT_EQ(refused({"city", "town"}).message, "\"town\" is one word too many");
    EXPECT_EQ(refused({"city", "--json=1"}).message, "--json takes no value");
    EXPECT_EQ(refused({"city", "--static", "a", "--static", "b"}).message,
              "--static is given twice");
}

TEST(ArgumentParser, AProgramOfOneCommandIsCalledByItsOwnName) {
    const CommandSpec command{.path = {},
                              .summary = "Shows rows",
                              .description = "",
                              .options = {{.name = "follow", .value = "", .help = ""}}};
    const ArgumentParser parser(command, "rows");
    EXPECT_EQ(std::get<UsageError>(parser.parse({"--zzzzzz"})).cure, "See: rows --help");
    EXPECT_EQ(std::get<UsageError>(parser.parse({"word"})).cure, "Usage: rows [OPTION]…");
}

TEST(ArgumentParser, AcceptsOnlyThePermittedWords) {
    EXPECT_EQ(parsed({"city", "--mode", "on"}).value("mode"), "on");
    EXPECT_EQ(refused({"city", "--mode", "maybe"}).cure, "Choose one of on, off.");
}

TEST(ArgumentParser, ASuggestionLeavesOtherWordsPermitted) {
    const CommandSpec command{.path = {"x"},
                              .summary = "",
                              .description = "",
                              .operands = {{.name = "KEY",
                                            .help = "",
                                            .completes = Completes::Suggestion,
                                            .words = {"one", "two"}}}};
    EXPECT_TRUE(std::holds_alternative<Arguments>(ArgumentParser(command).parse({"three"})));
    EXPECT_EQ(command.usage(), "x KEY");
}

TEST(ArgumentParser, HelpNeedsNoOperands) {
    EXPECT_TRUE(parsed({"--help"}).has("help"));
    EXPECT_TRUE(parsed({"-h"}).has("help"));
}

TEST(ArgumentParser, OptionalAndRepeatedOperandsAreCounted) {
    CommandSpec command;
    command.path = {"x"};
    command.operands = {{.name = "A", .help = ""},
                        {.name = "B", .help = "", .count = OperandSpec::Count::OneOrMore}};
    EXPECT_TRUE(std::holds_alternative<UsageError>(ArgumentParser(command).parse({"a"})));
    EXPECT_TRUE(std::holds_alternative<Arguments>(ArgumentParser(command).parse({"a", "b", "c"})));
    command.operands[1].count = OperandSpec::Count::Optional;
    EXPECT_TRUE(std::holds_alternative<Arguments>(ArgumentParser(command).parse({"a"})));
    EXPECT_TRUE(std::holds_alternative<UsageError>(ArgumentParser(command).parse({"a", "b", "c"})));
}

TEST(ArgumentParser, ARequiredOptionIsAskedForAndShown) {
    CommandSpec command;
    command.path = {"x"};
    command.options = {{.name = "to", .value = "PLACE", .help = "", .isRequired = true},
                       {.name = "by", .value = "TIME", .help = ""}};
    EXPECT_EQ(command.usage(), "x --to PLACE [OPTION]…");
    const auto answer = ArgumentParser(command).parse({"--by", "now"});
    ASSERT_TRUE(std::holds_alternative<UsageError>(answer));
    EXPECT_EQ(std::get<UsageError>(answer).message, "--to is missing");
    EXPECT_EQ(std::get<UsageError>(answer).cure, "Write --to PLACE.");
    EXPECT_TRUE(std::holds_alternative<Arguments>(ArgumentParser(command).parse({"--help"})));
}

TEST(Nearest, FindsASlipOfTheFingerAndNothingElse) {
    const std::vector<std::string> words = {"feeds", "favorites", "incidents"};
    EXPECT_EQ(nearest("feds", words), "feeds");
    EXPECT_EQ(nearest("incidnets", words), "incidents");
    EXPECT_EQ(nearest("jsno", {"json"}), "json");
    EXPECT_EQ(nearest("fav", words), "favorites");
    EXPECT_EQ(nearest("weather", words), std::nullopt);
    EXPECT_EQ(nearest("", words), std::nullopt);
    EXPECT_EQ(nearest("größe", {"grüße"}), "grüße"); // one letter, of two bytes
}

} // namespace
} // namespace orvo
