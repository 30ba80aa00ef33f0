#include "platform/feeds/alerts/LineName.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

bool isOnlyName(std::string_view text, std::string shortName, std::string longName) {
    ScheduleLine line;
    line.shortName = std::move(shortName);
    line.longName = std::move(longName);
    return isOnlyNameOfLine(text, line);
}

} // namespace

TEST(LineName, EachNameAndBothTogetherAreOnlyTheName) {
    for (const std::string text :
         {"17", "Hurontario", "17 Hurontario", "17 - HURONTARIO:", "Hurontario (17)"})
        EXPECT_TRUE(isOnlyName(text, "17", "Hurontario")) << text;
}

TEST(LineName, AnythingMoreIsMore) {
    for (const std::string text : {"17 delayed", "1", "170", "Hurontario closed", "17 17"})
        EXPECT_FALSE(isOnlyName(text, "17", "Hurontario")) << text;
}

TEST(LineName, NamesBeyondASCIICount) {
    EXPECT_TRUE(isOnlyName("T3 Hôpital", "T3", "Hôpital"));
    EXPECT_FALSE(isOnlyName("漢", "漢字", ""));
}

TEST(LineName, BlankTextsAreNoName) {
    EXPECT_FALSE(isOnlyName("", "", ""));
    EXPECT_FALSE(isOnlyName("--", "", ""));
    EXPECT_FALSE(isOnlyName("", "17", "Hurontario"));
}

} // namespace orvo::testing
