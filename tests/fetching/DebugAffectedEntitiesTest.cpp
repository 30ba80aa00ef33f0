#include "fetching/DebugAffectedEntities.h"

#include <gtest/gtest.h>

#include <limits>

namespace orvo {
namespace {

TEST(DebugAffectedEntities, AreAWholeLine) {
    constexpr std::uint64_t muid = std::numeric_limits<std::uint64_t>::max();
    const auto entities = DebugAffectedEntities::initWithMuid(muid);
    const TransitIncidentAffectedEntity& record = *entities;
    EXPECT_EQ(record.muid(), muid);
    EXPECT_FALSE(record.hasNextStopIDs());
    EXPECT_EQ(record.nextStopIDs(), nullptr);
}

} // namespace
} // namespace orvo
