#include "platform/feeds/http/Inflation.h"

#include "platform/feeds/http/Gzip.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Outcome = Inflation::Outcome;
using testing::gzip;

/// Reads exactly these bytes: the block ends where they end.
Inflation inflated(const std::string& bytes, std::uint64_t limit = 1'000'000) {
    const std::vector<std::uint8_t> block(bytes.begin(), bytes.end());
    return inflateGzip(block, limit);
}

TEST(Inflation, GivesBackWhatWasPacked) {
    for (const auto& text : {std::string(), std::string("alert"), std::string(900'000, 'x')}) {
        const auto inflation = inflated(gzip(text));
        ASSERT_EQ(inflation.outcome, Outcome::Whole);
        EXPECT_EQ(inflation.bytes->stringView(), text);
    }
}

TEST(Inflation, MembersFollowOneAnother) {
    EXPECT_EQ(inflated(gzip("ab") + gzip("") + gzip("cd")).bytes->stringView(), "abcd");
}

TEST(Inflation, CutAnywhereItIsDamaged) {
    const auto whole = gzip("alert alert alert");
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_EQ(inflated(whole.substr(0, length)).outcome, Outcome::Damaged) << length;
    for (std::size_t length = 1; length < whole.size(); ++length)
        EXPECT_EQ(inflated(whole + whole.substr(0, length)).outcome, Outcome::Damaged) << length;
}

TEST(Inflation, OtherBytesAreDamaged) {
    EXPECT_EQ(inflated("no gzip at all").outcome, Outcome::Damaged);
    EXPECT_EQ(inflated(gzip("alert") + "more").outcome, Outcome::Damaged);
    auto wrong = gzip("alert");
    wrong[wrong.size() - 5] ^= 1; // of the checksum
    EXPECT_EQ(inflated(wrong).outcome, Outcome::Damaged);
}

TEST(Inflation, TheLimitIsTheLastThatFits) {
    EXPECT_EQ(inflated(gzip("12345"), 5).outcome, Outcome::Whole);
    const auto tooLarge = inflated(gzip("12345"), 4);
    EXPECT_EQ(tooLarge.outcome, Outcome::TooLarge);
    EXPECT_EQ(tooLarge.bytes, nullptr);
    EXPECT_EQ(inflated(gzip(std::string(10'000'000, '\0')), 1000).outcome, Outcome::TooLarge);
}

} // namespace
} // namespace orvo
