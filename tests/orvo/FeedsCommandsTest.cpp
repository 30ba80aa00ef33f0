#include "CommandTest.h"
#include "platform/demo/DemoIncidents.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/sqlite/SQLiteDatabase.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;

class FeedsCommandsTest : public testing::CommandTest {};

TEST_F(FeedsCommandsTest, AddImportsTheScheduleAndReadsTheAlerts) {
    const auto answer =
        run({"feeds", "add", "city", "--static", writeSchedule(), "--alerts", writeAlerts({})});
    EXPECT_EQ(answer.code, ExitCode::Answered);
    EXPECT_EQ(answer.output, "Added city: 13 lines of 2 agencies\n");
    EXPECT_EQ(answer.error, "");
}

TEST_F(FeedsCommandsTest, UnreadableAlertsAreAWarningAndTheFeedIsAdded) {
    const auto alerts = write("alerts.pb", "<html>Sorry</html>");
    const auto answer =
        run({"feeds", "add", "city", "--static", writeSchedule(), "--alerts", alerts});
    EXPECT_EQ(answer.code, ExitCode::Answered);
    EXPECT_THAT(answer.error, HasSubstr("warning: the alerts " + alerts + " cannot be read now"));
    EXPECT_THAT(answer.error, HasSubstr("orvo feeds check city"));
    EXPECT_THAT(answered({"feeds", "list"}), HasSubstr("city\t13\t"));
}

TEST_F(FeedsCommandsTest, AlertsThatAreOfAnotherKindAreAWarning) {
    const std::string header("\x0A\x05\x0A\x03"
                             "2.0",
                             7);
    const std::string tripUpdate("\x12\x07\x0A\x01"
                                 "a"
                                 "\x1A\x02\x0A\x00",
                                 9);
    const auto addWith = [&](const std::string& bytes) {
        return run({"feeds",
                    "add",
                    "city",
                    "--replace",
                    "--static",
                    writeSchedule(),
                    "--alerts",
                    write("other.pb", bytes)});
    };
    const auto answer = addWith(header + tripUpdate + tripUpdate);
    EXPECT_EQ(answer.code, ExitCode::Answered);
    EXPECT_THAT(answer.error, HasSubstr("the alerts of city have 2 other entries and no alert\n"));
    EXPECT_THAT(answer.error, HasSubstr("trip updates"));
    EXPECT_EQ(addWith(header).error, "");
}

TEST_F(FeedsCommandsTest, AnUnreadableScheduleAddsNothing) {
    const auto notASchedule = write("x.zip", "not a zip");
    EXPECT_THAT(refused({"feeds", "add", "city", "--static", notASchedule, "--alerts", "a.pb"}),
                HasSubstr("x.zip"));
    EXPECT_EQ(answered({"feeds", "list"}), "");
}

TEST_F(FeedsCommandsTest, ANameIsTakenOnceUnlessItIsReplaced) {
    addCity();
    EXPECT_THAT(refused({"feeds", "add", "city", "--static", writeSchedule(), "--alerts", "a.pb"}),
                HasSubstr("--replace"));
    EXPECT_THAT(answered({"feeds",
                          "add",
                          "city",
                          "--replace",
                          "--static",
                          writeSchedule(),
                          "--alerts",
                          writeAlerts({})}),
                HasSubstr("Replaced city"));
}

TEST_F(FeedsCommandsTest, AddSaysWhatIsMissing) {
    const auto schedule = writeSchedule();
    const std::vector<std::string> whole = {
        "feeds", "add", "city", "--static", schedule, "--alerts", "a.pb"};
    const auto with = [&](std::initializer_list<std::string> more) {
        auto words = whole;
        words.insert(words.end(), more);
        return words;
    };
    EXPECT_THAT(refused({"feeds", "add", "city", "--alerts", "a"}, ExitCode::WrongUsage),
                HasSubstr("--static PATH|URL"));
    EXPECT_THAT(refused({"feeds", "add", "city", "--static", "a"}, ExitCode::WrongUsage),
                HasSubstr("--alerts PATH|URL"));
    EXPECT_THAT(refused(with({"--header", "no colon"}), ExitCode::WrongUsage),
                HasSubstr("--header NAME:VALUE"));
    EXPECT_THAT(refused(with({"--query", "=x"}), ExitCode::WrongUsage),
                HasSubstr("--query NAME=VALUE"));
    EXPECT_THAT(refused(with({"--user", "name"}), ExitCode::WrongUsage),
                HasSubstr("--user NAME:PASSWORD"));
    refused({"feeds", "add", "a:b", "--static", schedule, "--alerts", "a"}, ExitCode::WrongUsage);
}

