#include "platform/uikit/table/_RowHeights.h"

#include <gtest/gtest.h>

#include <random>

namespace orvo {
namespace {

TEST(RowHeights, NoRowsHaveNoHeight) {
    const _RowHeights none;
    EXPECT_EQ(none.total(), 0);
    EXPECT_EQ(none.rowAt(0), 0U);
    EXPECT_EQ(none.rowAt(50), 0U);
}

TEST(RowHeights, RowBeginsWhereTheOneBeforeEnds) {
    const _RowHeights rows({10, 20, 30});
    EXPECT_EQ(rows.top(0), 0);
    EXPECT_EQ(rows.top(2), 30);
    EXPECT_EQ(rows.top(3), 60);
    EXPECT_EQ(rows.rowAt(9.5), 0U);
    EXPECT_EQ(rows.rowAt(10), 1U);
    EXPECT_EQ(rows.rowAt(59), 2U);
    EXPECT_EQ(rows.rowAt(60), 3U);
    EXPECT_EQ(rows.rowAt(-5), 0U);
}

TEST(RowHeights, RowsWithoutAHeightHoldNoPoint) {
    const _RowHeights rows({0, 10, 0, 0, 5, 0});
    EXPECT_EQ(rows.rowAt(0), 1U);
    EXPECT_EQ(rows.rowAt(10), 4U);
    EXPECT_EQ(rows.rowAt(15), 6U);
}

TEST(RowHeights, ManyChangesGiveTheSameAsAdding) {
    std::mt19937 random(7);
    std::uniform_int_distribution<int> some(0, 40);
    for (std::size_t count = 1; count < 40; ++count) {
        std::vector<CGFloat> plain(count, 5);
        _RowHeights rows(plain);
        for (int change = 0; change < 60; ++change) {
            const auto row = static_cast<std::size_t>(random()) % count;
            plain[row] = some(random);
            rows.setHeight(row, plain[row]);
        }
        CGFloat top = 0;
        for (std::size_t row = 0; row < count; ++row) {
            ASSERT_EQ(rows.top(row), top);
            ASSERT_EQ(rows.height(row), plain[row]);
            if (plain[row] > 0) {
                ASSERT_EQ(rows.rowAt(top), row);
                ASSERT_EQ(rows.rowAt(top + plain[row] - 0.5), row);
            }
            top += plain[row];
        }
        ASSERT_EQ(rows.total(), top);
    }
}

} // namespace
} // namespace orvo
