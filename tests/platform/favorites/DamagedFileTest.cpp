#include "platform/favorites/DamagedFile.h"

#include "platform/foundation/Environment.h"
#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fstream>

namespace orvo {
namespace {

using ::testing::IsEmpty;
namespace fs = std::filesystem;

class DamagedFileTest : public ::testing::Test {
protected:
    void write(const std::string& suffix) const { std::ofstream(path.string() + suffix) << "x"; }
    bool exists(const std::string& suffix) const { return fs::exists(path.string() + suffix); }

    testing::TemporaryFolder folder;
    testing::LogCapture log;
    fs::path path = folder.path() / "store.sqlite";
};

TEST_F(DamagedFileTest, TakesItsJournalAlong) {
    for (const char* suffix : {"", "-wal", "-shm"})
        write(suffix);
    EXPECT_TRUE(DamagedFile(path).setAside("bad"));
    for (const char* suffix : {"", "-wal", "-shm"}) {
        EXPECT_FALSE(exists(suffix)) << suffix;
        EXPECT_TRUE(exists(std::string(".damaged-1") + suffix)) << suffix;
    }
}

TEST_F(DamagedFileTest, AFileThatAnotherProcessPutInItsPlaceIsLeftAlone) {
    write("");
    const DamagedFile damaged(path);
    write(".new");
    fs::rename(path.string() + ".new", path);
    EXPECT_TRUE(damaged.setAside("bad"));
    EXPECT_TRUE(exists(""));
    EXPECT_FALSE(exists(".damaged-1"));
    EXPECT_THAT(log.messages(), IsEmpty());
}

TEST_F(DamagedFileTest, AFileThatCannotBeSetAsideIsSaidInTheLog) {
    path = folder.path() / "gone" / "store.sqlite";
    EXPECT_FALSE(DamagedFile(path).setAside("bad"));
    EXPECT_EQ(log.messages().size(), 1U);
}

} // namespace
} // namespace orvo
