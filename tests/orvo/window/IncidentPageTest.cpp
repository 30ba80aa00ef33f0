#include "orvo/window/IncidentPage.h"

#include "orvo/window/WindowWorld.h"

namespace orvo {
namespace {

using IncidentPageTest = testing::WindowTest;

TEST_F(IncidentPageTest, ALineIsShownWithItsWholeIncidents) {
    const auto page =
        pageOfLine({testing::feedIncident(1, "Works"), testing::feedIncident(2, "Fire")});
    EXPECT_EQ(page.heading(), "U1 · Metro");
    // The times are those of Tokyo, where it is after midnight.
    EXPECT_EQ(page.shown(Now),
              "U1\n"
              "Metro\n"
              "\n"
              "Works\n"
              "Since Jun 15, 11:36 PM, until 1:06 AM\n"
              "[U1] and 1 more\n"
              "Short.\n"
              "First paragraph.\n"
              "Second paragraph.\n"
              "https://t.example/i\n"
              "\n"
              "Fire\n"
              "Since Jun 15, 11:36 PM, until 1:06 AM\n"
              "[U1] and 1 more\n"
              "Short.\n"
              "First paragraph.\n"
              "Second paragraph.\n"
              "https://t.example/i\n");
}

TEST_F(IncidentPageTest, ALineWithoutIncidentsRunsWell) {
    EXPECT_EQ(pageOfLine({}).shown(Now), "U1\nMetro\nGood service\n");
}

TEST_F(IncidentPageTest, WhatIsGoingOnStandsBeforeWhatIsToComeOrOverElseTheOrderStays) {
    IncidentPage page;
    page.incidents = {{.title = "Strike tomorrow", .start = Now + 1},
                      {.title = "Over", .end = Now},
                      {.title = "Works", .start = Now, .end = Now + 60},
                      {.title = "Unknown", .isUnknown = true}};
    page.putCurrentFirst(Now);
    std::vector<std::string> titles;
    for (const auto& incident : page.incidents)
        titles.push_back(incident.title);
    EXPECT_EQ(titles, (std::vector<std::string>{"Works", "Unknown", "Strike tomorrow", "Over"}));
}

TEST_F(IncidentPageTest, AListShowsItsIncidentsInFull) {
    const auto page = pageOfIncidents({testing::feedIncident(2, "Fire")});
    EXPECT_EQ(page.heading(), "1 incident");
    EXPECT_EQ(page.shown(Now),
              "1 incident\n"
              "\n"
              "Fire\n"
              "Since Jun 15, 11:36 PM, until 1:06 AM\n"
              "Short.\n"
              "First paragraph.\n"
              "Second paragraph.\n"
              "https://t.example/i\n");
}

TEST_F(IncidentPageTest, TheSchedulesNameTheLinesThatAreConcernedWithTheirShields) {
    importCity();
    const auto store = schedules();
    std::vector<std::shared_ptr<TransitAffectedEntityRecord>> entities;
    for (const char* route : {"M1", "T4", "M1", "nowhere"})
        entities.push_back(
            TransitAffectedEntityRecord::initWithFields({.muid = lineMuid("city", route)}));
    const auto page = pageOfIncidents(
        {TransitIncidentRecord::initWithFields(
            {.muid = 1, .title = "Works", .affectedEntities = NSArray::arrayOf(entities)})},
        store.get());
    ASSERT_EQ(page.incidents[0].lines.size(), 2U);
    EXPECT_EQ(page.incidents[0].lines[0].name, "M1");
    EXPECT_EQ(page.incidents[0].lines[1].shieldText(), "4");
    EXPECT_EQ(page.incidents[0].otherLines, 1U);
    EXPECT_EQ(page.shown(Now), "1 incident\n\nWorks\nUntil further notice\n[M1] [4] and 1 more\n");
}

TEST_F(IncidentPageTest, NamesAtMostTwelveLinesOfAnIncidentAndCountsTheRest) {
    importCity();
    const auto store = schedules();
    const auto lines = store->lines("city");
    ASSERT_GT(lines.size(), IncidentPage::MostNamedLines);
    std::vector<std::shared_ptr<TransitAffectedEntityRecord>> entities;
    for (const auto& line : lines)
        entities.push_back(TransitAffectedEntityRecord::initWithFields({.muid = line.muid}));
    const auto page = pageOfIncidents(
        {TransitIncidentRecord::initWithFields({.affectedEntities = NSArray::arrayOf(entities)})},
        store.get());
    EXPECT_EQ(page.incidents[0].lines.size(), IncidentPage::MostNamedLines);
    EXPECT_EQ(page.incidents[0].otherLines, lines.size() - IncidentPage::MostNamedLines);
}

TEST_F(IncidentPageTest, TheSummaryStandsBeforeADescriptionThatDoesNotBeginWithIt) {
    const auto textOf = [](const char* summary, const char* description) {
        return pageOfIncidents({TransitIncidentRecord::initWithFields(
                                   {.summary = summary, .fullDescription = description})})
            .incidents[0]
            .text;
    };
    EXPECT_EQ(textOf("Short.", "Long."), "Short.\n\nLong.");
    EXPECT_EQ(textOf("Short and\nbroken.", "Short\nand broken. Long."), "Short\nand broken. Long.");
    EXPECT_EQ(textOf("Short.", ""), "Short.");
}

TEST_F(IncidentPageTest, AnUnknownStatusHasNoPeriod) {
    const auto page = pageOfIncidents({FeedTransitIncident::initWithFields_details(
        {.title = "Status unknown"}, {.isUnknown = true})});
    EXPECT_TRUE(page.incidents[0].isUnknown);
    EXPECT_EQ(page.incidents[0].period(Now), "");
}

TEST_F(IncidentPageTest, TextsOfStrangersHoldNoControlCharacters) {
    const auto page = pageOfLine({TransitIncidentRecord::initWithFields(
        {.title = "a\x1b[31mb", .fullDescription = "c\rd\n\n\te\x07"})});
    EXPECT_EQ(page.incidents[0].title, "a [31mb");
    EXPECT_EQ(page.incidents[0].paragraphs(), (std::vector<std::string>{"c d", "e"}));
}

TEST_F(IncidentPageTest, OnlyLinksOfTheWebAreOpened) {
    const auto canOpen = [](const char* link) {
        return pageOfIncidents({FeedTransitIncident::initWithFields_details({}, {.link = link})})
            .incidents[0]
            .canOpenLink();
    };
    EXPECT_TRUE(canOpen("https://t.example"));
    EXPECT_TRUE(canOpen("http://t.example"));
    EXPECT_FALSE(canOpen("file:///etc/passwd"));
    EXPECT_FALSE(canOpen("javascript:alert(1)"));
}

} // namespace
} // namespace orvo
