#include "platform/feeds/alerts/IncidentContent.h"

#include "platform/foundation/Hashing.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

using namespace std::string_view_literals;

std::uint64_t numberOf(const IncidentContent& content, std::string_view feed = "town") {
    return IncidentContent::numbersOf(std::span(&content, 1), feed).at(0);
}

} // namespace

TEST(IncidentContent, NormalisesAcrossLongTexts) {
    std::string room;
    EXPECT_EQ(IncidentContent::normalised("a\u202Fb\u00A0c &eacute;", room), "a b c é");
}

TEST(IncidentContent, ATextThatIsAsItIsComparedIsNotCopied) {
    const std::string_view text = "  Line 17 delayed: use the bus ";
    std::string room;
    EXPECT_EQ(IncidentContent::normalised(text, room).data(), text.data() + 2);
    EXPECT_EQ(room, "");
}

TEST(IncidentContent, TheNumberIsOfFeedTextsAndEffect) {
    EXPECT_EQ(numberOf({"Delay", "Fire", 4}), stableHash("town\0Delay\0Fire\0004"sv));
    EXPECT_EQ(numberOf({"", "", 11}, ""), stableHash("\0\0\00011"sv));
}

TEST(IncidentContent, HasTheSameNumberAmongOthersAsAlone) {
    std::vector<IncidentContent> contents = {{"", "", 1},
                                             {"A", "A description that is longer than others", 2},
                                             {"Déviation", "", 3},
                                             {"Line 17", "Short", 4},
                                             {"Line 18", "One two", 5},
                                             {"Line 19", "Three", 6}};
    for (; !contents.empty(); contents.pop_back()) {
        const auto numbers = IncidentContent::numbersOf(contents, "town");
        ASSERT_EQ(numbers.size(), contents.size());
        for (std::size_t i = 0; i < contents.size(); ++i)
            EXPECT_EQ(numbers[i], numberOf(contents[i])) << contents.size() << ' ' << i;
    }
    EXPECT_TRUE(IncidentContent::numbersOf({}, "town").empty());
}

} // namespace orvo::testing
