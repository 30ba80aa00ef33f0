#include "platform/foundation/Hashing.h"

#include <gtest/gtest.h>

namespace orvo::testing {

TEST(Hashing, AStableHashIsFNV1a) {
    EXPECT_EQ(stableHash(""), 0xcbf29ce484222325ULL);
    EXPECT_EQ(stableHash("a"), 0xaf63dc4c8601ec8cULL); // the algorithm's published examples
    EXPECT_EQ(stableHash("foobar"), 0x85944171f73967e8ULL);
    EXPECT_EQ(stableHash("bar", stableHash("foo")), stableHash("foobar"));
}

TEST(Hashing, FourAtATimeAreEachAsAlone) {
    const std::array<std::string_view, HashLanes> texts = {"", "foobar", "\xFF", "foo"};
    const std::array<std::uint64_t, HashLanes> seeds = {1, stableHash(""), 3, stableHash("bar")};
    const auto none = stableHashes(texts, seeds);
    for (std::size_t lane = 0; lane < HashLanes; ++lane)
        EXPECT_EQ(none[lane], stableHash(texts[lane], seeds[lane]));
    const auto some = stableHashes({"abcd", "efg", "hijk", "lmnopq"}, seeds);
    EXPECT_EQ(some[0], stableHash("abcd", seeds[0]));
    EXPECT_EQ(some[1], stableHash("efg", seeds[1]));
    EXPECT_EQ(some[2], stableHash("hijk", seeds[2]));
    EXPECT_EQ(some[3], stableHash("lmnopq", seeds[3]));
}

} // namespace orvo::testing
