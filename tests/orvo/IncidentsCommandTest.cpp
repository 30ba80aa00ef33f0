#include "CommandTest.h"
#include "platform/demo/DemoIncidents.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

class IncidentsCommandTest : public testing::CommandTest {};

TEST_F(IncidentsCommandTest, WithoutFavouritesThereIsNothingToTell) {
    const auto answer = run({"incidents"});
    EXPECT_EQ(answer.code, ExitCode::Answered);
    EXPECT_EQ(answer.output, "");
    EXPECT_THAT(answer.error, HasSubstr("orvo favorites add"));
    EXPECT_EQ(answered({"incidents", "--json"}),
              "{\n  \"at\": \"2025-06-15T15:06:40Z\",\n  \"lines\": [],\n  \"error\": null\n}\n");
}

TEST_F(IncidentsCommandTest, LinesStandInTheFavouritesOrderWithCurrentBeforeComing) {
    addCity(DemoIncidents::around(Now));
    answered({"favorites", "add", "city:T7", "S1", "M1"});
    EXPECT_EQ(
        answered({"incidents"}),
        "7 · Marrow Bay Transit\n"
        "  Good service\n"
        "\n"
        "S1 · Harbour and Hills Railway\n"
        "  Fewer trains to the coast\n"
        "  After a medical emergency at Northgate every second train is left out.\n"
        "  since 2:26 PM, until 3:08 PM\n"
        "  Coming: Warning strike on the railway\n"
        "  Harbour and Hills Railway expects fewer trains and boats.\n"
        "  Jun 16, 11:06 AM – Jun 17, 11:06 AM\n"
        "\n"
        "M1 · Marrow Bay Transit\n"
        "  Delays on M1 and M2\n"
        "  Trains run up to 15 minutes late after a signal failure at Central Station. Change "
        "at Market Square for the tram to Old Harbour.\n"
        "  since 2:41 PM, until 6:06 PM\n");
}

TEST_F(IncidentsCommandTest, JsonHasEveryPeriodWithItsOwnTimes) {
    addCity(DemoIncidents::around(Now));
    answered({"favorites", "add", "city:B12"});
    const auto json = answered({"incidents", "--json"});
    EXPECT_THAT(json, HasSubstr("\"route_id\": \"B12\""));
    EXPECT_THAT(json,
                HasSubstr("\"start\": \"2025-06-15T14:06:40Z\",\n          \"end\": "
                          "\"2025-06-15T19:06:40Z\""));
    EXPECT_THAT(json,
                HasSubstr("\"start\": \"2025-06-16T13:06:40Z\",\n          \"end\": "
                          "\"2025-06-16T19:06:40Z\""));
    EXPECT_THAT(json,
                HasSubstr("\"severity\": \"INFO\",\n          \"effect\": \"STOP_MOVED\",\n  "
                          "        \"part\": true,\n          \"unknown\": false"));
}

TEST_F(IncidentsCommandTest, ComingPeriodsAreFainter) {
    addCity(DemoIncidents::around(Now));
    answered({"favorites", "add", "city:SKY"});
    const auto answer = run({"incidents"}, {.outputIsTerminal = true, .usesStyles = true});
    EXPECT_THAT(answer.output,
                HasSubstr("\x1b[2mComing: Cable car closed for inspection\x1b[0m\n"));
    EXPECT_THAT(answer.output, HasSubstr("\x1b[32mGood service\x1b[0m"));
}

TEST_F(IncidentsCommandTest, AFeedThatCannotBeReadIsUnknownAndNeverFine) {
    addCity();
    answered({"feeds", "add", "town", "--static", writeSchedule(), "--alerts", writeAlerts({})});
    answered({"feeds", "add", "gone", "--static", writeSchedule(), "--alerts", "nowhere.pb"});
    answered({"favorites", "add", "city:M1", "gone:M1"});
    const auto output = answered({"incidents"});
    EXPECT_THAT(output, HasSubstr("Good service"));
    EXPECT_THAT(output, HasSubstr("tatus unknown"));
    EXPECT_THAT(answered({"incidents", "--json"}), HasSubstr("\"unknown\": true"));
}

TEST_F(IncidentsCommandTest, WhatIsUnknownIsToldWithTheReasonAndTheCure) {
    addCity();
    answered({"feeds", "add", "gone", "--static", writeSchedule(), "--alerts", "/nowhere.pb"});
    answered({"favorites", "add", "city:M1", "gone:M1", "gone:T4"});
    const std::string told =
        "orvo: warning: the status of gone:M1, gone:T4 is unknown: The service alerts could not be "
        "read: /nowhere.pb: there is no such file\n"
        "See what its sources say with: orvo feeds check gone\n";
    EXPECT_EQ(run({"incidents"}).error, told);
    EXPECT_EQ(run({"incidents", "--json"}).error, told);
    EXPECT_THAT(run({"incidents", "--all"}).error, HasSubstr("the status of 13 lines of gone is"));
}

