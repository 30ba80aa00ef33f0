#include "orvo/CommandTest.h"
#include "orvo/HandOffReceiver.h"
#include "orvo/HandOffService.h"
#include "orvo/HandOffStore.h"
#include "orvo/HandOffWindows.h"
#include "orvo/HandOffWorld.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

class HandOffCommandsTest : public testing::CommandTest {
protected:
    /// What the terminal is told of it.
    std::string told(const std::shared_ptr<NSData>& activity) const {
        std::ostringstream output;
        const Terminal terminal(output, output, {});
        CommandContext context(terminal);
        const auto error = HandOffReceiver::take(
            HandOff::ofActivity(activity), context, HandOffReceiver::Audience::Terminal);
        EXPECT_FALSE(error) << error->localizedDescription();
        return output.str();
    }

    EnvironmentSlot<std::shared_ptr<const CodingClassTable>>::Override classes =
        CodingClassTable::current().overrideWith(testing::storableClasses());
};

TEST_F(HandOffCommandsTest, ALineIsToldWithItsWholeIncidents) {
    const auto line =
        testing::lineWith({testing::feedIncident(1, "Works"), testing::feedIncident(2, "Fire")});
    // The times are those of Tokyo, where it is after midnight.
    EXPECT_EQ(told(testing::tapOnLine(line)),
              "U1 · Metro\n"
              "  Works\n"
              "  since Jun 15, 11:36 PM, until 1:06 AM\n"
              "  Lines: U1 and 1 more\n"
              "  Short.\n"
              "\n"
              "  First paragraph.\n"
              "\n"
              "  Second paragraph.\n"
              "  https://t.example/i\n"
              "\n"
              "  Fire\n"
              "  since Jun 15, 11:36 PM, until 1:06 AM\n"
              "  Lines: U1 and 1 more\n"
              "  Short.\n"
              "\n"
              "  First paragraph.\n"
              "\n"
              "  Second paragraph.\n"
              "  https://t.example/i\n");
}

TEST_F(HandOffCommandsTest, ALineWithoutIncidentsRunsWell) {
    EXPECT_EQ(told(testing::tapOnLine(testing::lineWith({}))), "U1 · Metro\n  Good service\n");
}

TEST_F(HandOffCommandsTest, AListOfIncidentsIsToldInShort) {
    EXPECT_EQ(told(testing::tapOnIncidents(
                  {testing::feedIncident(2, "Fire"), testing::feedIncident(1, "Works")})),
              "2 incidents\n"
              "\n"
              "  Fire\n"
              "  since Jun 15, 11:36 PM, until 1:06 AM\n"
              "  Short.\n"
              "  https://t.example/i\n"
              "\n"
              "  Works\n"
              "  since Jun 15, 11:36 PM, until 1:06 AM\n"
              "  Short.\n"
              "  https://t.example/i\n");
    EXPECT_THAT(told(testing::tapOnIncidents({testing::feedIncident(2, "Fire")})),
                HasSubstr("1 incident\n"));
}

TEST_F(HandOffCommandsTest, LinesOfTheSchedulesAreNamed) {
    addCity();
    const auto store = ScheduleStore::open(ScheduleStore::defaultPath(), nullptr);
    const auto lines = store->lines("city");
    ASSERT_GT(lines.size(), 1U);
    std::vector<std::shared_ptr<TransitAffectedEntityRecord>> entities;
    for (const std::size_t index : {0U, 1U, 0U})
        entities.push_back(
            TransitAffectedEntityRecord::initWithFields({.muid = lines[index].muid}));
    const auto incident = TransitIncidentRecord::initWithFields(
        {.muid = 1, .title = "Works", .affectedEntities = NSArray::arrayOf(entities)});
    EXPECT_THAT(told(testing::tapOnIncidents({incident})),
                HasSubstr("Lines: " + lines[0].name() + ", " + lines[1].name() + "\n"));
}

TEST_F(HandOffCommandsTest, TextsOfStrangersCannotDriveTheTerminal) {
    const auto incident = TransitIncidentRecord::initWithFields({.muid = 1,
                                                                 .title = "a\x1b[31mb",
                                                                 .summary = "c\rd",
                                                                 .fullDescription = "e\x9b\x07"
                                                                                    "f"});
    const auto text = told(testing::tapOnLine(testing::lineWith({incident})));
    EXPECT_THAT(text, Not(HasSubstr("\x1b")));
    EXPECT_THAT(text, Not(HasSubstr("\r")));
    EXPECT_THAT(text, Not(HasSubstr("\x07")));
}

