#include "platform/feeds/schedule/LineSearch.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

ScheduleLine line(const std::string& routeId,
                  const std::string& shortName,
                  const std::string& longName,
                  const std::string& agency = "City Lines") {
    ScheduleLine line;
    line.routeId = routeId;
    line.shortName = shortName;
    line.longName = longName;
    line.agency.name = agency;
    return line;
}

std::vector<std::string> routesOf(const std::vector<ScheduleLine>& lines) {
    std::vector<std::string> routes;
    for (const auto& line : lines)
        routes.push_back(line.routeId);
    return routes;
}

std::vector<std::string>
find(std::vector<ScheduleLine> lines, const std::string& text, std::size_t limit = 100) {
    return routesOf(LineSearch("en").best(std::move(lines), text, limit));
}

TEST(LineSearch, OrdersByHowWellALineSuits) {
    const std::vector<ScheduleLine> lines = {line("any", "9", "Northern"),
                                             line("agency", "8", "Ring", "Ernesto Buses"),
                                             line("long", "7", "Gare - Ern street"),
                                             line("begins", "ERN2", "Ring"),
                                             line("whole", "5", "Ern"),
                                             line("same", "ern", "Ring"),
                                             line("none", "6", "Ring")};
    EXPECT_THAT(find(lines, "Ern"),
                ElementsAre("same", "whole", "begins", "long", "agency", "any"));
    EXPECT_THAT(find(lines, "Ern", 2), ElementsAre("same", "whole"));
}

TEST(LineSearch, EquallyGoodLinesKeepTheirOrder) {
    EXPECT_THAT(find({line("b", "10", ""), line("a", "11", ""), line("c", "1", "")}, "1"),
                ElementsAre("c", "b", "a"));
}

TEST(LineSearch, CaseAndAccentsDoNotCount) {
    const std::vector<ScheduleLine> lines = {line("a", "1", "Hôpital Línea Straße")};
    for (const char* text :
         {"hopital", "HÔPITAL", "linea", "strasse", "STRAßE", "Hopi", "ho\u0302pital"})
        EXPECT_THAT(find(lines, text), ElementsAre("a")) << text;
    EXPECT_THAT(find(lines, "hupital"), IsEmpty());
}

TEST(LineSearch, TheLocaleSaysWhichLettersAreTheSame) {
    const std::vector<ScheduleLine> lines = {line("a", "1", "Åkeshov")};
    EXPECT_THAT(routesOf(LineSearch("en").best(lines, "akes", 9)), ElementsAre("a"));
    EXPECT_THAT(routesOf(LineSearch("sv").best(lines, "akes", 9)), IsEmpty());
}

TEST(LineSearch, EachWordMustStandSomewhere) {
    const std::vector<ScheduleLine> lines = {line("a", "10", "Gare - Mairie", "River Boats"),
                                             line("b", "10", "Port - Mairie", "City Lines")};
    EXPECT_THAT(find(lines, "mairie gare"), ElementsAre("a"));
    EXPECT_THAT(find(lines, "10 city"), ElementsAre("b"));
    EXPECT_THAT(find(lines, "10 gare city"), IsEmpty());
}

TEST(LineSearch, FindsInsideWordsOfLanguagesWithoutBlanks) {
    EXPECT_THAT(find({line("a", "", "東京山手線")}, "山手"), ElementsAre("a"));
}

TEST(LineSearch, TheShorterOfTwoNamesThatBeginAlikeIsMeant) {
    const std::vector<ScheduleLine> lines = {line("shuttle", "Red Line Shuttle", "Alewife - Davis"),
                                             line("red", "", "Red Line"),
                                             line("x", "9", "Red Line")};
    EXPECT_THAT(find(lines, "red"), ElementsAre("red", "x", "shuttle"));
}

TEST(LineSearch, ATextWithoutWordsFindsNothing) {
    const std::vector<ScheduleLine> lines = {line("a", "1", "-")};
    for (const char* text : {"", " ", "-", "?!"})
        EXPECT_THAT(find(lines, text), IsEmpty()) << text;
}

TEST(LineSearch, NamedIsTheWholeShortOrLongName) {
    const std::vector<ScheduleLine> lines = {line("a", "1", "Red Line"),
                                             line("b", "Red", "Gare"),
                                             line("c", "11", "RED LINE"),
                                             line("d", "-", "Ring")};
    LineSearch search("en");
    EXPECT_THAT(routesOf(search.named(lines, "red line")), ElementsAre("a", "c"));
    EXPECT_THAT(routesOf(search.named(lines, "réd")), ElementsAre("b"));
    EXPECT_THAT(routesOf(search.named(lines, "1")), ElementsAre("a"));
    EXPECT_THAT(routesOf(search.named(lines, "-")), ElementsAre("d"));
    EXPECT_THAT(routesOf(search.named(lines, "")), IsEmpty());
}

