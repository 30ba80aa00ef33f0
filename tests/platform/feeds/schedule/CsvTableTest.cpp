#include "platform/feeds/schedule/CsvTable.h"

#include "TestSchedules.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

class CsvTableTest : public ::testing::Test {
protected:
    void open(const std::string& text) {
        stream = std::make_unique<testing::TextStream>(text);
        table = std::make_unique<CsvTable>(*stream, "stops.txt", budget);
        ASSERT_FALSE(table->readHeader());
    }

    ScheduleBudget budget{ScheduleLimits{}};
    std::unique_ptr<testing::TextStream> stream;
    std::unique_ptr<CsvTable> table;
    std::shared_ptr<NSError> error;
};

TEST_F(CsvTableTest, FindsColumnsInAnyOrderQuotedAndWithExtraOnes) {
    open("\xEF\xBB\xBF\"Stop_Name\",extra, stop_id \r\n\"Center, North \"\"loop\"\"\",x, S1 \r\n");
    ASSERT_TRUE(table->next(error));
    EXPECT_EQ(table->value(table->column("stop_id")), "S1");
    EXPECT_EQ(table->value(table->column("stop_name")), "Center, North \"loop\"");
    EXPECT_EQ(table->rowNumber(), 2U);
}

TEST_F(CsvTableTest, ReadsWhatAShortRowLacksAsEmptyAndALongRowUpToItsLastColumn) {
    open("stop_id,stop_name\nS1\nS2,Name,more,and more\n");
    EXPECT_EQ(table->column("zone_id"), CsvTable::NoColumn);
    ASSERT_TRUE(table->next(error));
    EXPECT_EQ(table->value(table->column("stop_name")), "");
    EXPECT_EQ(table->value(CsvTable::NoColumn), "");
    ASSERT_TRUE(table->next(error));
    EXPECT_EQ(table->value(table->column("stop_name")), "Name");
    EXPECT_FALSE(table->next(error));
    EXPECT_FALSE(error);
}

TEST_F(CsvTableTest, TakesTheFirstOfTwoColumnsWithOneName) {
    open("stop_id,stop_id\na,b\n");
    ASSERT_TRUE(table->next(error));
    EXPECT_EQ(table->value(table->column("stop_id")), "a");
}

TEST_F(CsvTableTest, RefusesTheRowBeyondTheBudget) {
    ScheduleLimits limits;
    limits.rows = 2;
    budget = ScheduleBudget(limits);
    open("stop_id\nS1\n\nS2\n");
    EXPECT_TRUE(table->next(error));
    EXPECT_TRUE(table->next(error));
    EXPECT_FALSE(table->next(error));
    EXPECT_FALSE(error);
    open("stop_id\nS3\n"); // another file of the same import
    EXPECT_FALSE(table->next(error));
    ASSERT_TRUE(error);
    EXPECT_EQ(error->localizedDescription(),
              "stops.txt: the schedule has more than 2 rows, the most that are read");
}

TEST_F(CsvTableTest, AnEmptyFileHasNoColumnsAndNoRows) {
    open("");
    EXPECT_FALSE(table->hasColumns());
    EXPECT_FALSE(table->next(error));
    EXPECT_FALSE(error);
}

} // namespace
} // namespace orvo
