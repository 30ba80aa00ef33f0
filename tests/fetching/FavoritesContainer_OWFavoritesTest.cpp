#include "fetching/FavoritesContainer_OWFavorites.h"

#include "platform/favorites/FavoritesStore.h"
#include "platform/foundation/RunLoop.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <latch>
#include <thread>
#include <vector>

namespace orvo {
namespace {

using testing::TemporaryProfile;

TEST(DefaultFavoritesContainer, IsOneObjectForAllThreads) {
    constexpr std::size_t threadCount = 8;
    std::vector<std::shared_ptr<FavoritesContainer>> seen(threadCount);
    std::latch start(threadCount);
    std::vector<std::thread> threads;
    threads.reserve(threadCount);
    for (auto& container : seen)
        threads.emplace_back([&] {
            start.arrive_and_wait();
            container = OWFavorites::defaultContainer();
        });
    for (auto& thread : threads)
        thread.join();
    ASSERT_TRUE(seen[0]);
    for (const auto& container : seen)
        EXPECT_EQ(container, seen[0]);
    EXPECT_EQ(OWFavorites::defaultContainer(), seen[0]);
}

TEST(DefaultFavoritesContainer, IsNeverReleased) {
    const std::weak_ptr<FavoritesContainer> watch = OWFavorites::defaultContainer();
    EXPECT_FALSE(watch.expired());
}

TEST(DefaultFavoritesContainer, ReadsTheFavoritesOfTheProfile) {
    (void)RunLoop::main();
    const TemporaryProfile profile;
    std::shared_ptr<NSError> error;
    const auto store =
        FavoritesStore::open(FavoritesStore::standardPath(), FavoritesStore::Access::Write, &error);
    ASSERT_TRUE(store) << descriptionOf(error);
    const auto place = FavoritePlace::initWithName_latitude_longitude("Home", 51.5, -0.1);
    ASSERT_EQ(store->addPlace(*place), nullptr);

    std::latch done(1);
    std::shared_ptr<NSArray> read;
    OWFavorites::defaultContainer()->accessContentsUsingConcurrentBlock(
        [&](const std::shared_ptr<NSArray>& favorites) {
            read = favorites;
            done.count_down();
        });
    done.wait();
    EXPECT_TRUE(equal(read, NSArray::arrayOf({place})));
}

} // namespace
} // namespace orvo
