#include "platform/feeds/http/BodyStore.h"

#include "platform/foundation/Environment.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <fstream>

namespace orvo {
namespace {

const std::string Key(64, 'a');

BodyRecord record(const std::string& tag, double at = 100) {
    BodyRecord made;
    made.entityTag = tag;
    made.lastModified = "Sun, 06 Nov 1994 08:49:37 GMT";
    made.receivedAt = at;
    made.validatedAt = at + 5;
    made.validations = 1;
    return made;
}

std::shared_ptr<NSData> bytes(const std::string& text) {
    return NSData::dataWithString(text);
}

class BodyStoreTest : public ::testing::Test {
protected:
    std::filesystem::path folder() const { return _temporary.path() / "made" / "bodies"; }
    std::vector<std::filesystem::path> files(const std::string& extension) const {
        std::vector<std::filesystem::path> found;
        for (const auto& file : std::filesystem::directory_iterator(folder()))
            if (file.path().extension() == extension)
                found.push_back(file.path());
        return found;
    }
    /// What another process would read.
    std::string textOf(const std::string& key) const {
        const BodyStore other(folder());
        const auto known = other.record(key);
        const auto body = known ? other.body(key, *known) : nullptr;
        return body ? std::string(body->stringView()) : "(none)";
    }
    static void write(const std::filesystem::path& path, const std::string& text) {
        std::ofstream(path, std::ios::binary) << text;
    }

    testing::TemporaryFolder _temporary;
};

TEST_F(BodyStoreTest, NothingIsKnownAtFirst) {
    const BodyStore store(folder());
    EXPECT_FALSE(store.record(Key));
    EXPECT_FALSE(std::filesystem::exists(folder()));
}

TEST_F(BodyStoreTest, WhatIsSavedIsReadByAnother) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("body")));
    const BodyStore other(folder());
    auto expected = record("\"1\"");
    expected.length = 4;
    const auto known = other.record(Key);
    ASSERT_TRUE(known);
    expected.checksum = known->checksum;
    EXPECT_EQ(*known, expected);
    EXPECT_EQ(textOf(Key), "body");
    EXPECT_FALSE(other.record(std::string(64, 'b')));
}

TEST_F(BodyStoreTest, AnEmptyBodyIsABody) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("")));
    EXPECT_EQ(textOf(Key), "");
}

TEST_F(BodyStoreTest, ANewBodyReplacesTheOldOne) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("old")));
    ASSERT_FALSE(store.save(Key, record("\"2\""), bytes("new")));
    EXPECT_EQ(textOf(Key), "new");
    EXPECT_EQ(files(".body").size(), 1U);
}

TEST_F(BodyStoreTest, FilesAreForTheirOwnerOnly) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("old")));
    using std::filesystem::perms;
    const auto others = perms::group_all | perms::others_all;
    EXPECT_EQ(std::filesystem::status(folder()).permissions() & others, perms::none);
    for (const auto& file : std::filesystem::directory_iterator(folder()))
        EXPECT_EQ(file.status().permissions() & others, perms::none) << file.path();
}

TEST_F(BodyStoreTest, BytesInUseAreNotReadAgain) {
    BodyStore store(folder());
    const auto held = bytes("body");
    ASSERT_FALSE(store.save(Key, record("\"1\""), held));
    EXPECT_EQ(store.body(Key, *store.record(Key)), held);
}

TEST_F(BodyStoreTest, UpdateKeepsTheBytes) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("body")));
    auto known = *store.record(Key);
    known.validatedAt = 500;
    known.validations = 7;
    ASSERT_FALSE(store.update(Key, known));
    EXPECT_EQ(BodyStore(folder()).record(Key), known);
    EXPECT_EQ(textOf(Key), "body");
}

TEST_F(BodyStoreTest, UpdateLeavesWhatAnotherSavedSince) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("body")));
    const auto mine = *store.record(Key);
    BodyStore other(folder());
    ASSERT_FALSE(other.save(Key, record("\"2\"", 200), bytes("newer")));
    ASSERT_FALSE(store.update(Key, mine));
    EXPECT_EQ(BodyStore(folder()).record(Key)->entityTag, "\"2\"");
    EXPECT_EQ(textOf(Key), "newer");
}

TEST_F(BodyStoreTest, DamagedBytesCountAsAbsent) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("body")));
    write(files(".body").front(), "bodx");
    EXPECT_EQ(textOf(Key), "(none)");
    write(files(".body").front(), "bod");
    EXPECT_FALSE(BodyStore(folder()).record(Key));
    std::filesystem::remove(files(".body").front());
    EXPECT_FALSE(BodyStore(folder()).record(Key));
}

TEST_F(BodyStoreTest, SavingMendsDamagedBytesOfTheSameContent) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("body")));
    write(files(".body").front(), "bodx");
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("body")));
    EXPECT_EQ(textOf(Key), "body");
}

TEST_F(BodyStoreTest, ARecordCutAnywhereCountsAsAbsent) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("body")));
    const auto path = files(".plist").front();
    std::ifstream file(path, std::ios::binary);
    const std::string whole((std::istreambuf_iterator<char>(file)), {});
    for (std::size_t length = 0; length < whole.size(); ++length) {
        write(path, whole.substr(0, length));
        EXPECT_FALSE(BodyStore(folder()).record(Key)) << length;
    }
    write(path, whole);
    EXPECT_TRUE(BodyStore(folder()).record(Key));
}

TEST_F(BodyStoreTest, AFolderThatCannotBeMadeKeepsTheBodyInMemory) {
    write(_temporary.path() / "made", "in the way");
    BodyStore store(folder());
    EXPECT_TRUE(store.save(Key, record("\"1\""), bytes("body")));
    ASSERT_TRUE(store.record(Key));
    EXPECT_EQ(store.body(Key, *store.record(Key))->stringView(), "body");
}

TEST_F(BodyStoreTest, InMemoryNothingReachesTheDisk) {
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("body")));
    EXPECT_FALSE(std::filesystem::exists(folder()));
    ASSERT_TRUE(store.record(Key));
    EXPECT_EQ(store.body(Key, *store.record(Key))->stringView(), "body");
}

TEST_F(BodyStoreTest, InMemoryTheDiskIsReadAndLeft) {
    {
        BodyStore store(folder());
        ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("body")));
    }
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    BodyStore store(folder());
    auto known = *store.record(Key);
    known.validations = 9;
    ASSERT_FALSE(store.update(Key, known));
    EXPECT_EQ(store.record(Key)->validations, 9);
    EXPECT_EQ(store.body(Key, known)->stringView(), "body");
    EXPECT_EQ(BodyStore(folder()).record(Key)->validations, 1);
}

TEST_F(BodyStoreTest, FilesThatNobodyWroteForLongAreSwept) {
    BodyStore store(folder());
    ASSERT_FALSE(store.save(Key, record("\"1\""), bytes("old")));
    for (const auto& file : std::filesystem::directory_iterator(folder()))
        std::filesystem::last_write_time(file.path(),
                                         std::filesystem::file_time_type::clock::now() -
                                             std::chrono::hours(91 * 24));
    ASSERT_FALSE(store.save(std::string(64, 'b'), record("\"2\""), bytes("new")));
    EXPECT_FALSE(BodyStore(folder()).record(Key));
    EXPECT_EQ(textOf(std::string(64, 'b')), "new");
    EXPECT_EQ(files(".plist").size(), 1U);
}

} // namespace
} // namespace orvo
