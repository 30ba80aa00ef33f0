#include "platform/feeds/schedule/ScheduleArchive.h"

#include "TestSchedules.h"
#include "platform/feeds/schedule/ScheduleError.h"
#include "support/TemporaryProfile.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <sys/stat.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;

class ScheduleArchiveTest : public ::testing::Test {
protected:
    std::unique_ptr<ScheduleArchive> open(const ScheduleSource& source) {
        error = nullptr;
        return ScheduleArchive::open(source, error);
    }
    std::unique_ptr<ScheduleArchive> openBytes(std::string_view bytes) {
        return open(ScheduleSource::fromBytes(NSData::dataWithString(bytes), "city.zip"));
    }
    std::string read(const ScheduleArchive& archive, std::string_view file) {
        const auto stream = archive.openFile(file, error);
        std::string text;
        std::array<char, 7> buffer{};
        while (stream) {
            const std::size_t length = stream->read(buffer, error);
            if (length == 0)
                break;
            text.append(buffer.data(), length);
        }
        return text;
    }
    std::string message() const { return error ? error->localizedDescription() : ""; }
    ScheduleErrorCode code() const { return static_cast<ScheduleErrorCode>(error->code()); }

    testing::TemporaryFolder folder;
    std::shared_ptr<NSError> error;
};

TEST_F(ScheduleArchiveTest, ReadsAZipFileItsBytesAndAFolderAlike) {
    const auto files = testing::smallSchedule();
    const auto bytes = testing::zipOf(files);
    testing::writeFile(folder.path() / "city.zip", bytes->stringView());
    for (const auto& [name, text] : files)
        testing::writeFile(folder.path() / "city" / name, text);
    for (const auto& source : {ScheduleSource::fromPath(folder.path() / "city.zip"),
                               ScheduleSource::fromBytes(bytes, "city.zip"),
                               ScheduleSource::fromPath(folder.path() / "city")}) {
        const auto archive = open(source);
        ASSERT_TRUE(archive) << message();
        EXPECT_TRUE(archive->has("agency.txt"));
        EXPECT_FALSE(archive->has("stops.txt"));
        EXPECT_EQ(archive->statedSize("stops.txt"), 0U);
        for (const auto& [name, text] : files) {
            EXPECT_EQ(archive->statedSize(name), text.size());
            EXPECT_EQ(read(*archive, name), text);
        }
        EXPECT_FALSE(error);
    }
}

TEST_F(ScheduleArchiveTest, AFolderMayEncloseTheSchedule) {
    testing::writeFile(folder.path() / "a/city/routes.txt", "route_id\nR1\n");
    const auto archive = open(ScheduleSource::fromPath(folder.path() / "a"));
    ASSERT_TRUE(archive) << message();
    EXPECT_EQ(read(*archive, "routes.txt"), "route_id\nR1\n");
    EXPECT_FALSE(open(ScheduleSource::fromPath(folder.path())));
    EXPECT_EQ(message(),
              folder.path().string() +
                  ": its schedule lies too deep, in a/city/; only one enclosing "
                  "folder is looked into");
}

TEST_F(ScheduleArchiveTest, SaysWhatIsNoZipFile) {
    const std::pair<std::string, std::string> cases[] = {
        {"", "city.zip: is empty"},
        {"  <!DOCTYPE html><html>", "city.zip: is a web page, not a zip file"},
        {"<html>", "city.zip: is a web page, not a zip file"},
        {"\x1F\x8B\x08 gz", "city.zip: is a gzip file, not a zip file"},
        {"hello\x1B world", "city.zip: is not a zip file; it begins with “hello world”"},
        {"PK\x03\x04 cut", "city.zip: begins like a zip file but is empty, cut off or damaged"}};
    for (const auto& [bytes, expected] : cases) {
        EXPECT_FALSE(openBytes(bytes));
        EXPECT_EQ(message(), expected);
        EXPECT_EQ(code(), ScheduleErrorCode::NotAnArchive);
        testing::writeFile(folder.path() / "other", bytes);
        EXPECT_FALSE(open(ScheduleSource::fromPath(folder.path() / "other")));
        EXPECT_EQ(message(), (folder.path() / "other").string() + expected.substr(8));
    }
}

