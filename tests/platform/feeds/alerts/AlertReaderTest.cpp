#include "platform/feeds/alerts/AlertReader.h"

#include "AlertMaker.h"
#include "CapturedFeed.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

struct Read {
    std::optional<AlertMessage> message;
    AlertErrorCode code{};
    std::string reason;
};

/// From a heap block of exactly the bytes' size; the entities in the answer are not to be read.
Read read(const std::string& bytes) {
    const std::vector<std::uint8_t> block(bytes.begin(), bytes.end());
    std::shared_ptr<NSError> error;
    Read read{AlertReader::read(block, &error), {}, {}};
    if (error) {
        read.code = static_cast<AlertErrorCode>(error->code());
        read.reason = error->localizedDescription();
    }
    return read;
}

std::string small() {
    return message(std::vector<AlertMaker>(2));
}

} // namespace

TEST(AlertReader, AHeaderAloneIsAWholeMessage) {
    const Read answer = read(message(std::vector<Wire>(), 1750000000));
    ASSERT_TRUE(answer.message);
    EXPECT_EQ(answer.message->timestamp, 1750000000U);
    EXPECT_TRUE(answer.message->entities.empty());
}

TEST(AlertReader, FindsEveryEntityInOrder) {
    const std::string bytes = small();
    const std::vector<std::uint8_t> block(bytes.begin(), bytes.end());
    std::vector<std::string_view> visited;
    const auto answer =
        AlertReader::read(block, nullptr, [&](std::string_view e) { visited.push_back(e); });
    ASSERT_TRUE(answer);
    ASSERT_EQ(answer->entities.size(), 2U);
    EXPECT_EQ(answer->entities[0], AlertMaker().entity().str());
    EXPECT_EQ(visited, answer->entities);
}

TEST(AlertReader, NoBytesAreAFailedFetch) {
    EXPECT_EQ(read("").code, AlertErrorCode::Empty);
}

TEST(AlertReader, AWebPageIsAFailedFetchEvenAfterABlankLine) {
    for (const std::string start : {"", "\n", "\r\n  ", "\xEF\xBB\xBF", "\n\n"}) {
        const Read answer = read(start + "<!DOCTYPE html>\n<html><body>Forbidden</body></html>");
        EXPECT_EQ(answer.code, AlertErrorCode::NotAlerts);
        EXPECT_EQ(answer.reason, "it is a web page or XML, not GTFS-Realtime");
    }
}

TEST(AlertReader, JSONIsAFailedFetch) {
    for (const std::string text : {"{\"error\": \"no key\"}", "[]", "\n{\"header\": {}}", "{}"})
        EXPECT_EQ(read(text).reason, "it is JSON, not GTFS-Realtime") << text;
}

TEST(AlertReader, CompressedBytesAreNamedAsSuch) {
    EXPECT_EQ(read("\x1F\x8B\x08 some bytes").reason, "it is compressed, not GTFS-Realtime");
}

TEST(AlertReader, CutAnywhereButBetweenEntitiesItIsAFailedFetch) {
    const std::string whole = small();
    const std::size_t entity = AlertMaker().entity().str().size() + 2;
    const std::size_t head = whole.size() - 2 * entity;
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const bool looksWhole = length == head || length == head + entity;
        EXPECT_EQ(read(whole.substr(0, length)).message.has_value(), looksWhole) << length;
    }
    EXPECT_EQ(read(whole.substr(0, whole.size() - 1)).code, AlertErrorCode::Truncated);
    EXPECT_EQ(read(whole.substr(0, whole.size() - 1)).reason, "it ends in the middle of an entry");
}

TEST(AlertReader, AMessageWithoutAHeaderIsAFailedFetch) {
    EXPECT_EQ(read(Wire().bytes(2, AlertMaker().entity()).str()).code, AlertErrorCode::NoHeader);
}

TEST(AlertReader, AHeaderThatSaysNothingIsNone) {
    EXPECT_EQ(read(Wire().bytes(1, "").str()).code, AlertErrorCode::NotAlerts);
    EXPECT_TRUE(read(Wire().bytes(1, Wire().bytes(1, "1.0")).str()).message);
    EXPECT_TRUE(read(Wire().bytes(1, Wire().number(3, 5)).str()).message);
}