std::vector<std::string>
near(std::vector<ScheduleLine> lines, const std::string& text, std::size_t limit = 100) {
    return routesOf(LineSearch("en").near(std::move(lines), text, limit));
}

TEST(LineSearch, NearIsAMisspeltWordOfAName) {
    const std::vector<ScheduleLine> lines = {line("a", "1", "Airport – Old Harbour"),
                                             line("b", "2", "Gare - Mairie"),
                                             line("c", "Harbour", "")};
    for (const char* text : {"harbor", "HARBUOR", "hárbourr", "arbour", "harbaur"})
        EXPECT_THAT(near(lines, text), ElementsAre("c", "a")) << text;
    EXPECT_THAT(near(lines, "old harbor"), ElementsAre("a"));
    EXPECT_THAT(near(lines, "harbor 1"), ElementsAre("a"));
    EXPECT_THAT(near(lines, "harbor 2"), IsEmpty());
}

TEST(LineSearch, NearerLinesComeFirstThenShorterNames) {
    const std::vector<ScheduleLine> lines = {line("two", "1", "Mountaineer"),
                                             line("long", "2", "Mountainear to the lake"),
                                             line("short", "3", "Mountainear"),
                                             line("also", "4", "Mountainear")};
    EXPECT_THAT(near(lines, "mountinear"), ElementsAre("short", "also", "long", "two"));
    EXPECT_THAT(near(lines, "mountinear", 2), ElementsAre("short", "also"));
}

TEST(LineSearch, NearAllowsMoreSlipsInLongerWords) {
    const auto isNear = [](const std::string& name, const std::string& text) {
        return !near({line("a", "", name)}, text).empty();
    };
    EXPECT_TRUE(isNear("Quay", "Quai"));
    EXPECT_FALSE(isNear("Red", "Bed"));
    EXPECT_FALSE(isNear("East", "West"));
    EXPECT_FALSE(isNear("Harbour", "Habor"));
    EXPECT_TRUE(isNear("Waterfront", "Wtarfront"));
    EXPECT_FALSE(isNear("Waterfront", "Wtarfrnot"));
    EXPECT_TRUE(isNear("Metropolitan Line", "Matropolitn lina"));
    EXPECT_FALSE(isNear(std::string(41, 'a'), std::string(40, 'a') + 'b'));
}

TEST(LineSearch, AnotherNumberIsAnotherLineAndNotNear) {
    EXPECT_THAT(
        near({line("a", "2041", ""), line("b", "SX41", ""), line("c", "Night", "")}, "2042"),
        IsEmpty());
    EXPECT_THAT(near({line("a", "N4321", "")}, "4321"), IsEmpty());
    EXPECT_THAT(near({line("a", "43210", "")}, "4321"), IsEmpty());
    EXPECT_THAT(near({line("a", "12", "Harbour"), line("b", "1", "Harbour")}, "harbor 1"),
                ElementsAre("b"));
    EXPECT_THAT(near({line("a", "Tram", "")}, "Tram4"), IsEmpty());
    EXPECT_THAT(near({line("a", "٢٠٤١", "")}, "٢٠٤٢"), IsEmpty());
}

TEST(LineSearch, AnAgencyIsSpeltRightOrNotMeant) {
    const std::vector<ScheduleLine> lines = {line("a", "1", "Harbour", "River Boats"),
                                             line("b", "2", "Harbour", "City Lines")};
    EXPECT_THAT(near(lines, "river harbor"), ElementsAre("a"));
    EXPECT_THAT(near(lines, "rivar"), IsEmpty());
}

TEST(LineSearch, NothingIsNearToATextWithoutWordsOrWithVeryMany) {
    const std::vector<ScheduleLine> lines = {line("a", "", "Harbour a b c d e f g h")};
    for (const char* text : {"", " ", "?!"})
        EXPECT_THAT(near(lines, text), IsEmpty()) << text;
    EXPECT_THAT(near(lines, "harbor a b c d e f g"), ElementsAre("a"));
    EXPECT_THAT(near(lines, "harbor a b c d e f g h"), IsEmpty());
}

} // namespace
} // namespace orvo
