// What several processes may do to one store at once, and what a killed one leaves.
#include "TestSchedules.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/foundation/Text.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <functional>
#include <random>
#include <sys/time.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace orvo {
namespace {

constexpr int LineCount = 1500;

/// A schedule whose lines all carry the edition's number.
std::shared_ptr<NSData> edition(int number) {
    std::string routes = "route_id,route_short_name,route_type\n";
    for (int line = 0; line < LineCount; ++line)
        routes += "R" + std::to_string(line) + "," + std::to_string(number) + ",3\n";
    return testing::zipOf({{"routes.txt", routes}});
}

/// Runs in a process of its own, which ends without cleaning up.
pid_t inChild(const std::function<bool()>& work) {
    const pid_t child = fork();
    if (child == 0)
        _exit(work() ? 0 : 1);
    return child;
}

int statusOf(pid_t child) {
    int status = 0;
    waitpid(child, &status, 0);
    return status;
}

class ScheduleStoreProcessTest : public ::testing::Test {
protected:
    bool import(const std::shared_ptr<NSData>& zip) const {
        const auto store = ScheduleStore::open(path, nullptr);
        return store && !store->importSchedule(
                            "city", ScheduleSource::fromBytes(zip, "city.zip"), {}, nullptr);
    }
    /// The edition that all lines are of; -1 when they differ or some are missing.
    static int wholeEdition(const ScheduleStore& store) {
        const auto lines = store.lines("city");
        if (lines.size() != LineCount)
            return -1;
        for (const auto& line : lines)
            if (line.shortName != lines.front().shortName)
                return -1;
        return std::stoi(lines.front().shortName);
    }

    testing::TemporaryFolder folder;
    std::filesystem::path path = folder.path() / "schedules.sqlite";
};

TEST_F(ScheduleStoreProcessTest, AKilledImportLeavesTheEarlierScheduleOrTheNewOne) {
    const auto first = edition(1);
    ASSERT_TRUE(import(first));
    const auto begin = std::chrono::steady_clock::now();
    ASSERT_TRUE(import(first));
    const auto whole = std::chrono::duration_cast<std::chrono::microseconds>(
        std::chrono::steady_clock::now() - begin);
    std::mt19937 random(42); // the moments differ from run to run all the same
    int killed = 0;
    for (int round = 2; round < 27; ++round) {
        const auto zip = edition(round);
        const int before = wholeEdition(*ScheduleStore::open(path, nullptr));
        ASSERT_NE(before, -1);
        std::uniform_int_distribution<long> moment(1, std::max(2L, whole.count()));
        const pid_t child = inChild([&, microseconds = moment(random)] {
            // Nothing handles this alarm, so the process ends on the spot.
            const itimerval alarm{{0, 0}, {microseconds / 1'000'000, microseconds % 1'000'000}};
            setitimer(ITIMER_REAL, &alarm, nullptr);
            return import(zip);
        });
        killed += WIFSIGNALED(statusOf(child)) ? 1 : 0;
        const auto store = ScheduleStore::open(path, nullptr);
        ASSERT_TRUE(store) << round;
        const int after = wholeEdition(*store);
        EXPECT_TRUE(after == before || after == round) << before << " " << after;
    }
    EXPECT_GT(killed, 0);
    EXPECT_TRUE(import(first));
}

TEST_F(ScheduleStoreProcessTest, ReadersSeeWholeSchedulesWhileOthersImport) {
    ASSERT_TRUE(import(edition(0)));
    std::vector<pid_t> children;
    for (int writer = 1; writer <= 2; ++writer)
        children.push_back(inChild([&, writer] {
            const auto zip = edition(writer);
            for (int round = 0; round < 5; ++round)
                if (!import(zip))
                    return false;
            return true;
        }));
    const auto store = ScheduleStore::open(path, nullptr);
    ASSERT_TRUE(store);
    std::size_t running = children.size();
    while (running > 0) {
        EXPECT_NE(wholeEdition(*store), -1);
        int status = 0;
        while (running > 0 && waitpid(-1, &status, WNOHANG) > 0) {
            EXPECT_EQ(status, 0);
            --running;
        }
    }
    EXPECT_NE(wholeEdition(*store), -1);
}

TEST_F(ScheduleStoreProcessTest, ManyMayMakeTheStoreAtOnce) {
    for (int round = 0; round < 5; ++round) {
        std::vector<pid_t> children;
        for (int count = 0; count < 8; ++count)
            children.push_back(
                inChild([&] { return ScheduleStore::open(path, nullptr) != nullptr; }));
        for (const pid_t child : children)
            EXPECT_EQ(statusOf(child), 0);
        std::filesystem::remove_all(folder.path());
        std::filesystem::create_directories(folder.path());
    }
}

TEST_F(ScheduleStoreProcessTest, ThreadsOfOneProcessShareAStore) {
    ASSERT_TRUE(import(edition(0)));
    const auto store = ScheduleStore::open(path, nullptr);
    std::vector<std::thread> threads;
    for (int count = 0; count < 3; ++count)
        threads.emplace_back([&] {
            for (int round = 0; round < 5; ++round) {
                EXPECT_NE(wholeEdition(*store), -1);
                EXPECT_TRUE(store->lineIndex("city"));
            }
        });
    EXPECT_FALSE(store->importSchedule(
        "city", ScheduleSource::fromBytes(edition(1), "city.zip"), {}, nullptr));
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(wholeEdition(*store), 1);
}

} // namespace
} // namespace orvo
