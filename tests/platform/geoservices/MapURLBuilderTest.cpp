#include "platform/geoservices/MapURLBuilder.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(MapURLBuilder, NamesTheFavouritesTypeAndTheMapType) {
    const auto builder = MapURLBuilder::URLForShowingFavoritesWithType(2);
    EXPECT_EQ(builder->build()->absoluteString(), "orvo://?favorites=2");
    builder->setMapType(3);
    EXPECT_EQ(builder->build()->absoluteString(), "orvo://?favorites=2&t=r");
    builder->setMapType(7);
    EXPECT_EQ(builder->build()->absoluteString(), "orvo://?favorites=2&t=7");
}

} // namespace
} // namespace orvo
