#include "platform/feeds/schedule/CsvReader.h"

#include "TestSchedules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using Row = std::vector<std::string>;

struct Read {
    std::vector<Row> rows;
    std::vector<std::uint64_t> numbers;
    std::string error;
};

Read readAll(const std::string& text, std::size_t pieceLength = 1 << 16) {
    testing::TextStream stream(text, pieceLength);
    CsvReader reader(stream, "routes.txt");
    Read read;
    std::shared_ptr<NSError> error;
    while (reader.next(error)) {
        Row row;
        for (std::size_t index = 0; index < reader.fieldCount(); ++index)
            row.emplace_back(reader.field(index));
        read.rows.push_back(std::move(row));
        read.numbers.push_back(reader.rowNumber());
    }
    if (error)
        read.error = error->localizedDescription();
    return read;
}

TEST(CsvReader, EndsRowsWithCrLfOrBothAndWithTheFile) {
    for (const char* text :
         {"a,b\nc,d\n", "a,b\rc,d\r", "a,b\r\nc,d\r\n", "a,b\nc,d", "a,b\r\nc,d"})
        for (const std::size_t pieceLength : {1U, 2U, 3U, 4U, 5U, 100U}) {
            const Read read = readAll(text, pieceLength);
            EXPECT_THAT(read.rows, ElementsAre(Row{"a", "b"}, Row{"c", "d"})) << text;
            EXPECT_THAT(read.numbers, ElementsAre(1, 2)) << text;
        }
}

TEST(CsvReader, KeepsEverythingInsideQuotes) {
    for (const std::size_t pieceLength : {1U, 7U, 100U}) {
        const Read read = readAll("\"a,b\",\"c\r\nd\",\"say \"\"no\"\"\",\"\"\n\"e\"", pieceLength);
        EXPECT_THAT(read.rows, ElementsAre(Row{"a,b", "c\r\nd", "say \"no\"", ""}, Row{"e"}));
        EXPECT_THAT(read.numbers, ElementsAre(1, 2));
    }
}

TEST(CsvReader, DropsBlanksAroundFieldsButNotInsideQuotes) {
    const Read read = readAll(" a ,\t\"b \" , c d\n");
    EXPECT_THAT(read.rows, ElementsAre(Row{"a", "b ", "c d"}));
}

TEST(CsvReader, TakesStrayQuotesAsTheyStand) {
    EXPECT_THAT(readAll("5\" pipe,\"a\"b,c\"\"\n").rows,
                ElementsAre(Row{"5\" pipe", "ab", "c\"\""}));
    EXPECT_THAT(readAll("\"a\"b\"c\",d\n").rows, ElementsAre(Row{"ab\"c\"", "d"}));
}

TEST(CsvReader, PassesBlankRowsOverAndCountsThem) {
    const Read read = readAll("a\n\n  \r\n\nb\n\n");
    EXPECT_THAT(read.rows, ElementsAre(Row{"a"}, Row{"b"}));
    EXPECT_THAT(read.numbers, ElementsAre(1, 5));
    EXPECT_TRUE(readAll("").rows.empty());
    EXPECT_TRUE(readAll("\n\r\n").rows.empty());
}

TEST(CsvReader, ARowOfCommasIsEmptyFields) {
    EXPECT_THAT(readAll(",,\n").rows, ElementsAre(Row{"", "", ""}));
    EXPECT_THAT(readAll("a,").rows, ElementsAre(Row{"a", ""}));
}

TEST(CsvReader, AnswersAnEmptyTextBeyondTheLastField) {
    testing::TextStream stream("a,b\n");
    CsvReader reader(stream, "routes.txt");
    std::shared_ptr<NSError> error;
    ASSERT_TRUE(reader.next(error));
    EXPECT_EQ(reader.field(2), "");
    EXPECT_EQ(reader.field(static_cast<std::size_t>(-1)), "");
}

TEST(CsvReader, RefusesAQuoteThatIsNeverClosedNamingTheRow) {
    const Read read = readAll("a,b\nc,\"d\ne,f\n");
    EXPECT_EQ(read.error, "routes.txt, row 2: a quotation mark is never closed");
    EXPECT_THAT(read.rows, ElementsAre(Row{"a", "b"}));
}

TEST(CsvReader, RefusesWhatIsNotUtf8NamingTheRow) {
    const std::string latin1 = "a\nb\nZ\xFCrich\n";
    EXPECT_EQ(readAll(latin1).error, "routes.txt, row 3: the text is not UTF-8");
    EXPECT_EQ(readAll("\"\xC3\",\xA9\n").error, "routes.txt, row 1: the text is not UTF-8");
    EXPECT_EQ(readAll("\xED\xA0\x80\n").error, "routes.txt, row 1: the text is not UTF-8");
}

TEST(CsvReader, RefusesAZeroByteNamingTheRowAndWhatItMayMean) {
    const std::string reason =
        "a byte is 0, which text has none of; UTF-16 needs its byte-order mark";
    EXPECT_EQ(readAll(std::string("a\nb\0c\n", 6)).error, "routes.txt, row 2: " + reason);
    EXPECT_EQ(readAll(std::string("\"\0\"\n", 4)).error, "routes.txt, row 1: " + reason);
    EXPECT_EQ(readAll(std::string("a\0\n\0", 4)).error, "routes.txt, row 1: " + reason);
}

TEST(CsvReader, RefusesARowThatIsTooLong) {
    const std::string longest(CsvReader::MaximumRowLength, 'x');
    EXPECT_EQ(readAll(longest + "\n").error, "");
    EXPECT_THAT(readAll("a\n" + longest + "x\n").error, HasSubstr("routes.txt, row 2: the row is"));
    EXPECT_THAT(readAll('"' + longest + longest).error, HasSubstr("longer than a row may be"));
}

TEST(CsvReader, RefusesARowWithTooManyFields) {
    const std::string most(CsvReader::MaximumFields - 1, ',');
    EXPECT_EQ(readAll(most).rows.size(), 1U);
    EXPECT_THAT(readAll(most + ",").error, HasSubstr("routes.txt, row 1: the row has more fields"));
}

TEST(CsvReader, EndsWithoutHarmWhereverTheTextIsCut) {
    const std::string text = "\xEF\xBB\xBF"
                             "a, \"b\"\"\r\nc\" ,é\r\n\r\nd\r";
    for (std::size_t length = 0; length <= text.size(); ++length)
        for (const std::size_t pieceLength : {1U, 100U}) {
            const Read read = readAll(text.substr(0, length), pieceLength);
            EXPECT_LE(read.rows.size(), 2U);
        }
}

} // namespace
} // namespace orvo