TEST_F(FeedsCommandsTest, ListSaysHowLongAScheduleIsValid) {
    addCity();
    EXPECT_THAT(answered({"feeds", "list"}), HasSubstr("city\t13\tuntil 2026-06-15\tless than"));
    clock->advance(400 * 86400.0);
    EXPECT_THAT(answered({"feeds", "list"}), HasSubstr("ran out on 2026-06-15\t400 days ago"));
    const auto json = answered({"feeds", "list", "--json"});
    EXPECT_THAT(json, HasSubstr("\"run_out\": true"));
    EXPECT_THAT(json, HasSubstr("\"checked\": \"2025-06-15T15:06:40Z\""));
    EXPECT_THAT(json, HasSubstr("\"error\": null"));
}

TEST_F(FeedsCommandsTest, SchedulesThatCannotBeReadAreToldAndAreNotLikeNone) {
    addCity();
    const auto store = ScheduleStore::defaultPath();
    ASSERT_TRUE(SQLiteDatabase::open(store, SQLiteDatabase::Mode::Write, nullptr)
                    ->execute("DROP TABLE feed"));
    for (const auto& words : std::vector<std::vector<std::string>>{{"feeds", "list"},
                                                                   {"feeds", "check"},
                                                                   {"lines", "harbour"},
                                                                   {"incidents", "--all"},
                                                                   {"favorites", "add", "M1"},
                                                                   {"favorites", "add", "city:M1"}})
        EXPECT_THAT(refused(words), HasSubstr(store.string() + ": ")) << words.front();
    const auto json = run({"feeds", "list", "--json"});
    EXPECT_EQ(json.code, ExitCode::Failed);
    EXPECT_THAT(json.output, HasSubstr(store.string() + ": "));
    EXPECT_THAT(json.output, HasSubstr("\"lines\": null,\n      \"agencies\": null,"));
    EXPECT_THAT(json.output, HasSubstr("\"run_out\": null,"));
}

TEST_F(FeedsCommandsTest, AFeedWithoutAScheduleHasNoLinesInJson) {
    addCity();
    std::filesystem::remove(ScheduleStore::defaultPath());
    const auto json = answered({"feeds", "list", "--json"});
    EXPECT_THAT(json, HasSubstr("\"lines\": 0,\n      \"agencies\": 0,"));
    EXPECT_THAT(json, HasSubstr("\"run_out\": false,"));
    EXPECT_THAT(json, HasSubstr("\"imported\": null,"));
}

TEST_F(FeedsCommandsTest, AFeedWhoseScheduleCannotBeRemovedStays) {
    addCity();
    const auto store = ScheduleStore::defaultPath();
    ASSERT_TRUE(SQLiteDatabase::open(store, SQLiteDatabase::Mode::Write, nullptr)
                    ->execute("DROP TABLE line"));
    EXPECT_THAT(refused({"feeds", "remove", "city"}), HasSubstr(store.string() + ": "));
    EXPECT_THAT(answered({"feeds", "list"}), HasSubstr("city\t13\t"));
}

TEST_F(FeedsCommandsTest, AFeedWhoseNameMayBeTakenKeepsItsSchedule) {
    addCity();
    const auto registry = profile.path() / "data" / "feeds.plist";
    std::filesystem::rename(registry, registry.string() + ".away");
    std::filesystem::create_symlink("feeds.plist",
                                    registry); // a loop, which root cannot read either
    const auto other =
        write("other/routes.txt", "route_id,agency_id,route_short_name,route_type\nX,mbt,X,1\n");
    write("other/agency.txt",
          "agency_id,agency_name,agency_url,agency_timezone\nmbt,M,https://m.example,UTC\n");
    EXPECT_EQ(refused({"feeds",
                       "add",
                       "city",
                       "--static",
                       std::filesystem::path(other).parent_path().string(),
                       "--alerts",
                       "a.pb"}),
              "orvo: " + registry.string() + ": Too many levels of symbolic links\n");
    std::filesystem::rename(registry.string() + ".away", registry);
    EXPECT_THAT(answered({"feeds", "list"}), HasSubstr("city\t13\t"));
}

