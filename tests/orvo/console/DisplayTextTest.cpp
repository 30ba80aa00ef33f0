#include "orvo/console/DisplayText.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Lines = std::vector<std::string>;

TEST(DisplayText, CountsColumnsAndNotBytes) {
    EXPECT_EQ(DisplayText::width("abc"), 3U);
    EXPECT_EQ(DisplayText::width("Straße"), 6U);
    EXPECT_EQ(DisplayText::width("e\u0301"), 1U);
    EXPECT_EQ(DisplayText::width("東京"), 4U);
    EXPECT_EQ(DisplayText::width("a\u200Bb"), 2U);
    EXPECT_EQ(DisplayText::width("\xFF"), 1U);
    EXPECT_EQ(DisplayText::width(""), 0U);
}

TEST(DisplayText, CutsWithoutSplittingACharacter) {
    EXPECT_EQ(DisplayText::cut("abcdef", 6), "abcdef");
    EXPECT_EQ(DisplayText::cut("abcdef", 5), "abcd…");
    EXPECT_EQ(DisplayText::cut("東京駅", 4), "東…");
    EXPECT_EQ(DisplayText::cut("e\u0301e\u0301e\u0301", 2), "e\u0301…");
    EXPECT_EQ(DisplayText::cut("abc", 1), "…");
    EXPECT_EQ(DisplayText::cut("abc", 0), "");
}

TEST(DisplayText, WrapsAtBlanks) {
    EXPECT_EQ(DisplayText::wrap("one two three", 7), (Lines{"one two", "three"}));
    EXPECT_EQ(DisplayText::wrap("one two", 100), (Lines{"one two"}));
    EXPECT_EQ(DisplayText::wrap("", 10), Lines{});
}

TEST(DisplayText, KeepsLineBreaksAndLongWords) {
    EXPECT_EQ(DisplayText::wrap("a\n\nb", 10), (Lines{"a", "", "b"}));
    EXPECT_EQ(DisplayText::wrap("see https://example.org/long now", 8),
              (Lines{"see", "https://example.org/long", "now"}));
}

TEST(DisplayText, EveryLineOfALongTextIsFilled) {
    EXPECT_EQ(DisplayText::wrap("aa bb cc dd ee ff g", 5),
              (std::vector<std::string>{"aa bb", "cc dd", "ee ff", "g"}));
    EXPECT_EQ(DisplayText::wrap("漢字 漢字 a", 6), (std::vector<std::string>{"漢字", "漢字 a"}));
}

TEST(DisplayText, OneLineHasNoControlCharacters) {
    EXPECT_EQ(DisplayText::oneLine(" a\n\t b\x1b[31mc "), "a b [31mc");
    EXPECT_EQ(DisplayText::oneLine("a\u2028b"), "a b");
    EXPECT_EQ(DisplayText::oneLine("R\u202E9\u2066a"), "R9a");
    EXPECT_EQ(DisplayText::oneLine(""), "");
}

} // namespace
} // namespace orvo
