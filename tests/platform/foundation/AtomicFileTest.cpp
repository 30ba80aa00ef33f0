#include "platform/foundation/AtomicFile.h"

#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <fstream>
#include <sys/stat.h>
#include <unistd.h>

namespace orvo::AtomicFileTests {
namespace {

class AtomicFileTest : public ::testing::Test {
protected:
    [[nodiscard]] std::unique_ptr<FileLock> lock() const {
        return FileLock::acquire(folder.path() / "lock", nullptr);
    }
    [[nodiscard]] std::shared_ptr<NSError> write(const std::string& content) const {
        return AtomicFile::write(*lock(), path, NSData::dataWithString(content)->bytes());
    }
    [[nodiscard]] std::string content() const {
        const auto data = AtomicFile::read(path);
        return data ? std::string(data->stringView()) : "(nil)";
    }
    static unsigned mode(const std::filesystem::path& path) {
        struct stat status {};
        return stat(path.c_str(), &status) == 0 ? status.st_mode & 0777U : 0;
    }

    testing::TemporaryFolder folder;
    std::filesystem::path path = folder.path() / "file";
};

TEST_F(AtomicFileTest, ReadsWhatWasWrittenLast) {
    EXPECT_FALSE(write("first"));
    EXPECT_FALSE(write(std::string(200'000, 'x')));
    EXPECT_EQ(content(), std::string(200'000, 'x'));
    EXPECT_FALSE(write(""));
    EXPECT_EQ(content(), "");
}

TEST_F(AtomicFileTest, NoFileIsNilWithoutAnError) {
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(AtomicFile::read(path, &error));
    EXPECT_FALSE(error);
}

TEST_F(AtomicFileTest, OnlyThePersonReadsTheFile) {
    const auto earlier = umask(0);
    EXPECT_FALSE(write("secret"));
    umask(earlier);
    EXPECT_EQ(mode(path), 0600U);
    EXPECT_EQ(mode(folder.path() / "lock"), 0600U);
}

TEST_F(AtomicFileTest, AFolderOrAPipeIsAnErrorThatNamesIt) {
    std::filesystem::create_directory(path);
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(AtomicFile::read(path, &error));
    ASSERT_TRUE(error);
    EXPECT_EQ(error->domain(), NSPOSIXErrorDomain);
    EXPECT_EQ(error->code(), EISDIR);
    EXPECT_EQ(error->localizedDescription(), path.string() + ": Is a directory");

    const auto pipe = folder.path() / "pipe";
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_FALSE(AtomicFile::read(pipe, &error));
    EXPECT_EQ(error->code(), EINVAL);
    EXPECT_EQ(error->localizedDescription(), pipe.string() + ": is no regular file");
}

TEST_F(AtomicFileTest, AWriteThatFailsLeavesTheFileAsItWas) {
    EXPECT_FALSE(write("kept"));
    std::filesystem::create_directory(folder.path() / "file.new"); // cannot be written aside
    const auto error = write("lost");
    ASSERT_TRUE(error);
    EXPECT_NE(error->localizedDescription().find("file.new: "), std::string::npos);
    EXPECT_EQ(content(), "kept");
}

TEST_F(AtomicFileTest, WhatAKilledWriterLeftIsWrittenOver) {
    std::ofstream(folder.path() / "file.new") << std::string(1000, 'h');
    EXPECT_FALSE(write("whole"));
    EXPECT_EQ(content(), "whole");
    EXPECT_FALSE(std::filesystem::exists(folder.path() / "file.new"));
}

TEST_F(AtomicFileTest, SettingAsideNeverWritesOver) {
    std::ofstream(folder.path() / "file.damaged-1") << "first";
    EXPECT_FALSE(write("second"));
    std::shared_ptr<NSError> error;
    EXPECT_EQ(AtomicFile::setAside(*lock(), path, &error), folder.path() / "file.damaged-2");
    EXPECT_FALSE(error);
    EXPECT_FALSE(std::filesystem::exists(path));
    EXPECT_EQ(AtomicFile::read(folder.path() / "file.damaged-1")->stringView(), "first");
    EXPECT_EQ(AtomicFile::read(folder.path() / "file.damaged-2")->stringView(), "second");
    EXPECT_TRUE(AtomicFile::setAside(*lock(), path, &error).empty());
    EXPECT_EQ(error->code(), ENOENT);
}

TEST_F(AtomicFileTest, FoldersAreMadeForThePersonAlone) {
    const auto deep = folder.path() / "a" / "b";
    EXPECT_FALSE(AtomicFile::makeFolder(deep));
    EXPECT_EQ(mode(deep), 0700U);
    EXPECT_FALSE(AtomicFile::makeFolder(deep));
    std::ofstream(folder.path() / "taken") << "";
    const auto error = AtomicFile::makeFolder(folder.path() / "taken");
    ASSERT_TRUE(error);
    EXPECT_EQ(error->code(), EEXIST);
}

TEST_F(AtomicFileTest, TheFolderOfALockIsMadeWhereItIsAsked) {
    const auto deep = folder.path() / "a" / "b";
    std::shared_ptr<NSError> error;
    EXPECT_TRUE(AtomicFile::lockMakingFolder(deep / "lock", &error));
    EXPECT_FALSE(error);
    EXPECT_EQ(mode(deep), 0700U);
    std::ofstream(folder.path() / "taken") << "";
    EXPECT_FALSE(AtomicFile::lockMakingFolder(folder.path() / "taken" / "lock", &error));
    ASSERT_TRUE(error);
    EXPECT_EQ(error->code(), EEXIST);
}

TEST_F(AtomicFileTest, ALockThatCannotBeMadeIsAnError) {
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(FileLock::acquire(folder.path() / "none" / "lock", &error));
    EXPECT_EQ(error->code(), ENOENT);
}

} // namespace
} // namespace orvo::AtomicFileTests
