#include "platform/foundation/NSString.h"

#include "platform/foundation/NSNumber.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(NSString, IsEqualToTheSameBytesAndHashesLikeThem) {
    const auto a = NSString::string("Grüße");
    const auto b = NSString::string("Grüße");
    const auto c = NSString::string("grüße");
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
    EXPECT_FALSE(a->isEqual(c.get()));
    EXPECT_FALSE(c->isEqual(a.get()));
    EXPECT_FALSE(a->isEqual(nullptr));
}

TEST(NSString, IsNeverEqualToANumberThatReadsTheSame) {
    const auto text = NSString::string("1");
    const auto number = NSNumber::numberWithInteger(1);
    EXPECT_FALSE(text->isEqual(number.get()));
    EXPECT_FALSE(number->isEqual(text.get()));
}

TEST(NSString, KeepsZeroBytes) {
    const auto a = NSString::string(std::string("a\0b", 3));
    EXPECT_EQ(a->utf8().size(), 3U);
    EXPECT_FALSE(a->isEqual(NSString::string("a").get()));
}

TEST(NSString, HashesTheSameInEveryRun) {
    EXPECT_EQ(NSString::string("")->hash(), 0xcbf29ce484222325ULL);
    EXPECT_EQ(NSString::string("a")->hash(), 0xaf63dc4c8601ec8cULL);
}

TEST(NSString, IsNilForNoTextAndEmptyForEmptyText) {
    EXPECT_EQ(NSString::stringOrNil(std::nullopt), nullptr);
    ASSERT_NE(NSString::stringOrNil(""), nullptr);
    EXPECT_EQ(NSString::stringOrNil("")->utf8(), "");
}

TEST(NSString, GivesItsTextWhereAnObjectIsOne) {
    EXPECT_EQ(stringValue(NSString::string("x").get()), "x");
    EXPECT_EQ(stringValue(NSNumber::numberWithInteger(1).get()), std::nullopt);
    EXPECT_EQ(stringValue(nullptr), std::nullopt);
}

TEST(NSString, HashesOptionalTextLikeItsObject) {
    EXPECT_EQ(hashOf(std::optional<std::string>("x")), NSString::string("x")->hash());
    EXPECT_EQ(hashOf(std::optional<std::string>()), 0U);
}

TEST(NSString, DescribesAndCopiesAsItself) {
    const auto text = NSString::string("x");
    EXPECT_EQ(text->description(), "x");
    EXPECT_EQ(text->copy(), text);
}

} // namespace
} // namespace orvo
