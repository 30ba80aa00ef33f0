#include "platform/foundation/MemoryPressureFile.h"

#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <string>

namespace orvo::MemoryPressureFileTests {
namespace {

using testing::TemporaryFolder;

constexpr std::string_view Events = "low 1\nhigh 2\nmax 3\noom 4\noom_kill 5\noom_group_kill 6\n";

void write(const std::filesystem::path& path, std::string_view text) {
    std::ofstream(path) << text;
}

std::string read(const std::filesystem::path& path) {
    std::ifstream file(path);
    return {std::istreambuf_iterator<char>(file), {}};
}

/// Files of the test's own in place of the kernel's.
class MemoryPressureFileTest : public ::testing::Test {
protected:
    TemporaryFolder folder;
    std::filesystem::path pressure = folder.path() / "memory";
    std::filesystem::path events = folder.path() / "memory.events";

private:
    EnvironmentSlot<MemoryPressureFile::Places>::Override _places =
        MemoryPressureFile::places().overrideWith({pressure, folder.path()});
};

TEST_F(MemoryPressureFileTest, AWarningIsASoftLimitAndCriticalAHardOne) {
    EXPECT_EQ(MemoryPressureFile::eventCount(Events, MemoryPressure::ProcessLimitWarning), 2U);
    EXPECT_EQ(MemoryPressureFile::eventCount(Events, MemoryPressure::ProcessLimitCritical), 7U);
}

TEST_F(MemoryPressureFileTest, WhatAGroupDoesNotTellCountsNothing) {
    for (const std::string_view text : {"", "\n\n", "high", "high x", "highest 9\nlow 1"})
        EXPECT_EQ(MemoryPressureFile::eventCount(text, MemoryPressure::ProcessLimitWarning), 0U)
            << text;
    EXPECT_EQ(MemoryPressureFile::eventCount(Events, MemoryPressure::Warning), 0U);
}

TEST_F(MemoryPressureFileTest, TheGroupIsThatOfTheUnifiedHierarchy) {
    EXPECT_EQ(MemoryPressureFile::controlGroupFolder("/g", "9:memory:/old\n0::/user.slice/a\n"),
              "/g/user.slice/a");
    EXPECT_EQ(MemoryPressureFile::controlGroupFolder("/g", "9:memory:/old\n"), "");
    EXPECT_EQ(MemoryPressureFile::controlGroupFolder("/g", ""), "");
}

TEST_F(MemoryPressureFileTest, EachDegreeOfTheMachineSetsItsOwnTrigger) {
    write(pressure, "");
    ASSERT_TRUE(MemoryPressureFile::open(MemoryPressure::Warning));
    EXPECT_EQ(read(pressure), std::string("some 150000 2000000") + '\0');
    ASSERT_TRUE(MemoryPressureFile::open(MemoryPressure::Critical));
    EXPECT_EQ(read(pressure), std::string("full 100000 2000000") + '\0');
}

TEST_F(MemoryPressureFileTest, OnlyACountThatHasGrownHasHappened) {
    write(events, "high 2\nmax 3\noom 4\n");
    const auto warning = MemoryPressureFile::open(MemoryPressure::ProcessLimitWarning);
    ASSERT_TRUE(warning);
    EXPECT_FALSE(warning->hasHappened());
    write(events, "high 2\nmax 9\noom 4\n");
    EXPECT_FALSE(warning->hasHappened());
    write(events, "high 3\nmax 9\noom 4\n");
    EXPECT_TRUE(warning->hasHappened());
    EXPECT_FALSE(warning->hasHappened());
}

TEST_F(MemoryPressureFileTest, AKernelWithoutTheFilesHasNone) {
    for (const auto degree : {MemoryPressure::Warning,
                              MemoryPressure::Critical,
                              MemoryPressure::ProcessLimitWarning,
                              MemoryPressure::ProcessLimitCritical})
        EXPECT_FALSE(MemoryPressureFile::open(degree));
}

TEST(MemoryPressureFile, ThisKernelTakesTheTriggersThatAreSet) {
    if (!std::filesystem::exists("/proc/pressure/memory"))
        GTEST_SKIP() << "no /proc/pressure";
    EXPECT_TRUE(MemoryPressureFile::open(MemoryPressure::Warning));
    EXPECT_TRUE(MemoryPressureFile::open(MemoryPressure::Critical));
}

} // namespace
} // namespace orvo::MemoryPressureFileTests
