#include "platform/foundation/NSValue.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(NSValue, KeepsAndDescribesItsRange) {
    const auto value = NSValue::valueWithRange({4, 2});
    EXPECT_EQ(value->rangeValue(), (NSRange{4, 2}));
    EXPECT_EQ(value->description(), "{4, 2}");
    EXPECT_EQ(value->copy(), value);
}

TEST(NSValue, IsEqualToTheSameRangeAndHashesLikeIt) {
    const auto a = NSValue::valueWithRange({4, 2});
    const auto b = NSValue::valueWithRange({4, 2});
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
    for (const auto& other : {NSValue::valueWithRange({2, 4}), NSValue::valueWithRange({4, 3})}) {
        EXPECT_FALSE(a->isEqual(other.get()));
        EXPECT_FALSE(other->isEqual(a.get()));
    }
    EXPECT_FALSE(a->isEqual(nullptr));
}

} // namespace
} // namespace orvo
