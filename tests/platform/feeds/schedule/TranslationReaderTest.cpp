#include "platform/feeds/schedule/TranslationReader.h"

#include "TestSchedules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::ElementsAre;

testing::ReadSchedule withTranslations(const std::string& text) {
    return testing::readSchedule(
        testing::withFile(testing::smallSchedule(), "translations.txt", text));
}

TEST(TranslationReader, TakesTheNamesOfLinesAndAgencies) {
    const auto read =
        withTranslations("table_name,field_name,language,translation,record_id,field_value\n"
                         "routes,route_long_name,en,Station - Town hall,R1,\n"
                         "agency,agency_name,en,City,,City Lines\n"
                         "stops,stop_name,en,Station,S1,\n"
                         "routes,route_desc,en,Long words,R1,\n");
    EXPECT_THAT(
        read.contents.translations,
        ElementsAre(
            ScheduleTranslation{"routes", "route_long_name", "en", "R1", "", "Station - Town hall"},
            ScheduleTranslation{"agency", "agency_name", "en", "", "City Lines", "City"}));
    EXPECT_TRUE(read.contents.notes.notes().empty());
}

TEST(TranslationReader, LeavesOutWhatLacksAPartAndCountsIt) {
    const auto read = withTranslations("table_name,field_name,language,translation,record_id\n"
                                       "routes,route_long_name,,Station,R1\n"
                                       "routes,route_long_name,en,,R1\n"
                                       "routes,route_long_name,en,Station,\n");
    EXPECT_TRUE(read.contents.translations.empty());
    EXPECT_THAT(
        read.contents.notes.notes(),
        ElementsAre(ImportNote{"translations.txt",
                               "no language, no translation or nothing that it is of, left out",
                               3,
                               2}));
}

TEST(TranslationReader, AFileOfTheOldFormIsLeftOut) {
    const auto read = withTranslations("trans_id,lang,translation\nGare,en,Station\n");
    EXPECT_THAT(
        read.contents.notes.notes(),
        ElementsAre(ImportNote{"translations.txt", "no column table_name, left out", 1, 0}));
}

} // namespace
} // namespace orvo
