#include "platform/feeds/schedule/TextDecoder.h"

#include "TestSchedules.h"
#include "platform/feeds/schedule/ScheduleError.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using testing::TextStream;

struct Decoded {
    std::string text;
    std::shared_ptr<NSError> error;
};

Decoded decode(const std::string& bytes, std::size_t pieceLength = 1 << 16) {
    TextStream stream(bytes, pieceLength);
    TextDecoder decoder(stream, "stops.txt");
    Decoded decoded;
    while (true) {
        const std::string_view piece = decoder.next(decoded.error);
        if (piece.empty())
            return decoded;
        decoded.text += piece;
    }
}

std::string utf16(std::u16string_view text, bool isBigEndian) {
    std::string bytes;
    for (const char16_t unit : text) {
        const auto high = static_cast<char>(unit >> 8);
        const auto low = static_cast<char>(unit & 0xFF);
        bytes += isBigEndian ? std::string{high, low} : std::string{low, high};
    }
    return bytes;
}

TEST(TextDecoder, PassesUtf8OnAndDropsItsMark) {
    EXPECT_EQ(decode("Zürich").text, "Zürich");
    EXPECT_EQ(decode("\xEF\xBB\xBFZürich").text, "Zürich");
    EXPECT_EQ(decode("").text, "");
    EXPECT_EQ(decode("\xEF\xBB\xBF").text, "");
    EXPECT_EQ(decode("\xEF\xBB").text, "\xEF\xBB");
}

TEST(TextDecoder, ConvertsUtf16ByItsMarkHoweverThePiecesAreCut) {
    const std::u16string text = u"\uFEFFZürich 東京 \U0001F68B,\r\n";
    for (const bool isBigEndian : {false, true})
        for (const std::size_t pieceLength : {1U, 2U, 3U, 5U, 1000U}) {
            const Decoded decoded = decode(utf16(text, isBigEndian), pieceLength);
            EXPECT_EQ(decoded.text, "Zürich 東京 \U0001F68B,\r\n");
            EXPECT_FALSE(decoded.error);
        }
}

TEST(TextDecoder, RefusesUtf16ThatIsCutOrHasHalfAPair) {
    const std::string whole = utf16(u"\uFEFFa\U0001F68B", false);
    for (std::size_t length = whole.size() - 1; length > whole.size() - 4; --length) {
        const Decoded decoded = decode(whole.substr(0, length));
        ASSERT_TRUE(decoded.error) << length;
        EXPECT_EQ(decoded.error->localizedDescription(),
                  "stops.txt: is marked as UTF-16 but is not valid UTF-16");
    }
    EXPECT_EQ(decode(whole.substr(0, whole.size() - 1)).text, "a");
    const std::string lone = {'\xFF', '\xFE', '\x00', '\xDC'};
    EXPECT_TRUE(decode(lone).error);
    const std::string twoHigh = {'\xFF', '\xFE', '\x00', '\xD8', '\x00', '\xD8'};
    EXPECT_TRUE(decode(twoHigh).error);
}

TEST(TextDecoder, PassesTheStreamsFailureOn) {
    TextStream stream("abc");
    stream.failure = scheduleError(ScheduleErrorCode::CannotRead, "broken");
    TextDecoder decoder(stream, "stops.txt");
    std::shared_ptr<NSError> error;
    std::string text;
    while (true) {
        const std::string_view piece = decoder.next(error);
        if (piece.empty())
            break;
        text += piece;
    }
    EXPECT_EQ(text, "abc");
    EXPECT_EQ(error, stream.failure);
}

} // namespace
} // namespace orvo