TEST_F(FeedsCommandsTest, UpdateSaysWhatCameAndWent) {
    addCity();
    write("schedule/routes.txt",
          "route_id,agency_id,route_short_name,route_type\nM1,mbt,M1,1\nNEW,mbt,N,3\n");
    EXPECT_EQ(answered({"feeds", "update"}), "city: 2 lines, 1 new, 12 gone\n");
}

TEST_F(FeedsCommandsTest, OneIsNoPlural) {
    writeSchedule();
    write("schedule/agency.txt",
          "agency_id,agency_name,agency_url,agency_timezone\nmbt,M,https://m.example,UTC\n");
    const auto* const routes = "route_id,agency_id,route_short_name,route_type\nM1,mbt,M1,1\n";
    const auto schedule = write("schedule/routes.txt", routes);
    EXPECT_EQ(answered({"feeds",
                        "add",
                        "city",
                        "--static",
                        std::filesystem::path(schedule).parent_path().string(),
                        "--alerts",
                        writeAlerts({})}),
              "Added city: 1 line of 1 agency\n");
    EXPECT_EQ(answered({"feeds", "update", "--force"}), "city: 1 line, 0 new, 0 gone\n");
}

TEST_F(FeedsCommandsTest, WhatAScheduleDoesNotSayIsNullInJson) {
    addCity();
    EXPECT_THAT(answered({"feeds", "list", "--json"}), HasSubstr("\"end_date\": \"2026-06-15\""));
    std::filesystem::remove(profile.path() / "schedule/feed_info.txt");
    std::filesystem::remove(profile.path() / "schedule/calendar.txt");
    answered({"feeds", "update", "--force"});
    EXPECT_THAT(answered({"feeds", "list", "--json"}),
                HasSubstr("\"version\": null,\n      \"start_date\": null,\n      "
                          "\"end_date\": null,\n"));
}

TEST_F(FeedsCommandsTest, AnUpdateThatFailsLeavesTheScheduleAndTheOtherFeedsGoOn) {
    addCity();
    answered({"feeds", "add", "town", "--static", writeSchedule(), "--alerts", writeAlerts({})});
    const auto kept = profile.path() / "kept";
    std::filesystem::rename(profile.path() / "schedule", kept);
    answered({"feeds", "add", "third", "--static", kept.string(), "--alerts", writeAlerts({})});
    const auto answer = run({"feeds", "update"});
    EXPECT_EQ(answer.code, ExitCode::Failed);
    EXPECT_THAT(answer.error, HasSubstr("orvo: city: "));
    EXPECT_THAT(answer.error, HasSubstr("orvo: town: "));
    EXPECT_EQ(answer.output, "third: 13 lines, 0 new, 0 gone\n");
    EXPECT_THAT(answered({"lines", "city"}), HasSubstr("city:M1"));
}

TEST_F(FeedsCommandsTest, CheckTellsWhatTheAlertsHold) {
    addCity(DemoIncidents::around(Now));
    const auto json = answered({"feeds", "check", "--json"});
    EXPECT_THAT(json, HasSubstr("\"lines\": 13"));
    EXPECT_THAT(json, HasSubstr("\"alerts\": 9"));
    EXPECT_THAT(json, HasSubstr("\"unknown_lines\": 0"));
    EXPECT_THAT(json, HasSubstr("\"header_time\": \"2025-06-15T15:06:40Z\""));
    EXPECT_THAT(answered({"feeds", "check", "city"}), HasSubstr("alerts: 9"));
}

TEST_F(FeedsCommandsTest, CheckFailsWhenASourceCannotBeRead) {
    addCity();
    write("alerts.pb", "");
    const auto answer = run({"feeds", "check", "--json"});
    EXPECT_EQ(answer.code, ExitCode::Failed);
    EXPECT_THAT(answer.output, HasSubstr("\"unknown_lines\": 13"));
    EXPECT_THAT(answer.error, HasSubstr("orvo: "));
}

TEST_F(FeedsCommandsTest, CheckNamesWhatTheScheduleDoesNotKnow) {
    auto incidents = DemoIncidents::around(Now);
    incidents.front().selectors.push_back({"nobody", "", ""});
    addCity(incidents);
    EXPECT_THAT(answered({"feeds", "check", "--json"}), HasSubstr("nobody"));
}

