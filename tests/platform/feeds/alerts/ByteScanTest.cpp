#include "platform/feeds/alerts/ByteScan.h"

#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

namespace orvo::ByteScanTests {
namespace {

std::string textOf(std::size_t length) {
    std::string text;
    for (std::size_t i = 0; i < length; ++i)
        text += static_cast<char>('a' + i);
    return text;
}

TEST(ByteScan, AShortWordDiffersWithEveryByteAndTheLength) {
    std::set<std::uint64_t> words;
    std::size_t texts = 0;
    for (std::size_t length = 1; length < ByteScan::Word; ++length) {
        for (std::size_t i = 0; i < length; ++i, ++texts) {
            std::string text = textOf(length);
            text[i] = '!';
            words.insert(ByteScan::shortWord(text) * ByteScan::Word + length);
        }
    }
    EXPECT_EQ(words.size(), texts);
}

TEST(ByteScan, TextsAreEqualByteForByte) {
    for (std::size_t length = 0; length < 3 * ByteScan::Word; ++length) {
        const std::string text = textOf(length);
        EXPECT_TRUE(ByteScan::isEqual(text, std::string(text)));
        EXPECT_FALSE(ByteScan::isEqual(text, text + 'x'));
        for (std::size_t i = 0; i < length; ++i) {
            std::string other = text;
            other[i] = '!';
            EXPECT_FALSE(ByteScan::isEqual(text, other)) << other;
        }
    }
}

TEST(ByteScan, AByteBeyondASCIIIsSeenWhereverItStands) {
    for (std::size_t length = 0; length < 3 * ByteScan::Word; ++length) {
        EXPECT_TRUE(ByteScan::isASCII(textOf(length)));
        for (std::size_t i = 0; i < length; ++i) {
            std::string other = textOf(length);
            other[i] = '\x80';
            EXPECT_FALSE(ByteScan::isASCII(other)) << length << ' ' << i;
        }
    }
}

TEST(ByteScan, PlainTextIsJudgedByEachOfItsBytes) {
    for (int byte = 0; byte <= 0xFF; ++byte) {
        const bool isPlain = byte >= ' ' && byte < 0x7F && byte != '<' && byte != '&';
        for (std::size_t i = 0; i < ByteScan::Block; ++i) {
            std::string text = textOf(ByteScan::Block + 1);
            text[i] = static_cast<char>(byte);
            EXPECT_EQ(ByteScan::isPlainText(text.data()), isPlain) << byte << " at " << i;
        }
    }
}

TEST(ByteScan, PlainTextHasNoTwoBlanksInARowNotEvenWithTheByteBehindIt) {
    for (std::size_t i = 0; i < ByteScan::Block; ++i) {
        std::string text = textOf(ByteScan::Block + 1);
        text[i] = ' ';
        EXPECT_TRUE(ByteScan::isPlainText(text.data())) << i;
        text[i + 1] = ' ';
        EXPECT_FALSE(ByteScan::isPlainText(text.data())) << i;
    }
}

TEST(ByteScan, OfTheByteBehindABlockOnlyABlankCounts) {
    std::string text = textOf(ByteScan::Block) + '<';
    EXPECT_TRUE(ByteScan::isPlainText(text.data()));
}

/// How many of the hashes differ in their low bits, by which tables find their places.
std::size_t places(const std::vector<std::string>& texts) {
    constexpr std::uint64_t LowBits = (1U << 16U) - 1;
    std::set<std::uint64_t> places;
    for (const std::string& text : texts)
        places.insert(ByteScan::quickHash(text) & LowBits);
    return places.size();
}

TEST(ByteScan, TextsThatDifferInAFewBytesHaveHashesOfTheirOwnInTheLowBitsToo) {
    constexpr std::size_t Count = 1000;
    constexpr std::size_t Nearly = 980; // by chance some 8 of 1000 share one of 65,536
    for (const std::size_t length : {3U, 7U, 8U, 13U, 16U, 24U}) {
        for (std::size_t at = 0; at + 3 <= length; ++at) {
            std::vector<std::string> texts;
            for (std::size_t i = 0; i < Count; ++i)
                texts.push_back(textOf(length).replace(at, 3, std::to_string(Count + i).substr(1)));
            EXPECT_GE(places(texts), Nearly) << length << " at " << at;
        }
    }
}

TEST(ByteScan, DigitsAtTheEndsOfTwoWordsDoNotCancelOut) {
    std::vector<std::string> texts;
    std::set<std::uint64_t> hashes;
    for (int i = 100; i < 200; ++i)
        for (int j = 100; j < 200; ++j)
            texts.push_back("Alert " + std::to_string(i).substr(1) + " Line " +
                            std::to_string(j).substr(1));
    for (const std::string& text : texts)
        hashes.insert(ByteScan::quickHash(text));
    EXPECT_EQ(hashes.size(), texts.size());
}

} // namespace
} // namespace orvo::ByteScanTests
