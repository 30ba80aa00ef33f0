#include "platform/feeds/schedule/LineTranslator.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

ScheduleLine line() {
    ScheduleLine line;
    line.routeId = "R1";
    line.shortName = "1";
    line.longName = "Gare - Mairie";
    line.agency.id = "A1";
    line.agency.name = "Transports";
    return line;
}

ScheduleTranslation longName(const std::string& language, const std::string& text) {
    return {"routes", "route_long_name", language, "R1", "", text};
}

std::string translatedLongName(const std::vector<ScheduleTranslation>& translations,
                               const std::string& person,
                               const std::string& schedule = "fr") {
    ScheduleLine result = line();
    LineTranslator(translations, schedule, person).translate(result);
    return result.longName;
}

TEST(LanguageMatch, RanksTagThenScriptThenLanguage) {
    EXPECT_EQ(languageMatch("de-AT", "DE_at"), 3);
    EXPECT_EQ(languageMatch("zh-Hant-TW", "zh-HK"), 2);
    EXPECT_EQ(languageMatch("zh-Hant-TW", "zh-CN"), 1);
    EXPECT_EQ(languageMatch("de-AT", "de"), 2);
    EXPECT_EQ(languageMatch("de", "den"), 0);
    EXPECT_EQ(languageMatch("de", ""), 0);
    EXPECT_EQ(languageMatch("", "de"), 0);
}

TEST(LineTranslator, TakesTheBestLanguageOffered) {
    const std::vector<ScheduleTranslation> offered = {
        longName("zh-CN", "simplified"), longName("zh-HK", "hong kong"), longName("en", "english")};
    EXPECT_EQ(translatedLongName(offered, "zh-TW"), "hong kong");
    EXPECT_EQ(translatedLongName(offered, "zh-Hans"), "simplified");
    EXPECT_EQ(translatedLongName(offered, "en-GB"), "english");
    EXPECT_EQ(translatedLongName(offered, "nl"), "Gare - Mairie");
}

TEST(LineTranslator, KeepsTheSchedulesOwnNamesForItsOwnLanguage) {
    const std::vector<ScheduleTranslation> offered = {longName("fr-CA", "canadien")};
    EXPECT_EQ(translatedLongName(offered, "fr", "fr"), "Gare - Mairie");
    EXPECT_EQ(translatedLongName(offered, "fr-CA", "fr"), "canadien");
    EXPECT_EQ(translatedLongName(offered, "fr-CA", "fr-CA"), "Gare - Mairie");
}

TEST(LineTranslator, TranslatesByRecordBeforeByText) {
    std::vector<ScheduleTranslation> offered = {
        {"routes", "route_long_name", "en", "", "Gare - Mairie", "by text"}};
    EXPECT_EQ(translatedLongName(offered, "en"), "by text");
    offered.push_back(longName("en", "by record"));
    EXPECT_EQ(translatedLongName(offered, "en"), "by record");
    offered = {{"routes", "route_long_name", "en", "R2", "", "another line"}};
    EXPECT_EQ(translatedLongName(offered, "en"), "Gare - Mairie");
}

TEST(LineTranslator, TranslatesShortNamesAndAgenciesButInventsNone) {
    const LineTranslator translator({{"routes", "route_short_name", "en", "R1", "", "one"},
                                     {"agency", "agency_name", "en", "", "Transports", "Transit"}},
                                    "fr",
                                    "en");
    ScheduleLine full = line();
    translator.translate(full);
    EXPECT_EQ(full.shortName, "one");
    EXPECT_EQ(full.agency.name, "Transit");
    ScheduleLine bare = line();
    bare.shortName.clear();
    translator.translate(bare);
    EXPECT_EQ(bare.shortName, "");
}

} // namespace
} // namespace orvo