TEST_F(ScheduleArchiveTest, RefusesAPathThatIsNotThereAndOneThatIsNoFile) {
    const auto missing = folder.path() / "missing";
    EXPECT_FALSE(open(ScheduleSource::fromPath(missing)));
    EXPECT_EQ(message(), missing.string() + ": No such file or directory");
    EXPECT_EQ(code(), ScheduleErrorCode::CannotRead);
    const auto pipe = folder.path() / "pipe";
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_FALSE(open(ScheduleSource::fromPath(pipe)));
    EXPECT_EQ(message(), pipe.string() + ": is neither a file nor a folder");
}

TEST_F(ScheduleArchiveTest, APipeInAFolderIsNoFileOfTheSchedule) {
    ASSERT_EQ(mkfifo((folder.path() / "routes.txt").c_str(), 0600), 0);
    EXPECT_FALSE(open(ScheduleSource::fromPath(folder.path())));
    EXPECT_THAT(message(), HasSubstr("holds no routes.txt"));
}

TEST_F(ScheduleArchiveTest, AZipFileCutAnywhereIsRefusedOrFailsWhileRead) {
    const auto bytes = testing::zipOf(testing::smallSchedule());
    for (std::size_t length = 0; length < bytes->length(); ++length) {
        // In a block of exactly that size, so that a read beyond it is seen.
        const auto cut = NSData::dataWithBytes(bytes->bytes().first(length));
        EXPECT_FALSE(open(ScheduleSource::fromBytes(cut, "city.zip"))) << length;
        EXPECT_TRUE(error) << length;
    }
}

TEST_F(ScheduleArchiveTest, AnEncryptedFileIsSaidToBeOne) {
    const auto bytes = testing::zipOf(testing::smallSchedule());
    std::string encrypted(bytes->stringView());
    constexpr std::size_t Flags = 8; // of an entry of the directory
    for (auto entry = encrypted.find("PK\x01\x02"); entry != std::string::npos;
         entry = encrypted.find("PK\x01\x02", entry + 1))
        encrypted[entry + Flags] |= 1;
    const auto archive = openBytes(encrypted);
    ASSERT_TRUE(archive) << message();
    EXPECT_FALSE(archive->openFile("routes.txt", error));
    EXPECT_EQ(message(),
              "city.zip: routes.txt: is encrypted; only archives without a password can be read");
    EXPECT_EQ(code(), ScheduleErrorCode::CannotRead);
}

TEST_F(ScheduleArchiveTest, ADamagedFileFailsWhileItIsRead) {
    const auto bytes = testing::zipOf(testing::smallSchedule());
    std::vector<std::uint8_t> damaged(bytes->bytes().begin(), bytes->bytes().end());
    damaged[60] ^= 0x55U; // inside agency.txt's compressed bytes
    const auto archive =
        open(ScheduleSource::fromBytes(NSData::dataWithVector(std::move(damaged)), "city.zip"));
    ASSERT_TRUE(archive);
    static_cast<void>(read(*archive, "agency.txt"));
    EXPECT_THAT(message(), HasSubstr("city.zip: agency.txt: cannot be"));
    EXPECT_EQ(code(), ScheduleErrorCode::CannotRead);
}

TEST_F(ScheduleArchiveTest, EveryDamagedByteIsTakenWithoutHarm) {
    const auto bytes = testing::zipOf({{"routes.txt", "route_id\nR1\nR2\nR3\n"}});
    for (std::size_t index = 0; index < bytes->length(); ++index) {
        std::vector<std::uint8_t> damaged(bytes->bytes().begin(), bytes->bytes().end());
        damaged[index] ^= 0xFFU;
        const auto archive =
            open(ScheduleSource::fromBytes(NSData::dataWithVector(std::move(damaged)), "city.zip"));
        if (archive && archive->has("routes.txt")) {
            EXPECT_LE(read(*archive, "routes.txt").size(), 100U);
        }
    }
}

} // namespace
} // namespace orvo