TEST_F(IncidentsCommandTest, TheCureOfALineThatLeftIsAnother) {
    addCity();
    answered({"feeds", "add", "gone", "--static", writeSchedule(), "--alerts", writeAlerts({})});
    answered({"favorites", "add", "city:M1", "gone:M1"});
    answered({"feeds", "remove", "gone"});
    write("schedule/routes.txt", "route_id,agency_id,route_short_name,route_type\nM2,mbt,M2,1\n");
    answered({"feeds", "update", "city"});
    const auto error = run({"incidents"}).error;
    EXPECT_THAT(error, HasSubstr("the status of city:M1 is unknown: "));
    EXPECT_THAT(error, HasSubstr("took its place with: orvo lines city\n"));
    EXPECT_THAT(error, HasSubstr("the status of gone:M1 is unknown: "));
    EXPECT_THAT(error, HasSubstr("Add its feed again with orvo feeds add, or remove it with: "));
}

TEST_F(IncidentsCommandTest, WhenNoFeedCanBeReadItFailsAndJsonSaysWhy) {
    addCity();
    answered({"favorites", "add", "M1"});
    write("alerts.pb", "");
    const auto answer = run({"incidents", "--json"});
    EXPECT_EQ(answer.code, ExitCode::Failed);
    EXPECT_THAT(answer.output, HasSubstr("\"lines\": [],\n  \"error\": {\n    \"domain\": \""));
    EXPECT_THAT(answer.output, HasSubstr("city"));
    EXPECT_THAT(answer.error, HasSubstr("orvo: "));
    EXPECT_THAT(answer.error, HasSubstr("\nSee what the sources say with: orvo feeds check\n"));
}

TEST_F(IncidentsCommandTest, WithFeedsButNoScheduleItSaysHowToGetThem) {
    EXPECT_THAT(run({"incidents", "--all"}).error, HasSubstr("There are no feeds yet."));
    addCity();
    answered({"favorites", "add", "city:M1"});
    std::filesystem::remove(ScheduleStore::defaultPath());
    EXPECT_THAT(run({"incidents", "--all"}).error,
                HasSubstr("No feed has a schedule yet. Get them with: orvo feeds update"));
    EXPECT_THAT(run({"incidents"}).error,
                HasSubstr("Get its schedule with: orvo feeds update city"));
}

TEST_F(IncidentsCommandTest, AllListsByFeedAndThenInTheSchedulesOrder) {
    answered({"feeds", "add", "town", "--static", writeSchedule(), "--alerts", writeAlerts({})});
    addCity(DemoIncidents::around(Now));
    const auto json = answered({"incidents", "--all", "--json"});
    EXPECT_LT(json.find("\"feed\": \"city\""), json.find("\"feed\": \"town\""));
    EXPECT_LT(json.find("\"route_id\": \"M1\""), json.find("\"route_id\": \"SKY\""));
    const auto text = answered({"incidents", "--all"});
    EXPECT_THAT(text, HasSubstr("other lines: good service\n"));
    EXPECT_THAT(text, Not(HasSubstr("Night bus")));
}

TEST_F(IncidentsCommandTest, TextsFollowTheLanguage) {
    addCity(DemoIncidents::around(Now));
    answered({"favorites", "add", "M1"});
    EXPECT_THAT(answered({"incidents", "--language", "de"}),
                HasSubstr("Verspätungen auf M1 und M2"));
}

TEST_F(IncidentsCommandTest, LongTextsFitTheTerminal) {
    addCity(DemoIncidents::around(Now));
    answered({"favorites", "add", "M1"});
    std::istringstream lines(run({"incidents"}, {.outputIsTerminal = true, .width = 40}).output);
    for (std::string line; std::getline(lines, line);)
        EXPECT_LE(line.size(), 42U) << line;
}

TEST_F(IncidentsCommandTest, MadeUpIncidentsNameTheLinesOwnFeed) {
    addCity();
    answered({"favorites", "add", "M1"});
    answered({"defaults", "write", "Orvo.TransitWidget.internal.injectFakeIncidents", "true"});
    const auto random = Environment::random().overrideWith([] { return 1U; });
    const auto json = answered({"incidents", "--json"});
    EXPECT_THAT(json, HasSubstr("\"feed\": \"city\""));
    EXPECT_THAT(json, HasSubstr("Something Bad™"));
}

} // namespace
} // namespace orvo
