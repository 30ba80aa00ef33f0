#include "platform/geoservices/MapItemIdentifier.h"

#include "platform/geoservices/TransitSystemRecord.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

constexpr std::uint64_t Largest = 18446744073709551615U;

TEST(MapItemIdentifier, IsEqualByItsNumberAlone) {
    const auto one = MapItemIdentifier::identifierWithMuid(7);
    const auto same = MapItemIdentifier::identifierWithMuid(7);
    EXPECT_TRUE(one->isEqual(same.get()));
    EXPECT_EQ(one->hash(), same->hash());
    EXPECT_FALSE(one->isEqual(MapItemIdentifier::identifierWithMuid(8).get()));
    EXPECT_FALSE(one->isEqual(TransitSystemRecord::initWithFields({}).get()));
    EXPECT_FALSE(one->isEqual(nullptr));
}

TEST(MapItemIdentifier, KeepsEveryNumberWhole) {
    const auto largest = MapItemIdentifier::identifierWithMuid(Largest);
    EXPECT_EQ(largest->muid(), Largest);
    EXPECT_EQ(largest->description(), "18446744073709551615");
    EXPECT_TRUE(largest->isEqual(largest->copy().get()));
}

} // namespace
} // namespace orvo
