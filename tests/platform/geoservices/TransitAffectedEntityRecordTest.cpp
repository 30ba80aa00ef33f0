#include "platform/geoservices/TransitAffectedEntityRecord.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(TransitAffectedEntityRecord, TellsNoStopsFromStopsThatAreNotTold) {
    const auto whole = TransitAffectedEntityRecord::initWithFields({.muid = 7});
    EXPECT_EQ(whole->muid(), 7U);
    EXPECT_FALSE(whole->hasNextStopIDs());
    EXPECT_EQ(whole->nextStopIDs(), nullptr);
    const auto untold =
        TransitAffectedEntityRecord::initWithFields({.muid = 7, .hasNextStopIDs = true});
    EXPECT_TRUE(untold->hasNextStopIDs());
    EXPECT_EQ(untold->nextStopIDs(), nullptr);
}

} // namespace
} // namespace orvo
