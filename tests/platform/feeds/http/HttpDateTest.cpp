#include "platform/feeds/http/HttpDate.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(HttpDate, ReadsTheThreeForms) {
    EXPECT_EQ(parseHttpDate("Sun, 06 Nov 1994 08:49:37 GMT"), 784111777);
    EXPECT_EQ(parseHttpDate("Sunday, 06-Nov-94 08:49:37 GMT"), 784111777);
    EXPECT_EQ(parseHttpDate("Sun Nov  6 08:49:37 1994"), 784111777);
}

TEST(HttpDate, TwoDigitYearsEndIn2069) {
    EXPECT_EQ(parseHttpDate("Thursday, 01-Jan-70 00:00:00 GMT"), 0);
    EXPECT_EQ(parseHttpDate("Tuesday, 01-Jan-69 00:00:00 GMT"), 3124224000);
}

TEST(HttpDate, LeapSecondAndLeapDay) {
    EXPECT_EQ(parseHttpDate("Sat, 31 Dec 2016 23:59:60 GMT"), 1483228800);
    EXPECT_EQ(parseHttpDate("Thu, 29 Feb 2024 00:00:00 GMT"), 1709164800);
}

TEST(HttpDate, RefusesEverythingElse) {
    for (const char* text : {"",
                             "120",
                             "Sun, 06 Nov 1994 08:49:37",
                             "Sun, 06 Nov 1994 08:49:37 CET",
                             "Sun, 31 Feb 1994 08:49:37 GMT",
                             "Sun, 00 Nov 1994 08:49:37 GMT",
                             "Sun, 06 Nox 1994 08:49:37 GMT",
                             "Sun, 06 Nov 994 08:49:37 GMT",
                             "Sun, 06 Nov 1994 24:49:37 GMT",
                             "Sun, 06 Nov 1994 08:60:37 GMT",
                             "Sun, 06 Nov 1994 08:49:61 GMT",
                             "Sun, 06 Nov 1994 08:49:3x GMT",
                             "1994-11-06T08:49:37Z"})
        EXPECT_EQ(parseHttpDate(text), std::nullopt) << text;
}

} // namespace
} // namespace orvo
