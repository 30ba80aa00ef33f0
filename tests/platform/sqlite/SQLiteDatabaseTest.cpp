#include "platform/sqlite/SQLiteDatabase.h"

#include "platform/sqlite/SQLiteStatement.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <chrono>
#include <fstream>
#include <limits>

namespace orvo {
namespace {

class SQLiteDatabaseTest : public ::testing::Test {
protected:
    std::filesystem::path path() const { return _folder.path() / "test.sqlite"; }
    std::unique_ptr<SQLiteDatabase> open(SQLiteDatabase::Mode mode) {
        return SQLiteDatabase::open(path(), mode, &_failure);
    }
    std::unique_ptr<SQLiteDatabase> withTable() {
        auto database = open(SQLiteDatabase::Mode::Write);
        EXPECT_TRUE(database->execute("CREATE TABLE t (a, b)"));
        return database;
    }
    static std::int64_t rows(SQLiteDatabase& database) {
        SQLiteStatement count(database, "SELECT count(*) FROM t");
        return count.step() ? count.integer(0) : -1;
    }

    testing::TemporaryFolder _folder;
    SQLiteFailure _failure;
};

TEST_F(SQLiteDatabaseTest, ReadingNeedsTheFile) {
    EXPECT_EQ(open(SQLiteDatabase::Mode::Read), nullptr);
    EXPECT_NE(_failure.code, 0);
    EXPECT_FALSE(_failure.isDamage());
    EXPECT_FALSE(std::filesystem::exists(path()));
}

TEST_F(SQLiteDatabaseTest, WritingKeepsAWriteAheadLog) {
    const auto database = withTable();
    EXPECT_TRUE(std::filesystem::exists(path().string() + "-wal"));
}

TEST_F(SQLiteDatabaseTest, AFailureTellsTheSystemsReason) {
    std::filesystem::create_directory(path());
    EXPECT_EQ(open(SQLiteDatabase::Mode::Write), nullptr);
    EXPECT_EQ(_failure.reason, "unable to open database file: Is a directory");
}

TEST_F(SQLiteDatabaseTest, EveryKindOfValueComesBack) {
    const auto database = withTable();
    const std::vector<std::uint8_t> bytes{0, 1, 255};
    SQLiteStatement insert(*database, "INSERT INTO t VALUES (?, ?)");
    EXPECT_TRUE(insert.bind(std::numeric_limits<std::uint64_t>::max()).bind(0.5).run());
    EXPECT_TRUE(insert.bind(std::string_view("a\0b", 3)).bind(std::span(bytes)).run());
    EXPECT_TRUE(insert.bind(std::string_view()).bind(std::span<const std::uint8_t>()).run());
    EXPECT_TRUE(insert.bind(std::optional<std::string>()).bindNull().run());

    SQLiteStatement query(*database, "SELECT a, b FROM t ORDER BY rowid");
    ASSERT_TRUE(query.step());
    EXPECT_EQ(query.unsignedInteger(0), std::numeric_limits<std::uint64_t>::max());
    EXPECT_EQ(query.real(1), 0.5);
    ASSERT_TRUE(query.step());
    EXPECT_EQ(query.text(0), std::string("a\0b", 3));
    EXPECT_EQ(std::vector(query.bytes(1).begin(), query.bytes(1).end()), bytes);
    ASSERT_TRUE(query.step());
    EXPECT_EQ(query.textOrNil(0), "");
    EXPECT_FALSE(query.isNull(1));
    ASSERT_TRUE(query.step());
    EXPECT_EQ(query.textOrNil(0), std::nullopt);
    EXPECT_TRUE(query.isNull(1));
    EXPECT_FALSE(query.step());
    EXPECT_FALSE(query.hasFailed());
}

TEST_F(SQLiteDatabaseTest, AStatementThatCannotBeCompiledFailsWithTheReason) {
    const auto database = withTable();
    SQLiteStatement statement(*database, "SELECT a FROM nowhere");
    EXPECT_FALSE(statement.bind(1.0).step());
    EXPECT_FALSE(statement.run());
    EXPECT_TRUE(statement.hasFailed());
    EXPECT_EQ(database->failure().reason, "no such table: nowhere");
}

TEST_F(SQLiteDatabaseTest, ATransactionThatEndsWithoutCommitLeavesNothing) {
    const auto database = withTable();
    {
        const SQLiteTransaction transaction(*database);
        ASSERT_TRUE(transaction.isOpen());
        EXPECT_TRUE(database->execute("INSERT INTO t VALUES (1, 2)"));
        EXPECT_EQ(rows(*database), 1);
    }
    EXPECT_EQ(rows(*database), 0);
    SQLiteTransaction transaction(*database);
    EXPECT_TRUE(database->execute("INSERT INTO t VALUES (1, 2)"));
    EXPECT_TRUE(transaction.commit());
    EXPECT_EQ(rows(*database), 1);
}

TEST_F(SQLiteDatabaseTest, IsReadWhileAnotherConnectionIsInTheMiddleOfWriting) {
    const auto writer = withTable();
    const auto reader = open(SQLiteDatabase::Mode::Read);
    SQLiteTransaction transaction(*writer);
    EXPECT_TRUE(writer->execute("INSERT INTO t VALUES (1, 2)"));
    EXPECT_EQ(rows(*reader), 0);
    EXPECT_TRUE(transaction.commit());
    EXPECT_EQ(rows(*reader), 1);
}

TEST_F(SQLiteDatabaseTest, ACopyInMemoryLeavesTheFileAsItIs) {
    withTable();
    const auto copy = SQLiteDatabase::openInMemory(path(), &_failure);
    ASSERT_NE(copy, nullptr) << _failure.reason;
    EXPECT_TRUE(copy->execute("INSERT INTO t VALUES (1, 2)"));
    EXPECT_EQ(rows(*copy), 1);
    EXPECT_EQ(rows(*open(SQLiteDatabase::Mode::Read)), 0);
}

TEST_F(SQLiteDatabaseTest, ACopyOfNoFileIsAFailure) {
    EXPECT_EQ(SQLiteDatabase::openInMemory(path(), &_failure), nullptr);
    EXPECT_NE(_failure.code, 0);
    EXPECT_NE(SQLiteDatabase::openInMemory(std::nullopt, &_failure), nullptr);
}

TEST_F(SQLiteDatabaseTest, KnowsDamage) {
    std::ofstream(path()) << std::string(5000, 'x');
    const auto database = open(SQLiteDatabase::Mode::Read);
    ASSERT_NE(database, nullptr);
    EXPECT_FALSE(database->isSound());
    EXPECT_TRUE(database->failure().isDamage());
    EXPECT_EQ(SQLiteDatabase::openInMemory(path(), &_failure), nullptr);
    EXPECT_TRUE(_failure.isDamage());
}

TEST_F(SQLiteDatabaseTest, AFileThatAnotherHoldsExclusivelyIsGivenUpInTime) {
    const auto holder = withTable();
    ASSERT_TRUE(holder->execute("PRAGMA locking_mode = EXCLUSIVE; BEGIN EXCLUSIVE;"
                                "INSERT INTO t VALUES (1, 2)"));
    constexpr std::chrono::milliseconds Short(30);
    for (const auto mode : {SQLiteDatabase::Mode::Write, SQLiteDatabase::Mode::Read}) {
        const auto begin = std::chrono::steady_clock::now();
        EXPECT_EQ(SQLiteDatabase::open(path(), mode, &_failure, Short), nullptr);
        EXPECT_LT(std::chrono::steady_clock::now() - begin, SQLiteDatabase::Patience);
        EXPECT_TRUE(_failure.isLocked()) << _failure.reason;
        EXPECT_FALSE(_failure.isDamage());
        EXPECT_EQ(_failure.reason, "database is locked");
    }
}

TEST_F(SQLiteDatabaseTest, AWriterWaitsAsLongAsItWasToldAtItsOpening) {
    const auto holder = withTable();
    constexpr std::chrono::milliseconds Short(30);
    const auto writer = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, &_failure, Short);
    ASSERT_NE(writer, nullptr) << _failure.reason;
    const SQLiteTransaction first(*holder);
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_FALSE(SQLiteTransaction(*writer).isOpen());
    EXPECT_LT(std::chrono::steady_clock::now() - begin, SQLiteDatabase::Patience);
    EXPECT_TRUE(writer->failure().isLocked());
}

TEST_F(SQLiteDatabaseTest, KnowsAFileThatMustNotBeWritten) {
    withTable();
    const auto reader = open(SQLiteDatabase::Mode::Read);
    EXPECT_FALSE(reader->execute("INSERT INTO t VALUES (1, 2)"));
    EXPECT_TRUE(reader->failure().isReadOnly());
    EXPECT_FALSE(reader->failure().isLocked());
}

TEST_F(SQLiteDatabaseTest, IsSoundWithItsLayoutNumber) {
    const auto database = withTable();
    EXPECT_TRUE(database->isSound());
    EXPECT_EQ(database->userVersion(), 0);
    EXPECT_TRUE(database->execute("PRAGMA user_version = 7"));
    EXPECT_EQ(database->userVersion(), 7);
}

} // namespace
} // namespace orvo
