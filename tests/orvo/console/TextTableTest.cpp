#include "orvo/console/TextTable.h"

#include <gtest/gtest.h>

#include <sstream>

namespace orvo {
namespace {

std::string printed(const TextTable& table, Terminal::Settings settings) {
    std::ostringstream output;
    std::ostringstream error;
    table.print(Terminal(output, error, settings));
    EXPECT_EQ(error.str(), "");
    return output.str();
}

TextTable sampleTable() {
    TextTable table({{"Line", TextTable::Column::Alignment::Left, false},
                     {"Name"},
                     {"Count", TextTable::Column::Alignment::Right, false}});
    table.addRow({"M1", "Airport – Old Harbour", "7"});
    table.addRow({"東京", "Two\nlines", "12"});
    return table;
}

TEST(TextTable, AlignsByColumnsOnATerminal) {
    EXPECT_EQ(printed(sampleTable(), {.outputIsTerminal = true, .width = 80}),
              "Line  Name                   Count\n"
              "M1    Airport – Old Harbour      7\n"
              "東京  Two lines                 12\n");
}

TEST(TextTable, FitsTheTerminalByCuttingWhatMayShrink) {
    EXPECT_EQ(printed(sampleTable(), {.outputIsTerminal = true, .width = 24}),
              "Line  Name         Count\n"
              "M1    Airport – …      7\n"
              "東京  Two lines       12\n");
}

TEST(TextTable, WhereItCannotFitEveryRowIsABlock) {
    TextTable table({{"Line", TextTable::Column::Alignment::Left, false},
                     {"Name", TextTable::Column::Alignment::Left, false},
                     {"Count", TextTable::Column::Alignment::Right, false}});
    table.addRow({"M1", "Airport – Old Harbour", "7"});
    table.addRow({"東京", "Two\nlines", "12"});
    EXPECT_EQ(printed(table, {.outputIsTerminal = true, .width = 20}),
              "Line   M1\n"
              "Name   Airport – Old\n"
              "       Harbour\n"
              "Count  7\n"
              "\n"
              "Line   東京\n"
              "Name   Two lines\n"
              "Count  12\n");
}

TEST(TextTable, ABlockLeavesEmptyTextsOutAndLongWordsWhole) {
    TextTable table({{"Feed", TextTable::Column::Alignment::Left, false},
                     {"Alerts", TextTable::Column::Alignment::Left, false},
                     {"Note"}});
    table.addRow({"city", "https://city.example/alerts.pb", ""});
    EXPECT_EQ(printed(table, {.outputIsTerminal = true, .width = 24}),
              "Feed    city\n"
              "Alerts  https://city.example/alerts.pb\n");
}

TEST(TextTable, IsPlainAndUncutInAPipe) {
    EXPECT_EQ(printed(sampleTable(), {.outputIsTerminal = false, .width = 20}),
              "M1\tAirport – Old Harbour\t7\n"
              "東京\tTwo lines\t12\n");
}

TEST(TextTable, StylesOnlyTheHeadings) {
    TextTable table({{"A"}});
    table.addRow({"x"});
    EXPECT_EQ(printed(table, {.outputIsTerminal = true, .usesStyles = true, .width = 80}),
              "\x1b[2mA\x1b[0m\nx\n");
}

TEST(TextTable, AShortRowIsFilledWithBlanks) {
    TextTable table({{"A"}, {"B"}});
    EXPECT_TRUE(table.isEmpty());
    table.addRow({"x"});
    EXPECT_FALSE(table.isEmpty());
    EXPECT_EQ(printed(table, {}), "x\t\n");
}

} // namespace
} // namespace orvo
