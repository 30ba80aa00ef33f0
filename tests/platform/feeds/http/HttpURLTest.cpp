#include "platform/feeds/http/HttpURL.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(HttpURL, SchemesAreToldByTheirForm) {
    EXPECT_EQ(HttpURL::scheme("svn+ssh://x"), "svn+ssh");
    EXPECT_EQ(HttpURL::scheme("://x"), "");
    EXPECT_EQ(HttpURL::scheme("a b://x"), "");
    EXPECT_EQ(HttpURL::scheme("/tmp/x"), "");
    EXPECT_TRUE(HttpURL::hasHttpScheme("HtTp://x"));
    EXPECT_FALSE(HttpURL::hasHttpScheme("http:/x"));
}

TEST(HttpURL, NormalizedIsWhatIsSent) {
    EXPECT_EQ(HttpURL::normalized("HTTP://Example.ORG/a b?c=ä#d"),
              "http://example.org/a%20b?c=%C3%A4");
    EXPECT_EQ(HttpURL::normalized("https://münchen.example/"), "https://xn--mnchen-3ya.example/");
    EXPECT_EQ(HttpURL::normalized("http://[::1]:8080/"), "http://[::1]:8080/");
    EXPECT_EQ(HttpURL::normalized("ftp://example.org/"), std::nullopt);
    EXPECT_EQ(HttpURL::normalized("http:///path"), std::nullopt);
    EXPECT_EQ(HttpURL::normalized("http://example.org:99999/"), std::nullopt);
}

TEST(HttpURL, ResolvesWhatALocationNames) {
    const auto* base = "https://example.org/a/b?c";
    EXPECT_EQ(HttpURL::resolved(base, "d"), "https://example.org/a/d");
    EXPECT_EQ(HttpURL::resolved(base, "/d?e=f"), "https://example.org/d?e=f");
    EXPECT_EQ(HttpURL::resolved(base, "//other.org/d"), "https://other.org/d");
    EXPECT_EQ(HttpURL::resolved(base, "http://other.org/"), "http://other.org/");
    EXPECT_EQ(HttpURL::resolved(base, ""), std::nullopt);
    EXPECT_EQ(HttpURL::resolved(base, "file:///etc/passwd"), std::nullopt);
    EXPECT_EQ(HttpURL::resolved(base, "javascript:alert(1)"), std::nullopt);
}

TEST(HttpURL, SameServerIsHostAndPortOrTheWayToTLS) {
    EXPECT_TRUE(HttpURL::isSameServer("http://a.org/x", "http://A.org:80/y"));
    EXPECT_TRUE(HttpURL::isSameServer("http://a.org/x", "https://a.org/y"));
    EXPECT_FALSE(HttpURL::isSameServer("https://a.org/x", "http://a.org/y"));
    EXPECT_FALSE(HttpURL::isSameServer("http://a.org/x", "http://a.org:81/y"));
    EXPECT_FALSE(HttpURL::isSameServer("http://a.org:81/x", "https://a.org/y"));
    EXPECT_FALSE(HttpURL::isSameServer("https://a.org/x", "https://b.a.org/y"));
}

TEST(HttpURL, QueryIsAddedWhereverOneStands) {
    EXPECT_EQ(HttpURL::withQuery("http://a.org/", {}), "http://a.org/");
    EXPECT_EQ(HttpURL::withQuery("http://a.org/", {{"k y", "a&b=ä"}, {"z", ""}}),
              "http://a.org/?k%20y=a%26b%3D%C3%A4&z=");
    EXPECT_EQ(HttpURL::withQuery("http://a.org/?x=1", {{"k", "1"}}), "http://a.org/?x=1&k=1");
    EXPECT_EQ(HttpURL::withQuery("http://a.org/?", {{"k", "1"}}), "http://a.org/?k=1");
    EXPECT_EQ(HttpURL::withQuery("http://a.org/?x&", {{"k", "1"}}), "http://a.org/?x&k=1");
}

TEST(HttpURL, PercentCodingGoesBothWays) {
    EXPECT_EQ(HttpURL::percentEncoded("aZ09-._~ /+"), "aZ09-._~%20%2F%2B");
    EXPECT_EQ(HttpURL::percentDecoded("a%20b+%C3%A4%zz"), "a b+ä%zz");
    EXPECT_EQ(HttpURL::percentDecoded("%41%4"), "A%4");
    EXPECT_EQ(HttpURL::percentDecoded("%-1%"), "%-1%");
    EXPECT_EQ(HttpURL::base64("me:hidden"), "bWU6aGlkZGVu");
}

} // namespace
} // namespace orvo
