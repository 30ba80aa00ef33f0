#include "platform/foundation/EnvironmentSlot.h"

#include <gtest/gtest.h>

#include <memory>
#include <thread>
#include <vector>

namespace orvo {
namespace {

TEST(EnvironmentSlot, MakesItsDefaultOnFirstUseAndOnce) {
    int made = 0;
    EnvironmentSlot<int> slot([&] { return ++made; });
    EXPECT_EQ(made, 0);
    EXPECT_EQ(slot.get(), 1);
    EXPECT_EQ(slot.get(), 1);
}

TEST(EnvironmentSlot, PutsTheEarlierValueBackAtTheEndOfAnOverride) {
    EnvironmentSlot<int> slot([] { return 1; });
    {
        const auto outer = slot.overrideWith(2);
        {
            const auto inner = slot.overrideWith(3);
            EXPECT_EQ(slot.get(), 3);
        }
        EXPECT_EQ(slot.get(), 2);
    }
    EXPECT_EQ(slot.get(), 1);
}

TEST(EnvironmentSlot, MakesNoDefaultWhileAnOverrideHolds) {
    int made = 0;
    EnvironmentSlot<int> slot([&] { return ++made; });
    {
        const auto scope = slot.overrideWith(5);
        EXPECT_EQ(slot.get(), 5);
    }
    EXPECT_EQ(made, 0);
    EXPECT_EQ(slot.get(), 1);
}

TEST(EnvironmentSlot, HoldsAnOverrideAsLongAsItsMovedScope) {
    EnvironmentSlot<int> slot([] { return 1; });
    {
        auto first = slot.overrideWith(2);
        {
            const auto second = std::move(first);
            EXPECT_EQ(slot.get(), 2);
        }
        EXPECT_EQ(slot.get(), 1);
    }
    EXPECT_EQ(slot.get(), 1);
}

TEST(EnvironmentSlot, KeepsWhatIsSet) {
    EnvironmentSlot<int> slot([] { return 1; });
    slot.set(8);
    EXPECT_EQ(slot.get(), 8);
}

TEST(EnvironmentSlot, HasAnotherGenerationAfterEveryChangeAndNeverZero) {
    EnvironmentSlot<int> slot([] { return 1; });
    const auto first = slot.generation();
    EXPECT_GT(first, 0U);
    (void)slot.get();
    EXPECT_EQ(slot.generation(), first);
    std::uint64_t inside = 0;
    {
        const auto scope = slot.overrideWith(2);
        inside = slot.generation();
    }
    EXPECT_NE(inside, first);
    EXPECT_NE(slot.generation(), inside);
    EXPECT_NE(slot.generation(), first);
}

TEST(EnvironmentSlot, IsReadAndTurnedFromSeveralThreads) {
    EnvironmentSlot<std::shared_ptr<int>> slot([] { return std::make_shared<int>(0); });
    std::vector<std::jthread> threads;
    for (int t = 0; t < 2; ++t)
        threads.emplace_back([&] {
            for (int i = 0; i < 500; ++i)
                EXPECT_NE(slot.get(), nullptr);
        });
    for (int i = 0; i < 500; ++i)
        slot.set(std::make_shared<int>(i));
}

} // namespace
} // namespace orvo
