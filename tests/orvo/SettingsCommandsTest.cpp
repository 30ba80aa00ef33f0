#include "CommandTest.h"
#include "platform/demo/DemoIncidents.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

class SettingsCommandsTest : public testing::CommandTest {};

TEST_F(SettingsCommandsTest, StepFreeIsOffUntilItIsTurnedOn) {
    EXPECT_EQ(answered({"settings"}), "step-free\toff\n");
    answered({"settings", "step-free", "on"});
    EXPECT_EQ(answered({"settings", "step-free"}), "on\n");
    answered({"settings", "step-free", "off"});
    EXPECT_EQ(answered({"settings", "--json"}), "{\n  \"step-free\": false\n}\n");
    refused({"settings", "step-free", "perhaps"}, ExitCode::WrongUsage);
    refused({"settings", "speed", "on"}, ExitCode::WrongUsage);
}

TEST_F(SettingsCommandsTest, StepFreeMakesLiftsCount) {
    addCity(DemoIncidents::around(Now));
    answered({"favorites", "add", "M1"});
    EXPECT_THAT(answered({"incidents"}), Not(HasSubstr("Lift out of order")));
    answered({"settings", "step-free", "on"});
    EXPECT_THAT(answered({"incidents"}), HasSubstr("Lift out of order"));
}

TEST_F(SettingsCommandsTest, DefaultsAreWrittenReadAndDeleted) {
    EXPECT_EQ(answered({"defaults", "read"}), "");
    answered({"defaults", "write", "b", "true"});
    answered({"defaults", "write", "a", "two words"});
    EXPECT_EQ(answered({"defaults", "read"}), "a\ttwo words\nb\ttrue\n");
    EXPECT_EQ(answered({"defaults", "read", "b"}), "true\n");
    EXPECT_EQ(answered({"defaults", "read", "--json"}),
              "{\n  \"a\": \"two words\",\n  \"b\": true\n}\n");
    answered({"defaults", "delete", "a"});
    EXPECT_THAT(refused({"defaults", "read", "a"}), HasSubstr("a is not set"));
    EXPECT_THAT(refused({"defaults", "delete", "a"}), HasSubstr("a is not set"));
}

TEST_F(SettingsCommandsTest, DamagedSettingsThatAreSetAsideAreToldOnce) {
    answered({"settings", "step-free", "on"});
    std::string name;
    for (const auto& entry : std::filesystem::directory_iterator(profile.path() / "data")) {
        if (entry.path().extension() == ".plist")
            name = entry.path().filename().string();
    }
    const auto path = write("data/" + name, "no property list");
    const auto error = refused({"settings"});
    EXPECT_THAT(error, HasSubstr(path + " is damaged (property list, byte 0: "));
    EXPECT_THAT(error, HasSubstr(") and was set aside as " + path + ".damaged-1\n"));
    EXPECT_THAT(error, HasSubstr("\nPut a good copy in its place, or choose anew with: orvo"));
    EXPECT_EQ(answered({"settings"}), "step-free\toff\n");
}

TEST_F(SettingsCommandsTest, SettingsThatCannotBeReadAreNotLikeNone) {
    addCity(DemoIncidents::around(Now));
    answered({"favorites", "add", "M1"});
    const auto path = profile.path() / "data" / "group.com.zentu.Orvo.plist";
    std::filesystem::create_symlink(path.filename(), path); // a loop, which root cannot read either
    const auto reason = path.string() + ": Too many levels of symbolic links\n";
    for (const auto& words : std::vector<std::vector<std::string>>{{"settings"},
                                                                   {"settings", "--json"},
                                                                   {"settings", "step-free"},
                                                                   {"settings", "step-free", "on"},
                                                                   {"defaults", "read"},
                                                                   {"defaults", "read", "k"},
                                                                   {"defaults", "write", "k", "v"},
                                                                   {"defaults", "delete", "k"}}) {
        const auto answer = run(words);
        EXPECT_EQ(answer.code, ExitCode::Failed) << words.back();
        EXPECT_EQ(answer.output, "");
        EXPECT_EQ(answer.error, "orvo: " + reason);
    }
    const auto answer = run({"incidents"});
    EXPECT_EQ(answer.code, ExitCode::Answered);
    EXPECT_THAT(answer.error,
                HasSubstr("orvo: warning: your settings count as never made: " + reason));
    EXPECT_TRUE(std::filesystem::is_symlink(path));
}

TEST_F(SettingsCommandsTest, DamagedSettingsThatStayAreToldToo) {
    const auto path = write("data/group.com.zentu.Orvo.plist", "no property list");
    const auto error = refused({"settings", "--at", "2024-07-24T01:28:40Z"});
    EXPECT_THAT(error, HasSubstr(path + " is damaged: property list, byte 0: "));
    EXPECT_TRUE(std::filesystem::exists(path));
}

TEST_F(SettingsCommandsTest, ValuesAreOfTheKindThatTheyLookLikeOrThatIsAsked) {
    const auto kept = [&](std::vector<std::string> words) {
        words.insert(words.begin(), {"defaults", "write", "k"});
        answered(words);
        const auto json = answered({"defaults", "read", "k", "--json"});
        return json.substr(9, json.size() - 12);
    };
    EXPECT_EQ(kept({"7"}), "7");
    EXPECT_EQ(kept({"0.5"}), "0.5");
    EXPECT_EQ(kept({"no"}), "false");
    EXPECT_EQ(kept({"7", "--type", "string"}), "\"7\"");
    EXPECT_EQ(kept({"7", "--type", "real"}), "7");
    refused({"defaults", "write", "k", "x", "--type", "bool"}, ExitCode::WrongUsage);
    refused({"defaults", "write", "k", "1.5", "--type", "integer"}, ExitCode::WrongUsage);
}

} // namespace
} // namespace orvo
