#include "platform/feeds/schedule/ScheduleText.h"

#include <gtest/gtest.h>

namespace orvo::ScheduleText {
namespace {

TEST(ScheduleText, CleanNameIsOneLineWithoutControlCharacters) {
    EXPECT_EQ(cleanName("  Gare\r\n  du\tNord "), "Gare du Nord");
    EXPECT_EQ(cleanName("a\x1B[31mb\x07"), "a[31mb");
    EXPECT_EQ(cleanName("a\u202Eb\u2066c\u200Ed"), "abcd");
    EXPECT_EQ(cleanName("a\u00A0b"), "a b");
    EXPECT_EQ(cleanName("東京 é"), "東京 é");
    EXPECT_EQ(cleanName("a\xFF"), "a\uFFFD");
    EXPECT_EQ(cleanName(" \n "), "");
}

TEST(ScheduleText, CleanNameEndsAfter500Characters) {
    std::string longName;
    for (int count = 0; count < 600; ++count)
        longName += "é";
    EXPECT_EQ(cleanName(longName), longName.substr(0, 1000));
}

TEST(ScheduleText, ColorIsSixHexadecimalDigitsInCapitals) {
    EXPECT_EQ(color("da291c"), "DA291C");
    EXPECT_EQ(color("#FFffFF"), "FFFFFF");
    for (const char* bad : {"", "FFF", "GGGGGG", "DA291C0", "0xDA29", "##1234", " 12345"})
        EXPECT_EQ(color(bad), "") << bad;
}

TEST(ScheduleText, DateIsADayOfTheCalendar) {
    EXPECT_EQ(date("20240229"), "2024-02-29");
    for (const char* bad :
         {"", "20230229", "20241301", "20240100", "2024-1-1", "2024010", "2024010a"})
        EXPECT_EQ(date(bad), "") << bad;
}

TEST(ScheduleText, WebAddressIsHttpOnly) {
    EXPECT_EQ(webAddress("https://a.example/x"), "https://a.example/x");
    EXPECT_EQ(webAddress("HTTP://a.example"), "HTTP://a.example");
    EXPECT_EQ(webAddress("javascript:alert(1)"), "");
    EXPECT_EQ(webAddress("a.example"), "");
}

TEST(ScheduleText, SmallNumberIsWholeAndNotNegative) {
    EXPECT_EQ(smallNumber("0"), 0);
    EXPECT_EQ(smallNumber("999999"), 999999);
    for (const char* bad : {"", "-1", "1000000", "3.0", "3x", " 3", "99999999999999999999"})
        EXPECT_FALSE(smallNumber(bad)) << bad;
}

TEST(ScheduleText, TrimmedDropsBlanksAtTheEndsOnly) {
    EXPECT_EQ(trimmed(" a b\r\n"), "a b");
    EXPECT_EQ(trimmed("\t "), "");
}

} // namespace
} // namespace orvo::ScheduleText
