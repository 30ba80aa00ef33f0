#include "platform/foundation/EditDistance.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

/// The same both ways.
std::size_t distance(std::u16string_view a, std::u16string_view b) {
    EXPECT_EQ(editDistance(a, b), editDistance(b, a));
    return editDistance(a, b);
}

TEST(EditDistance, CountsWhatWasLeftOutAddedChangedAndSwapped) {
    EXPECT_EQ(distance(u"harbour", u"harbour"), 0U);
    EXPECT_EQ(distance(u"harbour", u"harbor"), 1U);
    EXPECT_EQ(distance(u"harbour", u"harbaur"), 1U);
    EXPECT_EQ(distance(u"harbour", u"habrour"), 1U);
    EXPECT_EQ(distance(u"harbour", u"arbuor"), 2U);
    EXPECT_EQ(distance(u"abc", u"xyz"), 3U);
}

TEST(EditDistance, ToNothingIsTheLength) {
    EXPECT_EQ(distance(u"", u""), 0U);
    EXPECT_EQ(distance(u"", u"quay"), 4U);
}

TEST(EditDistance, ASwapAtEitherEndIsOne) {
    EXPECT_EQ(distance(u"ab", u"ba"), 1U);
    EXPECT_EQ(distance(u"quay", u"uqay"), 1U);
    EXPECT_EQ(distance(u"quay", u"quya"), 1U);
}

} // namespace
} // namespace orvo
