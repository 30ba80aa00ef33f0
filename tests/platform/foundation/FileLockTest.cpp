#include "platform/foundation/FileLock.h"

#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

namespace orvo::FileLockTests {
namespace {

TEST(FileLock, LetsOneThreadInAtATime) {
    const testing::TemporaryFolder folder;
    const auto path = folder.path() / "lock";
    std::atomic<int> inside = 0;
    std::atomic<int> entries = 0;
    std::atomic<bool> together = false;
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([&] {
            for (int j = 0; j < 50; ++j) {
                const auto lock = FileLock::acquire(path, nullptr);
                if (++inside != 1)
                    together = true;
                ++entries;
                for (int k = 0; k < 20; ++k) // time for another to come in
                    std::this_thread::yield();
                --inside;
            }
        });
    for (auto& thread : threads)
        thread.join();
    EXPECT_FALSE(together);
    EXPECT_EQ(entries, 200);
}

TEST(FileLock, EndsWithItsObject) {
    const testing::TemporaryFolder folder;
    for (int i = 0; i < 3; ++i) // would wait without an end
        EXPECT_TRUE(FileLock::acquire(folder.path() / "lock", nullptr));
}

} // namespace
} // namespace orvo::FileLockTests