TEST(AlertReader, AHeaderThatCannotBeWalkedIsAFailedFetch) {
    EXPECT_FALSE(read(Wire().bytes(1, Wire().bytes(1, "2.0").raw("\x1A\x7F")).str()).message);
}

TEST(AlertReader, WrongWireTypesOfTheMessageAreAFailedFetch) {
    const std::string good = message(std::vector<Wire>());
    EXPECT_FALSE(read(good + Wire().number(1, 3).str()).message);
    EXPECT_FALSE(read(good + Wire().number(2, 3).str()).message);
    EXPECT_FALSE(read(good + Wire().key(2, 5).raw("1234").str()).message);
    EXPECT_FALSE(read(good + Wire().group(1).str()).message);
    EXPECT_FALSE(read(good + Wire().group(2).str()).message);
}

TEST(AlertReader, UnknownFieldsAndGroupsOfTheMessageAreSteppedOver) {
    const std::string more =
        Wire().number(3, 1).bytes(1104, "x").key(20000, 3).number(1, 2).key(20000, 4).str();
    const Read answer = read(more + small() + more);
    ASSERT_TRUE(answer.message) << answer.reason;
    EXPECT_EQ(answer.message->entities.size(), 2U);
}

TEST(AlertReader, AHeaderFieldOfTheWrongTypeIsAFailedFetch) {
    // Read as missing, a time of years ago would count as now.
    EXPECT_FALSE(read(Wire().bytes(1, Wire().bytes(1, "2.0").bytes(3, "soon")).str()).message);
    EXPECT_FALSE(read(Wire().bytes(1, Wire().number(1, 2).number(3, 5)).str()).message);
    EXPECT_FALSE(read(Wire().bytes(1, Wire().bytes(1, "2.0").bytes(2, "all")).str()).message);
    for (std::uint32_t field = 1; field <= 3; ++field)
        EXPECT_FALSE(read(Wire().bytes(1, header(5).group(field)).str()).message) << field;
    EXPECT_TRUE(read(Wire().bytes(1, header(5).group(4)).str()).message);
}

TEST(AlertReader, AMessageOfMereDifferencesIsAFailedFetch) {
    const Wire differential = Wire().bytes(1, "2.0").number(2, 1).number(3, 5);
    const Read answer = read(Wire().bytes(1, differential).bytes(2, AlertMaker().entity()).str());
    EXPECT_EQ(answer.code, AlertErrorCode::Difference);
    EXPECT_EQ(answer.reason, "it tells only what changed since an earlier message");
    EXPECT_FALSE(read(Wire().bytes(1, Wire().bytes(1, "2.0").number(2, 7)).str()).message);
}

TEST(AlertReader, MoreEntitiesThanAnyFeedHasAreRefused) {
    std::string bytes = message(std::vector<Wire>());
    for (int i = 0; i < 250'001; ++i)
        bytes += std::string("\x12\x00", 2);
    EXPECT_EQ(read(bytes).reason, "it has more entries than any feed");
}

TEST(AlertReader, ReadsTheCapturedHeaderOnlyFeedsAndNoOthersOfThem) {
    if (capturedFeeds().empty())
        GTEST_SKIP() << "ORVO_TEST_FEEDS is not set";
    const auto file = [](const char* name) {
        return read(bytesOf(capturedFeeds() / name));
    };
    EXPECT_TRUE(file("empty-feeds/caltrain-20231108-header-only.pb").message);
    EXPECT_TRUE(file("empty-feeds/gtt-torino-20250904-header-only.pb").message);
    EXPECT_TRUE(file("irail-nmbs-2015/empty.pb").message);
    EXPECT_EQ(file("empty-feeds/zero-bytes.pb").code, AlertErrorCode::Empty);
    EXPECT_EQ(file("hostile-rt/html-error-page.pb").code, AlertErrorCode::NotAlerts);
    EXPECT_EQ(file("hostile-rt/truncated-middle.pb").code, AlertErrorCode::Truncated);
    EXPECT_TRUE(file("hostile-rt/truncated-at-boundary.pb").message);
}

} // namespace orvo::testing