TEST_F(HandOffCommandsTest, TheLastIsShownAgain) {
    const auto text = told(testing::tapOnLine(testing::lineWith({})));
    const auto shown = run({"show"});
    EXPECT_EQ(shown.output, text);
    EXPECT_THAT(shown.error, HasSubstr("less than a minute ago"));
    EXPECT_THAT(answered({"open", "orvo://?t=r"}), HasSubstr("No favourite lines yet"));
    EXPECT_THAT(answered({"show"}), HasSubstr("orvo favorites add"));
}

TEST_F(HandOffCommandsTest, NothingHandedOverIsSaidSo) {
    const auto shown = run({"show"});
    EXPECT_EQ(shown.code, ExitCode::Answered);
    EXPECT_EQ(shown.output, "");
    EXPECT_THAT(shown.error, HasSubstr("Nothing has been handed over yet"));
    EXPECT_THAT(shown.error, HasSubstr("orvo show --demo"));
    EXPECT_THAT(run({"show", "--demo"}).error, Not(HasSubstr("orvo show --demo")));
}

TEST_F(HandOffCommandsTest, WhatIsGoingOnIsToldBeforeWhatIsToCome) {
    const auto tomorrow = TransitIncidentRecord::initWithFields(
        {.muid = 1,
         .startDate = NSDate::dateWithTimeIntervalSince1970(Now + 86400),
         .title = "Strike"});
    const auto works = TransitIncidentRecord::initWithFields({.muid = 2, .title = "Works"});
    const auto text = told(testing::tapOnLine(testing::lineWith({tomorrow, works})));
    EXPECT_LT(text.find("Works"), text.find("Strike"));
}

TEST_F(HandOffCommandsTest, OpenTellsTheFavorites) {
    addCity();
    answered({"favorites", "add", "city:M1"});
    EXPECT_EQ(answered({"open", "orvo://?favorites=2&t=r&session=s"}),
              answered({"favorites", "list"}));
    EXPECT_EQ(answered({"open"}), answered({"favorites", "list"}));
}

TEST_F(HandOffCommandsTest, OpenTellsSlipsFromWhatThereIsNot) {
    EXPECT_THAT(refused({"open", "https://t.example"}, ExitCode::WrongUsage),
                HasSubstr("no URL of this application"));
    EXPECT_THAT(refused({"open", "orvo://?favorites=5"}, ExitCode::Failed),
                HasSubstr("no list of favourites"));
    EXPECT_FALSE(HandOffStore::last(nullptr));
}

TEST_F(HandOffCommandsTest, WhatWasKeptAndCannotBeReadIsAnError) {
    write("state/hand-off.plist", "junk");
    EXPECT_THAT(refused({"show"}), HasSubstr("hand-off.plist"));
}

TEST_F(HandOffCommandsTest, WithoutADisplayFavoritesAreNotEditedInAWindow) {
    const auto said = refused({"favorites", "edit"});
    EXPECT_THAT(said, HasSubstr("there is no display to show a window on"));
    EXPECT_THAT(said, HasSubstr("orvo favorites add"));
}

TEST_F(HandOffCommandsTest, NothingIsTakenAtAnotherMoment) {
    for (const auto& words : {std::vector<std::string>{"open", "orvo://?t=r"},
                              std::vector<std::string>{"receive", "ContinueUserActivity"},
                              std::vector<std::string>{"service"}}) {
        auto dated = words;
        dated.insert(dated.end(), {"--at", "2024-07-24T01:28:40Z"});
        EXPECT_THAT(refused(dated, ExitCode::WrongUsage), HasSubstr("--at writes nothing"));
    }
    EXPECT_FALSE(HandOffStore::last(nullptr));
}

/// Windows as text: what was shown, with the leave to come to the front.
class ShownAsText final : public HandOffWindows {
public:
    void show(const HandOff::Content& content,
              CommandContext&,
              const std::string& activationToken) override {
        const auto* line = std::get_if<HandOff::Line>(&content);
        shown += (line ? line->line->name().value_or("") : "favourites") + " of " +
                 Environment::profile().get().data.filename().string() + " " + activationToken +
                 "\n";
    }
    [[nodiscard]] bool isAnyOpen() const override { return !shown.empty(); }
    void setAllClosed(std::function<void()>) override {}

