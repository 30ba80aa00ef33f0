#include "platform/foundation/NSURL.h"

#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(NSURL, KeepsItsTextAsGiven) {
    const std::string text = "https://example.org/a%20b?q=ü#f";
    const auto url = NSURL::URLWithString(text);
    ASSERT_NE(url, nullptr);
    EXPECT_EQ(url->absoluteString(), text);
    EXPECT_EQ(url->description(), text);
}

TEST(NSURL, GivesItsSchemeInSmallLetters) {
    EXPECT_EQ(NSURL::URLWithString("HTTPS://example.org")->scheme(), "https");
    EXPECT_EQ(NSURL::URLWithString("svn+ssh://x")->scheme(), "svn+ssh");
    EXPECT_EQ(NSURL::URLWithString("map:")->scheme(), "map");
}

TEST(NSURL, IsNilForWhatIsNone) {
    for (const char* text : {"",
                             "example.org",
                             "/path",
                             ":",
                             "://x",
                             "1a://x",
                             "a_b://x",
                             "http://a b",
                             " http://a",
                             "http://a\n",
                             "http://a\x7f"})
        EXPECT_EQ(NSURL::URLWithString(text), nullptr) << text;
    EXPECT_EQ(NSURL::URLWithString(std::string("http://a\0b", 10)), nullptr);
}

TEST(NSURL, IsEqualToTheSameTextAndHashesLikeIt) {
    const auto a = NSURL::URLWithString("map://x");
    const auto b = NSURL::URLWithString("map://x");
    const auto c = NSURL::URLWithString("map://X");
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
    EXPECT_FALSE(a->isEqual(c.get()));
    EXPECT_FALSE(c->isEqual(a.get()));
    EXPECT_FALSE(a->isEqual(nullptr));
    EXPECT_FALSE(a->isEqual(NSString::string("map://x").get()));
    EXPECT_EQ(a->copy(), a);
}

} // namespace
} // namespace orvo
