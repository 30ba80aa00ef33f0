#include "platform/feeds/alerts/WireCursor.h"

#include "AlertMaker.h"

#include <gtest/gtest.h>

#include <memory>
#include <vector>

namespace orvo::testing {

namespace {

/// What a walk shows: `1=7 2="ab"`, then `failed` or `cut`. The bytes lie in a heap block of
/// exactly their size.
std::string walk(const std::string& bytes) {
    const std::vector<char> block(bytes.begin(), bytes.end());
    WireCursor cursor({block.data(), block.size()});
    std::string text;
    while (cursor.next()) {
        text += text.empty() ? "" : " ";
        text += std::to_string(cursor.field()) + "=";
        if (cursor.key() == WireCursor::bytes(cursor.field()))
            text += '"' + std::string(cursor.bytes()) + '"';
        else if (cursor.key() == WireCursor::number(cursor.field()))
            text += std::to_string(cursor.number());
        else
            text += (cursor.key() & 7U) == 3U ? "group" : "fixed";
    }
    if (cursor.failed())
        text += cursor.wasCutShort() ? " cut" : " failed";
    return text;
}

std::string nestedGroups(std::size_t depth) {
    Wire wire;
    for (std::size_t i = 0; i < depth; ++i)
        wire.key(5, 3);
    for (std::size_t i = 0; i < depth; ++i)
        wire.key(5, 4);
    return wire.number(1, 7).str();
}

} // namespace

TEST(WireCursor, ShowsFieldsOfEachWireType) {
    EXPECT_EQ(walk(Wire()
                       .number(1, 7)
                       .bytes(2, "ab")
                       .key(3, 1)
                       .raw("12345678")
                       .key(4, 5)
                       .raw("1234")
                       .number(5000, 1ULL << 63U)
                       .str()),
              "1=7 2=\"ab\" 3=fixed 4=fixed 5000=9223372036854775808");
}

TEST(WireCursor, AnEmptyMessageHasNoFields) {
    EXPECT_EQ(walk(""), "");
}

TEST(WireCursor, ReadsLengthsOfOneTwoAndThreeBytes) {
    for (const std::size_t length : {0U, 1U, 127U, 128U, 300U, 16383U, 16384U, 40000U}) {
        const std::string text(length, 'x');
        EXPECT_EQ(walk(Wire().bytes(2, text).number(1, 3).str()), "2=\"" + text + "\" 1=3");
    }
}

TEST(WireCursor, CutAtEveryByteItNeverReadsOnAndSaysSo) {
    const std::string whole = Wire()
                                  .number(1, 300)
                                  .bytes(2, "ab")
                                  .key(3, 1)
                                  .raw("12345678")
                                  .key(4, 5)
                                  .raw("1234")
                                  .key(6, 3)
                                  .number(1, 1)
                                  .key(6, 4)
                                  .str();
    const std::vector<std::size_t> boundaries = {0, 3, 7, 16, 21, 25};
    for (std::size_t length = 0; length <= whole.size(); ++length) {
        const bool isBoundary =
            std::find(boundaries.begin(), boundaries.end(), length) != boundaries.end();
        EXPECT_EQ(walk(whole.substr(0, length)).ends_with(" cut") ||
                      walk(whole.substr(0, length)) == " cut",
                  !isBoundary)
            << length;
    }
}

TEST(WireCursor, AGroupIsOneFieldWhateverIsInIt) {
    EXPECT_EQ(walk(Wire().number(1, 1).raw(nestedGroups(3)).str()), "1=1 5=group 1=7");
    EXPECT_EQ(walk(Wire().key(9, 3).bytes(1, "inside").group(8).key(9, 4).number(2, 5).str()),
              "9=group 2=5");
}

TEST(WireCursor, GroupsMayBe64DeepAndNoDeeper) {
    EXPECT_EQ(walk(nestedGroups(64)), "5=group 1=7");
    EXPECT_EQ(walk(nestedGroups(65)), " failed");
    EXPECT_EQ(walk(nestedGroups(1'000'000)), " failed");
}

TEST(WireCursor, AGroupMustEndAsItBegan) {
    EXPECT_EQ(walk(Wire().key(5, 3).key(6, 4).str()), " failed");
    EXPECT_EQ(walk(Wire().key(5, 3).number(1, 1).str()), " cut");
    EXPECT_EQ(walk(Wire().number(1, 1).key(5, 4).str()), "1=1 failed");
}

TEST(WireCursor, AVarintOfElevenBytesIsNone) {
    EXPECT_EQ(walk(Wire().key(1, 0).raw(std::string(9, '\xFF') + '\x01').str()),
              "1=18446744073709551615");
    EXPECT_EQ(walk(Wire().key(1, 0).raw(std::string(10, '\xFF') + '\x01').str()), " failed");
    EXPECT_EQ(walk(std::string(11, '\xFF')), " failed");
}

TEST(WireCursor, ALengthPastTheEndIsACut) {
    EXPECT_EQ(walk(Wire().key(2, 2).varint(3).raw("ab").str()), " cut");
    EXPECT_EQ(walk(Wire().key(2, 2).varint(~0ULL).raw("ab").str()), " cut");
    EXPECT_EQ(walk(Wire().key(2, 2).varint(1ULL << 40U).str()), " cut");
}

TEST(WireCursor, FieldZeroAndUnknownWireTypesFail) {
    EXPECT_EQ(walk(Wire().number(0, 1).str()), " failed");
    EXPECT_EQ(walk(Wire().bytes(0, "").str()), " failed");
    EXPECT_EQ(walk(Wire().key(1, 6).raw("12345678").str()), " failed");
    EXPECT_EQ(walk(Wire().key(1, 7).raw("12345678").str()), " failed");
    EXPECT_EQ(walk(Wire().varint(1ULL << 33U).raw("12").str()), " failed");
}

TEST(WireCursor, LetsAnotherStepOverWholeFields) {
    const std::string bytes = Wire().bytes(5, "a").bytes(5, "b").bytes(6, "c").str();
    WireCursor cursor(bytes);
    ASSERT_TRUE(cursor.next());
    std::string_view rest;
    cursor.skipWith([&](const char* from, const char* end) noexcept {
        rest = {from, static_cast<std::size_t>(end - from)};
        return from + 3;
    });
    EXPECT_EQ(rest, Wire().bytes(5, "b").bytes(6, "c").str());
    ASSERT_TRUE(cursor.next());
    EXPECT_EQ(cursor.bytes(), "c");
}

} // namespace orvo::testing
