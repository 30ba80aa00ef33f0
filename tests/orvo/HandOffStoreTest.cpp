#include "orvo/HandOffStore.h"

#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <fstream>

namespace orvo {
namespace {

class HandOffStoreTest : public ::testing::Test {
protected:
    std::filesystem::path file() const { return profile.path() / "state" / "hand-off.plist"; }

    testing::StoppedClock clock{1750000000};
    testing::TemporaryProfile profile;
};

TEST_F(HandOffStoreTest, KeepsTheLastWithItsTime) {
    EXPECT_FALSE(HandOffStore::keep(HandOff::ofURL("orvo://?t=r")));
    EXPECT_FALSE(HandOffStore::keep(HandOff::ofActivity(NSData::dataWithString("bytes"))));
    std::shared_ptr<NSError> error;
    const auto kept = HandOffStore::last(&error);
    ASSERT_TRUE(kept);
    EXPECT_FALSE(error);
    EXPECT_FALSE(kept->handOff.url());
    EXPECT_EQ(kept->handOff.activity()->stringView(), "bytes");
    EXPECT_EQ(kept->receivedAt, 1750000000);
}

TEST_F(HandOffStoreTest, AURLStaysAURL) {
    EXPECT_FALSE(HandOffStore::keep(HandOff::ofURL("orvo://?t=r")));
    const auto kept = HandOffStore::last(nullptr);
    ASSERT_TRUE(kept);
    EXPECT_EQ(kept->handOff.url(), "orvo://?t=r");
    EXPECT_FALSE(kept->handOff.activity());
}

TEST_F(HandOffStoreTest, OnlyItsOwnerCanReadIt) {
    EXPECT_FALSE(HandOffStore::keep(HandOff::ofURL("orvo://?t=r")));
    EXPECT_EQ(std::filesystem::status(file()).permissions(),
              std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
}

TEST_F(HandOffStoreTest, NothingHandedOverIsNoError) {
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(HandOffStore::last(&error));
    EXPECT_FALSE(error);
    EXPECT_FALSE(std::filesystem::exists(file()));
}

TEST_F(HandOffStoreTest, ADamagedFileIsAnErrorThatNamesIt) {
    std::filesystem::create_directories(file().parent_path());
    for (const char* content : {"", "junk", "bplist00"}) {
        std::ofstream(file(), std::ios::binary) << content;
        std::shared_ptr<NSError> error;
        EXPECT_FALSE(HandOffStore::last(&error));
        ASSERT_TRUE(error) << content;
        EXPECT_NE(error->localizedDescription().find(file().string()), std::string::npos);
    }
    EXPECT_FALSE(HandOffStore::keep(HandOff::ofURL("orvo://?t=r")));
    EXPECT_TRUE(HandOffStore::last(nullptr));
}

TEST_F(HandOffStoreTest, AFolderThatCannotBeMadeIsAnError) {
    std::ofstream(profile.path() / "state") << "in the way";
    const auto error = HandOffStore::keep(HandOff::ofURL("orvo://?t=r"));
    ASSERT_TRUE(error);
    EXPECT_NE(error->localizedDescription().find("state"), std::string::npos);
}

TEST_F(HandOffStoreTest, NothingIsWrittenWhereWritesStayInMemory) {
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    EXPECT_FALSE(HandOffStore::keep(HandOff::ofURL("orvo://?t=r")));
    EXPECT_FALSE(std::filesystem::exists(file()));
}

} // namespace
} // namespace orvo
