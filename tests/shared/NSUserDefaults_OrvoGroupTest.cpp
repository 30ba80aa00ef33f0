#include "shared/NSUserDefaults_OrvoGroup.h"

#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace orvo {
namespace {

using OrvoGroup::__orvo_groupUserDefaults;
using testing::TemporaryProfile;

TEST(GroupUserDefaults, AreTheAppGroupsSuite) {
    const TemporaryProfile profile;
    EXPECT_EQ(__orvo_groupUserDefaults()->suiteName(), "group.com.zentu.Orvo");
    EXPECT_EQ(__orvo_groupUserDefaults()->setBool_forKey(true, "key"), nullptr);
    EXPECT_TRUE(std::filesystem::exists(profile.path() / "data" / "group.com.zentu.Orvo.plist"));
}

TEST(GroupUserDefaults, AreANewObjectEachTimeWithTheSameContent) {
    const TemporaryProfile profile;
    const auto first = __orvo_groupUserDefaults();
    const auto second = __orvo_groupUserDefaults();
    EXPECT_NE(first, second);
    first->setBool_forKey(true, "key");
    EXPECT_TRUE(second->boolForKey("key"));
    EXPECT_TRUE(__orvo_groupUserDefaults()->boolForKey("key"));
}

} // namespace
} // namespace orvo
