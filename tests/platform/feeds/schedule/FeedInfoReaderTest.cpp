#include "platform/feeds/schedule/FeedInfoReader.h"

#include "TestSchedules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

testing::ReadSchedule withInfo(const std::string& text) {
    return testing::readSchedule(
        testing::withFile(testing::smallSchedule(), "feed_info.txt", text));
}

TEST(FeedInfoReader, ReadsTheFirstRow) {
    const auto read = withInfo("feed_publisher_name,feed_lang,feed_start_date,feed_end_date,"
                               "feed_version\n"
                               "City,de,20240709,20240824,\"Summer, D\"\nOther,en,,,\n");
    const ScheduleInfo& info = read.contents.info;
    EXPECT_EQ(info.publisher, "City");
    EXPECT_EQ(info.language, "de");
    EXPECT_EQ(info.version, "Summer, D");
    EXPECT_EQ(info.startDate, "2024-07-09");
    EXPECT_EQ(info.endDate, "2024-08-24");
    EXPECT_EQ(info.timezone, "Europe/Paris");
    // Midnight after the last day, in summer time.
    EXPECT_EQ(info.validUntil, 1724536800);
    EXPECT_FALSE(info.hasRunOut(1724536799));
    EXPECT_TRUE(info.hasRunOut(1724536800));
}

TEST(FeedInfoReader, WithoutTheFileTheFirstAgencySpeaks) {
    const auto read = testing::readSchedule(testing::smallSchedule());
    EXPECT_EQ(read.contents.info.language, "fr");
    EXPECT_EQ(read.contents.info.timezone, "Europe/Paris");
    EXPECT_EQ(read.contents.info.endDate, "");
    EXPECT_FALSE(read.contents.info.validUntil);
    EXPECT_FALSE(read.contents.info.hasRunOut(1e15));
}

TEST(FeedInfoReader, AScheduleInSeveralLanguagesNamesItsOwnApart) {
    EXPECT_EQ(withInfo("feed_lang,default_lang\nMUL,nl\n").contents.info.language, "nl");
    EXPECT_EQ(withInfo("feed_lang\nmul\n").contents.info.language, "fr");
}

TEST(FeedInfoReader, CountsADateThatIsNone) {
    const auto read = withInfo("feed_end_date\n20240231\n");
    EXPECT_EQ(read.contents.info.endDate, "");
    EXPECT_THAT(read.contents.notes.notes(),
                ::testing::ElementsAre(
                    ImportNote{"feed_info.txt", "no day of the calendar in feed_end_date", 1, 2}));
}

} // namespace
} // namespace orvo
