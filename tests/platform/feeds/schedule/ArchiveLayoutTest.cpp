#include "platform/feeds/schedule/ArchiveLayout.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

struct Found {
    std::optional<ArchiveLayout> layout;
    std::string error;
};

Found find(const std::vector<std::string>& paths) {
    std::vector<ArchiveEntry> entries;
    for (const auto& path : paths)
        entries.push_back({path, entries.size(), 0});
    std::shared_ptr<NSError> error;
    Found found{ArchiveLayout::find(std::move(entries), "city.zip", error), {}};
    if (error)
        found.error = error->localizedDescription();
    return found;
}

TEST(ArchiveLayout, FindsTheScheduleAtTheTopOrInOneEnclosingFolder) {
    for (const std::string folder : {"", "feed/", "./", "./feed/", "feed\\"}) {
        const Found found = find({"readme.md", folder + "routes.txt", folder + "Stops.TXT"});
        ASSERT_TRUE(found.layout) << folder << found.error;
        EXPECT_EQ(found.layout->entry("routes.txt")->number, 1U);
        EXPECT_EQ(found.layout->entry("stops.txt")->number, 2U);
        EXPECT_EQ(found.layout->entry("trips.txt"), nullptr);
    }
}

TEST(ArchiveLayout, RefusesAScheduleTwoFoldersDeep) {
    EXPECT_EQ(find({"feed/2024/routes.txt", "feed/2024/stops.txt"}).error,
              "city.zip: its schedule lies too deep, in feed/2024/; only one enclosing folder is "
              "looked into");
    EXPECT_FALSE(find({"a\\b\\routes.txt"}).layout);
    EXPECT_FALSE(find({"./a/b/c/routes.txt"}).layout);
}

TEST(ArchiveLayout, FilesOfOtherFoldersDoNotBelongToTheSchedule) {
    const Found found = find({"feed/routes.txt", "feed/more/stops.txt", "stops.txt"});
    ASSERT_TRUE(found.layout);
    EXPECT_EQ(found.layout->entry("stops.txt"), nullptr);
}

TEST(ArchiveLayout, PassesOverWhatSystemsPutBeside) {
    const Found found = find({"__MACOSX/feed/routes.txt",
                              "feed/._routes.txt",
                              "feed/.old/routes.txt",
                              ".git/routes.txt",
                              "feed/",
                              "feed/routes.txt"});
    ASSERT_TRUE(found.layout) << found.error;
    EXPECT_EQ(found.layout->entry("routes.txt")->number, 5U);
}

TEST(ArchiveLayout, RefusesTwoSchedules) {
    EXPECT_EQ(find({"a/routes.txt", "b/routes.txt"}).error,
              "city.zip: holds more than one schedule, in a/ and in b/; add each on its own");
    EXPECT_EQ(find({"routes.txt", "old/routes.txt"}).error,
              "city.zip: holds more than one schedule, at its top and in old/; add each on its "
              "own");
}

TEST(ArchiveLayout, RefusesOneFileTwiceInOnePlace) {
    EXPECT_EQ(find({"routes.txt", "stops.txt", "Stops.txt"}).error,
              "city.zip: holds stops.txt twice in one place");
    EXPECT_EQ(find({"routes.txt", "routes.txt"}).error,
              "city.zip: holds routes.txt twice in one place");
}

TEST(ArchiveLayout, RefusesWhatHoldsNoRoutes) {
    EXPECT_EQ(find({"agency.txt"}).error, "city.zip: holds no routes.txt, so it is no schedule");
    EXPECT_EQ(
        find({"feed/", "feed/inner.zip"}).error,
        "city.zip: holds no routes.txt but another archive, feed/inner.zip; take that out and "
        "add it");
    EXPECT_EQ(find({"a/routes.txt/"}).error, "city.zip: holds no routes.txt, so it is no schedule");
}

TEST(ArchiveLayout, NamesInMessagesCannotSteerATerminal) {
    EXPECT_EQ(find({"\x1B[2J.zip"}).error,
              "city.zip: holds no routes.txt but another archive, [2J.zip; take that out and add "
              "it");
}

} // namespace
} // namespace orvo
