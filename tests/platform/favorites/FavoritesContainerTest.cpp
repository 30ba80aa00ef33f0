#include "platform/favorites/FavoritesContainer.h"

#include "platform/favorites/FavoriteLines.h"
#include "platform/favorites/FavoritesStore.h"
#include "platform/favorites/RemoteFavoritesPersister.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"
#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <deque>
#include <future>
#include <mutex>

namespace orvo {
namespace {

using ::testing::ElementsAre;

/// Answers what it was told, then that it cannot be read.
class QueuedPersister final : public virtual FavoritesPersister {
public:
    std::shared_ptr<NSArray> favorites(std::shared_ptr<NSError>* error) const override {
        const std::lock_guard lock(_mutex);
        if (answers.empty()) {
            *error = NSError::errorWithMessage("Test", 1, "the disk is gone");
            return nullptr;
        }
        auto answer = answers.front();
        answers.pop_front();
        return answer;
    }

    mutable std::deque<std::shared_ptr<NSArray>> answers;

private:
    mutable std::mutex _mutex;
};

std::shared_ptr<NSArray> contents(const FavoritesContainer& container) {
    std::promise<std::shared_ptr<NSArray>> answer;
    container.accessContentsUsingConcurrentBlock(
        [&](const std::shared_ptr<NSArray>& favorites) { answer.set_value(favorites); });
    return answer.get_future().get();
}

TEST(FavoritesContainer, NeedsAPersister) {
    EXPECT_THROW((void)FavoritesContainer::initWithPersister(nullptr), NSInvalidArgumentException);
}

TEST(FavoritesContainer, CallsItsBlockOnAWorkerQueueAndNeverInsideTheCall) {
    const auto persister = std::make_shared<QueuedPersister>();
    persister->answers = {NSArray::array()};
    const auto container = FavoritesContainer::initWithPersister(persister);
    std::promise<bool> onWorker;
    std::mutex held;
    {
        // A block that ran inside the call would wait here for ever.
        const std::lock_guard lock(held);
        container->accessContentsUsingConcurrentBlock([&](const std::shared_ptr<NSArray>&) {
            {
                const std::lock_guard inside(held);
            } // given back before the answer: this function's end takes the mutex with it
            onWorker.set_value(DispatchQueue::globalQueue()->isCurrent());
        });
    }
    EXPECT_TRUE(onWorker.get_future().get());
}

TEST(FavoritesContainer, LivesUntilItsBlockRan) {
    const auto persister = std::make_shared<QueuedPersister>();
    const auto array = NSArray::array();
    persister->answers = {array};
    std::promise<std::shared_ptr<NSArray>> answer;
    FavoritesContainer::initWithPersister(persister)->accessContentsUsingConcurrentBlock(
        [&](const std::shared_ptr<NSArray>& favorites) { answer.set_value(favorites); });
    EXPECT_EQ(answer.get_future().get(), array);
}

TEST(FavoritesContainer, AFailedReadGivesWhatWasReadLastAndIsLogged) {
    const testing::LogCapture log;
    const auto persister = std::make_shared<QueuedPersister>();
    const auto array = NSArray::arrayOf<NSString>({NSString::string("a")});
    persister->answers = {array};
    const auto container = FavoritesContainer::initWithPersister(persister);
    EXPECT_EQ(contents(*container), array);
    EXPECT_EQ(container->unreadable(), nullptr);
    EXPECT_EQ(contents(*container), array);
    EXPECT_THAT(log.messages(), ElementsAre("Error Domain=Test Code=1 \"the disk is gone\""));
}

TEST(FavoritesContainer, TellsWhyTheLatestReadFailedUntilOneSucceeds) {
    const testing::LogCapture log;
    const auto persister = std::make_shared<QueuedPersister>();
    const auto container = FavoritesContainer::initWithPersister(persister);
    EXPECT_EQ(container->unreadable(), nullptr);
    (void)contents(*container);
    ASSERT_NE(container->unreadable(), nullptr);
    EXPECT_EQ(container->unreadable()->localizedDescription(), "the disk is gone");
    persister->answers = {NSArray::array()};
    (void)contents(*container);
    EXPECT_EQ(container->unreadable(), nullptr);
}

TEST(FavoritesContainer, WithoutAnyReadThatSucceededThereAreNoFavorites) {
    const testing::LogCapture log;
    const auto container =
        FavoritesContainer::initWithPersister(std::make_shared<QueuedPersister>());
    EXPECT_EQ(contents(*container)->count(), 0U);
}

TEST(FavoritesContainer, ManyReadersWhileAWriterChangesTheStoreSeeWholeLists) {
    const testing::TemporaryProfile profile;
    const auto container = FavoritesContainer::initWithPersister(RemoteFavoritesPersister::init());
    std::vector<std::promise<std::size_t>> counts(40);
    const auto store = FavoritesStore::open(
        FavoritesStore::standardPath(), FavoritesStore::Access::Write, nullptr);
    for (std::uint64_t muid = 1; muid <= counts.size(); ++muid) {
        EXPECT_EQ(store->addLine(*testing::favoriteLine(muid, std::to_string(muid))), nullptr);
        container->accessContentsUsingConcurrentBlock(
            [&count = counts[muid - 1]](const std::shared_ptr<NSArray>& favorites) {
                count.set_value(favorites->count());
            });
    }
    for (std::size_t index = 0; index < counts.size(); ++index)
        EXPECT_GT(counts[index].get_future().get(), index);
}

TEST(RemoteFavoritesPersister, ReadsTheProfileInUseAtEachAccess) {
    const auto persister = RemoteFavoritesPersister::init();
    for (const char* name : {"first", "second"}) {
        const testing::TemporaryProfile profile;
        EXPECT_EQ(persister->favorites(nullptr)->count(), 0U);
        EXPECT_EQ(FavoritesStore::open(
                      FavoritesStore::standardPath(), FavoritesStore::Access::Write, nullptr)
                      ->addLine(*testing::favoriteLine(1, name)),
                  nullptr);
        const auto favorites = persister->favorites(nullptr);
        ASSERT_EQ(favorites->count(), 1U);
        EXPECT_EQ(favorites->objectAtIndex(0)->description(), name);
    }
}

} // namespace
} // namespace orvo
