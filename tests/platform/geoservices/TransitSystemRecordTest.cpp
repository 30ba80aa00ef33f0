#include "platform/geoservices/TransitSystemRecord.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(TransitSystemRecord, TellsNoNameFromAnEmptyOne) {
    EXPECT_EQ(TransitSystemRecord::initWithFields({})->name(), std::nullopt);
    EXPECT_EQ(TransitSystemRecord::initWithFields({.name = ""})->name(), "");
}

TEST(TransitSystemRecord, GivesTheVeryArtworkThatItWasMadeWith) {
    const auto artwork = TransitArtworkDataSource::initWithFields({});
    EXPECT_EQ(TransitSystemRecord::initWithFields({.artwork = artwork})->artwork(), artwork);
}

} // namespace
} // namespace orvo
