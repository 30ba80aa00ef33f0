#include "CommandTest.h"
#include "platform/foundation/NSDate.h"

namespace orvo {
namespace {

class ProgramTest : public testing::CommandTest {};

TEST_F(ProgramTest, WithoutACommandItIsWronglyUsed) {
    EXPECT_NE(refused({}, ExitCode::WrongUsage).find("orvo --help"), std::string::npos);
    EXPECT_NE(refused({"feeds"}, ExitCode::WrongUsage).find("orvo feeds --help"),
              std::string::npos);
}

TEST_F(ProgramTest, AnUnknownOptionIsNamedThoughNoCommandIsGiven) {
    EXPECT_EQ(refused({"--nosuch"}, ExitCode::WrongUsage),
              "orvo: there is no option --nosuch\nSee: orvo --help\n");
    EXPECT_EQ(refused({"feeds", "-x"}, ExitCode::WrongUsage),
              "orvo: there is no option -x\nSee: orvo feeds --help\n");
    EXPECT_EQ(refused({"--demo"}, ExitCode::WrongUsage),
              "orvo: which command?\nSee: orvo --help\n");
}

TEST_F(ProgramTest, HelpAndVersionAreAnswers) {
    EXPECT_NE(answered({"--help"}).find("favorites add"), std::string::npos);
    EXPECT_EQ(answered({"--version"}), "orvo " ORVO_VERSION "\n");
    EXPECT_EQ(answered({"feeds", "add", "--help"}).rfind("Usage: orvo feeds add NAME", 0), 0U);
}

TEST_F(ProgramTest, EveryCommandHasAnExampleAndASummaryWithoutAFullStop) {
    std::ostringstream ignored;
    const Program program(Terminal(ignored, ignored, {}));
    for (const auto& command : program.spec().commands) {
        EXPECT_FALSE(command.examples.empty()) << command.name();
        EXPECT_NE(command.summary.back(), '.') << command.name();
        for (const auto& example : command.examples)
            EXPECT_EQ(example.command.rfind("orvo ", 0), 0U) << example.command;
    }
}

TEST_F(ProgramTest, ASlipNamesWhatWasMeant) {
    EXPECT_EQ(refused({"incidnets"}, ExitCode::WrongUsage),
              "orvo: there is no command orvo incidnets\nDid you mean orvo incidents?\n");
    EXPECT_EQ(refused({"feeds", "xyzzy"}, ExitCode::WrongUsage),
              "orvo: there is no command orvo feeds xyzzy\nSee: orvo feeds --help\n");
}

TEST_F(ProgramTest, AtStopsTheClockAndKeepsWritesInMemoryWhileItRuns) {
    EXPECT_NE(answered({"--at", "2024-07-24T01:28:40Z", "incidents", "--json"})
                  .find("\"at\": \"2024-07-24T01:28:40Z\""),
              std::string::npos);
    EXPECT_EQ(NSDate::date()->timeIntervalSince1970(), Now);
    EXPECT_FALSE(Environment::keepsWritesInMemory().get());
}

TEST_F(ProgramTest, AtIsRefusedByWhateverWouldWrite) {
    const std::vector<std::vector<std::string>> commands = {
        {"feeds", "add", "city", "--static", writeSchedule(), "--alerts", writeAlerts({})},
        {"feeds", "update"},
        {"feeds", "remove", "city"},
        {"favorites", "add", "M1"},
        {"favorites", "move", "M1", "1"},
        {"favorites", "remove", "M1"},
        {"settings", "step-free", "on"},
        {"defaults", "write", "k", "v"},
        {"defaults", "delete", "k"},
        {"demo"}};
    for (auto words : commands) {
        words.insert(words.end(), {"--at", "2024-07-24T01:28:40Z"});
        const auto error = refused(words, ExitCode::WrongUsage);
        EXPECT_NE(error.find("--at writes nothing"), std::string::npos) << words[0] << error;
    }
    EXPECT_EQ(answered({"feeds", "list"}), "");
    EXPECT_EQ(answered({"settings", "--at", "2024-07-24T01:28:40Z"}), "step-free\toff\n");
}

TEST_F(ProgramTest, ALanguageThatIsNoneIsWrongUsage) {
    for (const char* tag : {"%%", "", "d", "de-", "de--AT", "de AT", "overlong-x-123456789"})
        EXPECT_NE(refused({"settings", std::string("--language=") + tag}, ExitCode::WrongUsage)
                      .find("--language: \"" + std::string(tag) + "\" is no language"),
                  std::string::npos);
}

TEST_F(ProgramTest, HelpExplainsTheProgramAGroupOrACommand) {
    EXPECT_EQ(answered({"help"}), answered({"--help"}));
    EXPECT_EQ(answered({"help", "feeds"}), answered({"feeds", "--help"}));
    EXPECT_EQ(answered({"help", "feeds", "add"}), answered({"feeds", "add", "--help"}));
    EXPECT_EQ(refused({"help", "feeds", "lst"}, ExitCode::WrongUsage),
              "orvo: there is no command orvo feeds lst\nDid you mean orvo feeds list?\n");
    EXPECT_EQ(refused({"help", "lines", "x"}, ExitCode::WrongUsage),
              "orvo: there is no command orvo lines x\nSee: orvo lines --help\n");
}

TEST_F(ProgramTest, APortOfTheDemonstrationBelongsToItsServer) {
    EXPECT_EQ(answered({"demo", "--help"}).rfind("Usage: orvo demo [--serve [PORT]]\n", 0), 0U);
}

TEST_F(ProgramTest, ATimeThatIsNoneIsWrongUsage) {
    EXPECT_NE(refused({"incidents", "--at", "noon"}, ExitCode::WrongUsage).find("2024-07-24T01"),
              std::string::npos);
}

TEST_F(ProgramTest, TheValueOfAnEarlyOptionIsNoCommand) {
    EXPECT_NE(answered({"--language", "de", "settings"}).find("step-free"), std::string::npos);
    EXPECT_EQ(Text::locale().get(), "en");
}

} // namespace
} // namespace orvo
