#include "platform/uikit/solver/SparseTableau.h"

#include <gtest/gtest.h>

#include <cmath>
#include <map>
#include <random>
#include <set>
#include <vector>

namespace {

using namespace orvo;
using Row = std::map<SparseTableau::Symbol, double>;

Row rowOf(const SparseTableau& tableau, SparseTableau::Symbol symbol) {
    Row row;
    for (auto place = tableau.firstInRow(symbol); place != SparseTableau::None;
         place = tableau[place].nextInRow) {
        EXPECT_EQ(tableau[place].row, symbol);
        EXPECT_TRUE(row.emplace(tableau[place].column, tableau[place].coefficient).second);
    }
    return row;
}

std::set<SparseTableau::Symbol> rowsWith(const SparseTableau& tableau,
                                         SparseTableau::Symbol column) {
    std::set<SparseTableau::Symbol> rows;
    for (auto place = tableau.firstInColumn(column); place != SparseTableau::None;
         place = tableau[place].nextInColumn) {
        EXPECT_EQ(tableau[place].column, column);
        EXPECT_TRUE(rows.insert(tableau[place].row).second);
    }
    return rows;
}

void addRow(SparseTableau& tableau, SparseTableau::Symbol symbol, const Row& row) {
    for (const auto& [column, coefficient] : row)
        tableau.addColumnToSum(column, coefficient);
    tableau.makeRowOfSum(symbol);
}

SparseTableau::Place
placeOf(const SparseTableau& tableau, SparseTableau::Symbol row, SparseTableau::Symbol column) {
    auto place = tableau.firstInRow(row);
    while (place != SparseTableau::None && tableau[place].column != column)
        place = tableau[place].nextInRow;
    return place;
}

/// Columns 0 to 2; rows 3 = 2·0 + 4·1 and 4 = 0 − 3·2.
class SparseTableauTest : public testing::Test {
protected:
    SparseTableauTest() {
        tableau.reserve(8);
        addRow(tableau, 3, {{0, 2}, {1, 4}});
        addRow(tableau, 4, {{0, 1}, {2, -3}});
    }

    SparseTableau tableau;
};

TEST_F(SparseTableauTest, PivotLetsRowAndColumnChangePlaces) {
    tableau.pivot(placeOf(tableau, 3, 0));
    EXPECT_EQ(rowOf(tableau, 0), (Row{{1, -2}, {3, 0.5}}));
    EXPECT_EQ(rowOf(tableau, 4), (Row{{1, -2}, {2, -3}, {3, 0.5}}));
    EXPECT_EQ(rowOf(tableau, 3), Row());
    EXPECT_EQ(rowsWith(tableau, 3), (std::set<SparseTableau::Symbol>{0, 4}));
    EXPECT_EQ(rowsWith(tableau, 0), std::set<SparseTableau::Symbol>());
}

TEST_F(SparseTableauTest, PivotingBackRestoresTheRows) {
    tableau.pivot(placeOf(tableau, 3, 0));
    tableau.pivot(placeOf(tableau, 0, 3));
    EXPECT_EQ(rowOf(tableau, 3), (Row{{0, 2}, {1, 4}}));
    EXPECT_EQ(rowOf(tableau, 4), (Row{{0, 1}, {2, -3}}));
}

TEST_F(SparseTableauTest, SumsOfRowsAndColumnsBecomeARow) {
    tableau.addRowToSum(3, 0.5);
    tableau.addRowToSum(4, -1);
    tableau.addColumnToSum(1, 1);
    tableau.makeRowOfSum(5);
    EXPECT_EQ(rowOf(tableau, 5), (Row{{1, 3}, {2, 3}}));
    EXPECT_EQ(rowsWith(tableau, 0), (std::set<SparseTableau::Symbol>{3, 4}));
}

TEST_F(SparseTableauTest, EntriesThatCancelOutAreDropped) {
    addRow(tableau, 5, {{0, 1}, {1, 2}});
    tableau.pivot(placeOf(tableau, 3, 0)); // 0 = ½·3 − 2·1, so 5 = ½·3
    EXPECT_EQ(rowOf(tableau, 5), (Row{{3, 0.5}}));
    EXPECT_EQ(rowsWith(tableau, 1), (std::set<SparseTableau::Symbol>{0, 4}));
}

TEST_F(SparseTableauTest, ErasedRowsLeaveTheirColumns) {
    tableau.eraseRow(3);
    EXPECT_EQ(rowOf(tableau, 3), Row());
    EXPECT_EQ(rowsWith(tableau, 0), (std::set<SparseTableau::Symbol>{4}));
    EXPECT_EQ(rowsWith(tableau, 1), std::set<SparseTableau::Symbol>());
    addRow(tableau, 6, {{1, 1}, {2, 1}});
    EXPECT_EQ(rowOf(tableau, 6), (Row{{1, 1}, {2, 1}}));
    EXPECT_EQ(rowOf(tableau, 4), (Row{{0, 1}, {2, -3}}));
}

TEST_F(SparseTableauTest, ClearedTableauIsEmpty) {
    tableau.clear();
    EXPECT_EQ(rowOf(tableau, 3), Row());
    EXPECT_EQ(rowsWith(tableau, 0), std::set<SparseTableau::Symbol>());
}

/// Beside a full table of the same numbers.
TEST(SparseTableau, ManyPivotsDoWhatADenseTableDoes) {
    constexpr std::size_t Count = 6;
    std::mt19937 random(11);
    SparseTableau tableau;
    tableau.reserve(2 * Count);
    std::map<SparseTableau::Symbol, Row> dense;
    std::vector<SparseTableau::Symbol> columns;
    std::vector<SparseTableau::Symbol> rows;
    for (SparseTableau::Symbol index = 0; index < Count; ++index) {
        columns.push_back(index);
        rows.push_back(static_cast<SparseTableau::Symbol>(Count) + index);
    }
    for (const auto row : rows) {
        for (const auto column : columns) {
            if (random() % 2 == 0)
                dense[row][column] = static_cast<double>(random() % 5) - 2.25;
        }
        addRow(tableau, row, dense[row]);
    }
    for (int turn = 0; turn < 200; ++turn) {
        auto& leaving = rows[random() % Count];
        auto& entering = columns[random() % Count];
        const double pivot = dense[leaving][entering];
        if (std::abs(pivot) < 0.1)
            continue;
        tableau.pivot(placeOf(tableau, leaving, entering));
        Row solved;
        for (const auto column : columns)
            solved[column] = -dense[leaving][column] / pivot;
        solved.erase(entering);
        solved[leaving] = 1 / pivot;
        dense.erase(leaving);
        for (auto& [row, coefficients] : dense) {
            const double factor = coefficients[entering];
            coefficients.erase(entering);
            for (const auto& [column, coefficient] : solved)
                coefficients[column] += factor * coefficient;
        }
        dense[entering] = solved;
        std::swap(leaving, entering);
        for (const auto row : rows) {
            Row sparse = rowOf(tableau, row);
            for (const auto column : columns)
                ASSERT_NEAR(sparse[column], dense[row][column], 1e-6) << "turn " << turn;
        }
    }
}

} // namespace
