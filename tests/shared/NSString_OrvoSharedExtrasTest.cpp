#include "shared/NSString_OrvoSharedExtras.h"

#include "platform/foundation/NSValue.h"
#include "platform/foundation/Text.h"

#include <gtest/gtest.h>

#include <optional>
#include <ostream>
#include <string>
#include <vector>

namespace orvo {

void PrintTo(const NSRange& range, std::ostream* stream) {
    *stream << "{" << range.location << "," << range.length << "}";
}

namespace {

using Ranges = std::optional<std::vector<NSRange>>;

class PrefixMatches : public ::testing::Test {
protected:
    static Ranges matches(const std::string& text, const std::string& search) {
        const auto array = OrvoSharedExtras::_orvo_prefixMatchesForSearchString(text, search);
        if (!array)
            return std::nullopt;
        std::vector<NSRange> ranges;
        for (const auto& value : typed<NSValue>(array))
            ranges.push_back(value->rangeValue());
        return ranges;
    }
    static Ranges ranges(std::vector<NSRange> values) { return values; }

    static Ranges
    matchesIn(const char* locale, const std::string& text, const std::string& search) {
        const auto override = Text::locale().overrideWith(locale);
        return matches(text, search);
    }

private:
    EnvironmentSlot<std::string>::Override _locale = Text::locale().overrideWith("en");
};

TEST_F(PrefixMatches, ComeInTheOrderOfTheSearchWords) {
    EXPECT_EQ(matches("New York", "yo ne"), ranges({{4, 2}, {0, 2}}));
}

TEST_F(PrefixMatches, AreTheFirstWordThatBeginsSo) {
    EXPECT_EQ(matches("Old New Newark", "new"), ranges({{4, 3}}));
    EXPECT_EQ(matches("Old New Newark", "newa"), ranges({{8, 4}}));
}

TEST_F(PrefixMatches, AreBeginningsOfWordsAndNotTheirMiddle) {
    EXPECT_EQ(matches("New York", "ork"), std::nullopt);
    EXPECT_EQ(matches("Aachen chenille", "chen"), ranges({{7, 4}}));
}

TEST_F(PrefixMatches, CaseAndAccentsDoNotCount) {
    EXPECT_EQ(matches("École Élysée", "ely ECO"), ranges({{6, 3}, {0, 3}}));
    EXPECT_EQ(matches("Elysee", "ély"), ranges({{0, 3}}));
}

TEST_F(PrefixMatches, AreAsLongAsTheWordThatWasTyped) {
    EXPECT_EQ(matches("Straße", "strasse"), ranges({{0, 7}}));
    EXPECT_EQ(matches("e\u0301cole", "e"), ranges({{0, 1}}));
    EXPECT_EQ(matches("ecole", "e\u0301"), ranges({{0, 2}}));
}

TEST_F(PrefixMatches, CountUtf16Units) {
    EXPECT_EQ(matches("\U0001F68B Tram", "tr"), ranges({{3, 2}}));
}

TEST_F(PrefixMatches, AreNilWhenOneOfSeveralWordsBeginsNone) {
    EXPECT_EQ(matches("New York", "new x"), std::nullopt);
    EXPECT_EQ(matches("New York", "x new"), std::nullopt);
}

TEST_F(PrefixMatches, AreEmptyAndNotNilWhenNoWordWasTyped) {
    EXPECT_EQ(matches("New York", ""), ranges({}));
    EXPECT_EQ(matches("New York", "   "), ranges({}));
    EXPECT_EQ(matches("New York", " .,;! "), ranges({}));
    EXPECT_EQ(matches("", ""), ranges({}));
}

TEST_F(PrefixMatches, InATextWithoutWordsAreNilForAnyWord) {
    EXPECT_EQ(matches("", "a"), std::nullopt);
    EXPECT_EQ(matches("...", "a"), std::nullopt);
}

TEST_F(PrefixMatches, SeveralSearchWordsMayBeginTheSameWord) {
    EXPECT_EQ(matches("New York", "ne new"), ranges({{0, 2}, {0, 3}}));
    EXPECT_EQ(matches("New York", "ne ne"), ranges({{0, 2}, {0, 2}}));
}

TEST_F(PrefixMatches, WordsAreFoundAlsoWhereTheWritingDoesNotPartThem) {
    EXPECT_EQ(matchesIn("th", "สถานีรถไฟ", "รถไฟ"), ranges({{5, 4}}));
    EXPECT_EQ(matchesIn("th", "สถานี รถไฟ", "รถไฟสถานี"), ranges({{6, 4}, {0, 5}}));
}

TEST_F(PrefixMatches, WhatCountsAsTheSameLetterIsTheLocalesMatter) {
    EXPECT_EQ(matchesIn("en", "Östersund", "os"), ranges({{0, 2}}));
    EXPECT_EQ(matchesIn("sv", "Östersund", "os"), std::nullopt);
    EXPECT_EQ(matchesIn("en", "Aarhus", "år"), std::nullopt);
    EXPECT_EQ(matchesIn("da", "Aarhus", "år"), ranges({{0, 2}}));
}

TEST_F(PrefixMatches, PunctuationSeparatesWords) {
    EXPECT_EQ(matches("Paddington–Reading (fast)", "fa re"), ranges({{20, 2}, {11, 2}}));
}

} // namespace
} // namespace orvo
