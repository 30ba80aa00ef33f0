#include "platform/foundation/SeededStringHash.h"

#include "platform/foundation/Hashing.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace orvo {
namespace {

TEST(SeededStringHash, TextsThatWerePreparedToHaveOneHashDoNotShareIt) {
    const std::string_view one = "8yn0iYCKYHlIj4-BwPqk";
    const std::string_view other = "GReLUrM4wMqfg9yzV3KQ";
    ASSERT_EQ(stableHash(one), stableHash(other));
    EXPECT_NE(SeededStringHash()(one), SeededStringHash()(other));
}

TEST(SeededStringHash, IsTheSameForTheSameTextInThisProcess) {
    EXPECT_EQ(SeededStringHash()("R1"), SeededStringHash()(std::string("R1")));
    EXPECT_NE(SeededStringHash()("R1"), SeededStringHash()("R2"));
    EXPECT_NE(SeededStringHash()("R1"), stableHash("R1"));
}

TEST(SeededStringHash, ATableOfStringsIsAskedWithAView) {
    const SeededTextMap<std::string, int> table{{"R1", 1}, {"R2", 2}};
    EXPECT_EQ(table.find(std::string_view("R2"))->second, 2);
    EXPECT_FALSE(table.contains(std::string_view("R3")));
    EXPECT_TRUE(SeededTextSet<std::string>{"R1"}.contains(std::string_view("R1")));
}

TEST(SeededStringHash, ScatteringKeepsNumbersApart) {
    std::unordered_set<std::uint64_t> seen;
    for (std::uint64_t number = 0; number < 1000; ++number)
        EXPECT_TRUE(seen.insert(scattered(number << 54U)).second);
    EXPECT_EQ(scattered(7), scattered(7));
}

TEST(SeededStringHash, NumbersThatWerePreparedForOneBucketAreSpread) {
    SeededNumberMap<int> table;
    table.reserve(1000);
    const std::uint64_t buckets = table.bucket_count();
    for (std::uint64_t number = 0; number < 1000; ++number)
        table.emplace(number * buckets, 1);
    ASSERT_EQ(table.bucket_count(), buckets);
    std::size_t fullest = 0;
    for (std::size_t bucket = 0; bucket < buckets; ++bucket)
        fullest = std::max(fullest, table.bucket_size(bucket));
    EXPECT_LT(fullest, 50U);
}

} // namespace
} // namespace orvo
