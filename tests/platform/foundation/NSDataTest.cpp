#include "platform/foundation/NSData.h"

#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdlib>
#include <cstring>

namespace orvo {
namespace {

TEST(NSData, CopiesTheBytesThatItIsGiven) {
    std::array<std::uint8_t, 3> bytes = {1, 2, 3};
    const auto data = NSData::dataWithBytes(bytes);
    bytes[0] = 9;
    ASSERT_EQ(data->length(), 3U);
    EXPECT_EQ(data->bytes()[0], 1);
}

TEST(NSData, TakesOverAllocatedBytesWithoutACopy) {
    auto* bytes = static_cast<std::uint8_t*>(std::malloc(3)); // freed by the data
    std::memcpy(bytes, "abc", 3);
    const auto data = NSData::dataWithBytesNoCopy(bytes, 3);
    EXPECT_EQ(data->bytes().data(), bytes);
    EXPECT_EQ(data->stringView(), "abc");
}

TEST(NSData, IsEqualToTheSameBytesWhereverTheyLieAndHashesLikeThem) {
    auto* bytes = static_cast<std::uint8_t*>(std::malloc(3));
    std::memcpy(bytes, "abc", 3);
    const auto a = NSData::dataWithBytesNoCopy(bytes, 3);
    const auto b = NSData::dataWithString("abc");
    const auto c = NSData::dataWithVector({'a', 'b', 'd'});
    const auto shorter = NSData::dataWithString("ab");
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
    EXPECT_FALSE(a->isEqual(c.get()));
    EXPECT_FALSE(c->isEqual(a.get()));
    EXPECT_FALSE(a->isEqual(shorter.get()));
    EXPECT_FALSE(shorter->isEqual(a.get()));
    EXPECT_FALSE(a->isEqual(nullptr));
    EXPECT_FALSE(a->isEqual(NSString::string("abc").get()));
}

TEST(NSData, MayBeEmpty) {
    const auto empty = NSData::dataWithString("");
    EXPECT_EQ(empty->length(), 0U);
    EXPECT_TRUE(empty->stringView().empty());
    EXPECT_TRUE(empty->isEqual(NSData::dataWithBytes({}).get()));
    EXPECT_TRUE(empty->isEqual(NSData::dataWithBytesNoCopy(nullptr, 0).get()));
    EXPECT_EQ(empty->description(), "{length = 0, bytes = 0x}");
}

TEST(NSData, DescribesShortBytesWholeAndLeavesOutTheMiddleOfLongOnes) {
    EXPECT_EQ(NSData::dataWithVector({1, 0xab, 0xff})->description(),
              "{length = 3, bytes = 0x01abff}");
    EXPECT_EQ(NSData::dataWithString(std::string(24, 'A'))->description(),
              "{length = 24, bytes = 0x414141414141414141414141414141414141414141414141}");
    EXPECT_EQ(
        NSData::dataWithString(std::string(16, 'A') + "xyz" + std::string(8, 'B'))->description(),
        "{length = 27, bytes = 0x41414141414141414141414141414141 ... 4242424242424242}");
}

TEST(NSData, IsItsOwnCopy) {
    const auto data = NSData::dataWithString("a");
    EXPECT_EQ(data->copy(), data);
}

} // namespace
} // namespace orvo