TEST_F(FeedsCommandsTest, UnknownFeedsAreNamed) {
    for (const char* command : {"update", "check", "remove"})
        EXPECT_THAT(refused({"feeds", command, "nowhere"}), HasSubstr("there is no feed nowhere"));
}

TEST_F(FeedsCommandsTest, AMisspeltFeedIsAnsweredWithTheOneThatIsNear) {
    addCity();
    for (const char* command : {"update", "check", "remove"}) {
        EXPECT_THAT(refused({"feeds", command, "ctiy"}),
                    HasSubstr("there is no feed ctiy; did you mean city?"));
        EXPECT_THAT(refused({"feeds", command, "village"}),
                    HasSubstr("there is no feed village; see: orvo feeds list"));
    }
}

TEST_F(FeedsCommandsTest, ADamagedRegistryIsNamedWithTheReasonAndTheCure) {
    addCity();
    answered({"favorites", "add", "M1"});
    write("data/feeds.plist", "no property list");
    for (const auto& words : std::vector<std::vector<std::string>>{
             {"feeds", "list"}, {"feeds", "check"}, {"feeds", "update"}, {"incidents"}}) {
        const auto error = refused(words);
        EXPECT_THAT(error, HasSubstr("data/feeds.plist is damaged: property list, byte 0: "));
        EXPECT_THAT(error, HasSubstr("\nPut a good copy in its place, or add your feeds anew"));
    }
}

TEST_F(FeedsCommandsTest, AddTellsOfADamagedRegistryThatItSetAside) {
    write("data/feeds.plist", "no property list");
    const auto answer =
        run({"feeds", "add", "city", "--static", writeSchedule(), "--alerts", writeAlerts({})});
    EXPECT_EQ(answer.code, ExitCode::Failed);
    EXPECT_EQ(answer.output, "Added city: 13 lines of 2 agencies\n");
    const auto path = (profile.path() / "data/feeds.plist").string();
    EXPECT_THAT(answer.error, HasSubstr(path + " is damaged (property list, byte 0: "));
    EXPECT_THAT(answer.error, HasSubstr(") and was set aside as " + path + ".damaged-1\n"));
    EXPECT_THAT(answer.error, HasSubstr("\nPut a good copy in its place, or add your feeds anew"));
    EXPECT_EQ(run({"feeds", "list"}).error, "");
}

TEST_F(FeedsCommandsTest, RemoveForgetsTheScheduleToo) {
    addCity();
    EXPECT_EQ(answered({"feeds", "remove", "city"}), "Removed city\n");
    EXPECT_EQ(answered({"feeds", "list"}), "");
    EXPECT_THAT(run({"lines", "M1"}).error, HasSubstr("There is no schedule yet. Add a feed with"));
}

TEST_F(FeedsCommandsTest, LinesWithoutAnyScheduleAreNoneInBothForms) {
    const auto text = run({"lines", "M1"});
    EXPECT_EQ(text.code, ExitCode::Answered);
    EXPECT_EQ(text.output, "");
    EXPECT_EQ(text.error,
              "There is no schedule yet. Add a feed with: orvo feeds add. For those that you have: "
              "orvo feeds update\n");
    const auto json = run({"lines", "M1", "--json"});
    EXPECT_EQ(json.code, ExitCode::Answered);
    EXPECT_EQ(json.output, "{\n  \"lines\": [],\n  \"total\": 0,\n  \"error\": null\n}\n");
    EXPECT_EQ(json.error, "");
    EXPECT_THAT(refused({"favorites", "add", "M1"}), HasSubstr("there is no schedule yet"));
}

TEST_F(FeedsCommandsTest, AMisspeltSearchNamesTheLinesThatAreNear) {
    addCity();
    const auto near = run({"lines", "Skylin", "Cabel", "Car"});
    EXPECT_EQ(near.code, ExitCode::Answered);
    EXPECT_EQ(near.output, "");
    EXPECT_EQ(near.error,
              "No line matches Skylin Cabel Car. Did you mean city:SKY (Skyline Cable Car)?\n");
    EXPECT_EQ(run({"lines", "zzzzz"}).error, "No line matches zzzzz.\n");
    EXPECT_EQ(run({"lines", "M9"}).error, "No line matches M9.\n");
    EXPECT_EQ(run({"lines", "Skylin Cabel Car", "--json"}).error, "");
}

