#include "platform/favorites/FavoriteLines.h"
#include "platform/favorites/FavoriteTransitLine.h"
#include "platform/favorites/FavoritesStore.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <csignal>
#include <sys/wait.h>
#include <unistd.h>

namespace orvo {
namespace {

/// A process that adds lines, moving each to the front, and says through a pipe when each stands.
class WriterProcess {
public:
    WriterProcess(const std::filesystem::path& path, std::uint64_t first) {
        EXPECT_EQ(::pipe(_pipe), 0);
        _process = ::fork();
        if (_process == 0)
            write(path, first);
        ::close(_pipe[1]);
    }
    WriterProcess(const WriterProcess&) = delete;
    WriterProcess& operator=(const WriterProcess&) = delete;
    ~WriterProcess() { ::close(_pipe[0]); }

    /// Ends the process without warning once it has told of `count` lines. How many it told of in
    /// all.
    std::uint64_t killAfter(std::uint64_t count) {
        std::uint64_t told = 0;
        char byte = 0;
        while (told < count && ::read(_pipe[0], &byte, 1) == 1)
            ++told;
        ::kill(_process, SIGKILL);
        while (::read(_pipe[0], &byte, 1) == 1)
            ++told;
        int status = 0;
        ::waitpid(_process, &status, 0);
        EXPECT_TRUE(WIFSIGNALED(status));
        return told;
    }

private:
    [[noreturn]] void write(const std::filesystem::path& path, std::uint64_t first) const {
        const auto store = FavoritesStore::open(path, FavoritesStore::Access::Write, nullptr);
        for (std::uint64_t muid = first; store; ++muid) {
            if (store->addLine(*testing::favoriteLine(muid, std::to_string(muid))))
                break;
            const auto entries = store->entries(nullptr);
            if (store->move(entries.back().number, 0) || ::write(_pipe[1], "+", 1) != 1)
                break;
        }
        ::_exit(1);
    }

    int _pipe[2]{};
    pid_t _process = 0;
};

std::vector<std::uint64_t> linesIn(const std::filesystem::path& path) {
    std::shared_ptr<NSError> error;
    const auto store = FavoritesStore::open(path, FavoritesStore::Access::Write, &error);
    EXPECT_EQ(descriptionOf(error), "(null)");
    std::vector<std::uint64_t> lines;
    for (const auto& favorite : typed<FavoriteTransitLine>(store->favorites(&error)))
        lines.push_back(favorite->transitLine()->muid());
    EXPECT_EQ(descriptionOf(error), "(null)");
    return lines;
}

TEST(FavoritesStoreKill, AWriterKilledAtAnyMomentLosesNothingThatStood) {
    const testing::TemporaryFolder folder;
    const auto path = folder.path() / "favorites.sqlite";
    std::uint64_t standing = 0; // lines 1 to this, the newest first
    for (std::uint64_t round = 0; round < 20; ++round) {
        WriterProcess writer(path, standing + 1);
        standing += writer.killAfter(round % 5);
        auto lines = linesIn(path);
        // One more may have been added, and even moved, when the end came.
        if (lines.size() > standing) {
            ASSERT_EQ(lines.size(), standing + 1);
            const auto unannounced = std::ranges::find(lines, standing + 1);
            ASSERT_NE(unannounced, lines.end());
            std::rotate(lines.begin(), unannounced, unannounced + 1);
            ++standing;
        }
        // Whether it was moved or not, from now on it is in its place.
        const auto store = FavoritesStore::open(path, FavoritesStore::Access::Write, nullptr);
        for (const auto& entry : store->entries(nullptr)) {
            const auto favorite = std::dynamic_pointer_cast<FavoriteTransitLine>(entry.favorite);
            if (favorite->transitLine()->muid() == standing) {
                EXPECT_EQ(store->move(entry.number, 0), nullptr);
            }
        }
        ASSERT_EQ(lines.size(), standing);
        for (std::uint64_t index = 0; index < standing; ++index)
            ASSERT_EQ(lines[index], standing - index);
    }
    EXPECT_GT(standing, 30U);
}

} // namespace
} // namespace orvo