    std::string shown;
};

class HandOffServiceTest : public HandOffCommandsTest {
protected:
    std::ostringstream output;
    Terminal::Settings settings{.outputIsTerminal = true};
    int requests = 0;
    HandOffWindows* windows = nullptr;

    std::shared_ptr<NSError>
    ask(const std::function<std::shared_ptr<NSError>(HandOffService&)>& request) {
        const Terminal terminal(output, output, settings);
        HandOffService service(
            terminal, [this] { ++requests; }, windows);
        return request(service);
    }
};

TEST_F(HandOffServiceTest, TakesActivitiesAndURLs) {
    const auto bytes = testing::tapOnLine(testing::lineWith({}));
    EXPECT_FALSE(ask(
        [&](auto& service) { return service.activateAction("ContinueUserActivity", bytes, {}); }));
    EXPECT_THAT(output.str(), HasSubstr("U1 · Metro"));
    EXPECT_TRUE(HandOffStore::last(nullptr)->handOff.activity());
    EXPECT_FALSE(ask([](auto& service) {
        return service.openURLs({"orvo://?t=r", "orvo://?favorites=2&t=r"}, {});
    }));
    EXPECT_EQ(HandOffStore::last(nullptr)->handOff.url(), "orvo://?favorites=2&t=r");
    EXPECT_FALSE(ask([](auto& service) { return service.activate({}); }));
    EXPECT_EQ(requests, 3);
}

TEST_F(HandOffServiceTest, WhereNobodyLooksNothingIsPrinted) {
    settings.outputIsTerminal = false;
    EXPECT_FALSE(ask([](auto& service) { return service.openURLs({"orvo://?t=r"}, {}); }));
    EXPECT_EQ(output.str(), "");
    EXPECT_TRUE(HandOffStore::last(nullptr));
}

TEST_F(HandOffServiceTest, WhatIsTakenIsShownInAWindow) {
    ShownAsText shown;
    windows = &shown;
    const auto bytes = testing::tapOnLine(testing::lineWith({}));
    EXPECT_FALSE(ask([&](auto& service) {
        return service.activateAction("ContinueUserActivity", bytes, {.activationToken = "token"});
    }));
    EXPECT_FALSE(ask([](auto& service) { return service.activate({}); }));
    EXPECT_EQ(shown.shown, "U1 of data token\nfavourites of data \n");
    EXPECT_TRUE(ask([](auto& service) { return service.openURLs({"http://x"}, {}); }));
    EXPECT_EQ(shown.shown, "U1 of data token\nfavourites of data \n");
}

TEST_F(HandOffServiceTest, AProcessOfTheDemonstrationShowsThePersonsOwnLinesWhenAsked) {
    const auto demo = Environment::profile().overrideWith(ProfileFolders::demonstration());
    const auto standsStill = Environment::keepsWritesInMemory().overrideWith(true);
    ShownAsText shown;
    windows = &shown;
    EXPECT_FALSE(ask([](auto& service) { return service.activate({}); }));
    EXPECT_EQ(shown.shown, "favourites of group.com.zentu.Orvo \n");
}

TEST_F(HandOffServiceTest, WhatItCannotTakeIsAnErrorAndNotKept) {
    const auto refusal = [&](const std::string& action, const std::shared_ptr<NSData>& parameter) {
        const auto error =
            ask([&](auto& service) { return service.activateAction(action, parameter, {}); });
        return error ? error->localizedDescription() : "";
    };
    EXPECT_THAT(refusal("Other", NSData::dataWithString("")), HasSubstr("ContinueUserActivity"));
    EXPECT_THAT(refusal("ContinueUserActivity", nullptr), HasSubstr("parameter"));
    EXPECT_THAT(refusal("ContinueUserActivity", NSData::dataWithString("x")),
                HasSubstr("no activity"));
    EXPECT_TRUE(ask([](auto& service) { return service.openURLs({"http://x"}, {}); }));
    EXPECT_FALSE(HandOffStore::last(nullptr));
}

} // namespace
} // namespace orvo