TEST_F(FeedsCommandsTest, LinesThatCannotBeReadAreAFailureAndNotNone) {
    addCity();
    const auto path = ScheduleStore::defaultPath();
    ASSERT_TRUE(SQLiteDatabase::open(path, SQLiteDatabase::Mode::Write, nullptr)
                    ->execute("DROP TABLE line"));
    for (const auto& words : std::vector<std::vector<std::string>>{
             {"lines", "city"}, {"incidents", "--all"}, {"completion", "words", "lines"}})
        EXPECT_THAT(refused(words), HasSubstr(path.string())) << words[0];
}

TEST_F(FeedsCommandsTest, ALineWhoseNameBreaksTheLineIsNoWordForShells) {
    writeSchedule();
    write("schedule/routes.txt",
          "route_id,agency_id,route_short_name,route_type\n"
          "\"a\n$(b)\",mbt,1,0\nc,mbt,2,0\n");
    answered({"feeds",
              "add",
              "city",
              "--static",
              (profile.path() / "schedule").string(),
              "--alerts",
              writeAlerts({})});
    EXPECT_EQ(answered({"completion", "words", "lines"}), "city:c\n");
    answered({"favorites", "add", "1", "2"});
    EXPECT_EQ(answered({"completion", "words", "favorites"}), "city:c\n");
}

TEST_F(FeedsCommandsTest, LinesAreFoundAndListedByFeed) {
    addCity();
    EXPECT_EQ(answered({"lines", "airport"}),
              "city:X90\tX90\tAirport Express\tMarrow Bay Transit\tbus\n"
              "city:M1\tM1\tAirport – Old Harbour\tMarrow Bay Transit\tmetro\n");
    const auto all = answered({"lines", "city"});
    EXPECT_EQ(std::count(all.begin(), all.end(), '\n'), 13);
    EXPECT_EQ(all.rfind("city:M1\t", 0), 0U);
    EXPECT_EQ(answered({"lines", "zzz"}), "");
    EXPECT_THAT(answered({"lines", "funicular", "--json"}), HasSubstr("\"mode\": \"funicular\""));
}

class ManyLinesTest : public testing::CommandTest {
protected:
    void SetUp() override {
        writeSchedule();
        std::string routes = "route_id,agency_id,route_short_name,route_type\n";
        for (int i = 0; i < 1234; ++i)
            routes += "r" + std::to_string(i) + ",mbt,Tram " + std::to_string(i) + ",0\n";
        write("schedule/routes.txt", routes);
        answered({"feeds",
                  "add",
                  "city",
                  "--static",
                  (profile.path() / "schedule").string(),
                  "--alerts",
                  writeAlerts({})});
    }

    static std::int64_t rows(const std::string& text) {
        return std::count(text.begin(), text.end(), '\n');
    }
};

TEST_F(ManyLinesTest, AreCutAndSaidToBe) {
    const auto answer = run({"lines", "tram"});
    EXPECT_EQ(rows(answer.output), 200);
    EXPECT_EQ(answer.error, "200 of 1,234 lines. Narrow the search, or show all with --limit 0.\n");
    EXPECT_THAT(answered({"lines", "tram", "--json"}), HasSubstr("\"total\": 1234,"));
}

TEST_F(ManyLinesTest, AreShownAsManyAsAsked) {
    const auto all = run({"lines", "tram", "--limit", "0"});
    EXPECT_EQ(rows(all.output), 1234);
    EXPECT_EQ(all.error, "");
    const auto three = run({"lines", "tram", "--limit", "3"});
    EXPECT_EQ(rows(three.output), 3);
    EXPECT_THAT(three.error, HasSubstr("3 of 1,234 lines"));
    EXPECT_EQ(rows(run({"lines", "city"}).output), 1234);
    EXPECT_EQ(rows(run({"lines", "city", "--limit", "5"}).output), 5);
    for (const char* limit : {"few", "-1", "", "1.5"})
        EXPECT_THAT(
            refused({"lines", "tram", std::string("--limit=") + limit}, ExitCode::WrongUsage),
            HasSubstr("--limit"));
}

TEST_F(ManyLinesTest, ASearchForNothingIsWrongUsage) {
    for (const char* search : {"", " ", "\n"})
        EXPECT_THAT(refused({"lines", search}, ExitCode::WrongUsage), HasSubstr("SEARCH is empty"));
}

} // namespace
} // namespace orvo
