#include "platform/foundation/NSUserDefaults.h"

#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSMutableSet.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"
#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <csignal>
#include <fstream>
#include <sys/stat.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace orvo::NSUserDefaultsTests {
namespace {

constexpr const char* Suite = "group.com.zentu.Orvo";

class NSUserDefaultsTest : public ::testing::Test {
protected:
    static std::shared_ptr<NSUserDefaults> defaults() {
        return NSUserDefaults::initWithSuiteName(Suite);
    }
    [[nodiscard]] std::filesystem::path folder() const { return profile.path() / "data"; }
    [[nodiscard]] std::filesystem::path file() const {
        return folder() / "group.com.zentu.Orvo.plist";
    }
    void writeFile(const std::string& content) const {
        std::filesystem::create_directories(folder());
        std::ofstream(file(), std::ios::binary) << content;
    }
    [[nodiscard]] std::vector<std::string> files() const {
        std::vector<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(folder()))
            names.push_back(entry.path().filename().string());
        std::ranges::sort(names);
        return names;
    }

    testing::TemporaryProfile profile;
};

TEST_F(NSUserDefaultsTest, ANameThatIsNoFileNameIsNil) {
    EXPECT_FALSE(NSUserDefaults::initWithSuiteName(""));
    EXPECT_FALSE(NSUserDefaults::initWithSuiteName("a/b"));
    EXPECT_FALSE(NSUserDefaults::initWithSuiteName(std::string("a\0b", 3)));
    EXPECT_EQ(defaults()->suiteName(), Suite);
}

TEST_F(NSUserDefaultsTest, EachCallAnswersANewObjectWithTheSameContent) {
    const auto a = defaults();
    const auto b = defaults();
    EXPECT_NE(a, b);
    EXPECT_FALSE(a->setObject_forKey(NSString::string("x"), "key"));
    EXPECT_EQ(b->stringForKey("key"), "x");
}

TEST_F(NSUserDefaultsTest, ReadingMakesNoFile) {
    EXPECT_FALSE(defaults()->objectForKey("key"));
    EXPECT_FALSE(defaults()->removeObjectForKey("key"));
    EXPECT_FALSE(std::filesystem::exists(file()));
}

TEST_F(NSUserDefaultsTest, TheFileIsThePersonsAndABinaryPropertyList) {
    EXPECT_FALSE(defaults()->setBool_forKey(true, "key"));
    struct stat status {};
    ASSERT_EQ(stat(file().c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777U, 0600U);
    ASSERT_EQ(stat(folder().c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777U, 0700U);
    const auto list = PropertyList::read(AtomicFile::read(file())->bytes());
    EXPECT_EQ(list->description(), "{key = 1}");
    EXPECT_EQ(files(),
              (std::vector<std::string>{"group.com.zentu.Orvo.plist",
                                        "group.com.zentu.Orvo.plist.lock"}));
}

TEST_F(NSUserDefaultsTest, OtherKeysAreKept) {
    for (const char* key : {"b", "a", "c"})
        EXPECT_FALSE(defaults()->setObject_forKey(NSString::string(key), key));
    EXPECT_FALSE(defaults()->setObject_forKey(NSString::string("new"), "a"));
    EXPECT_EQ(defaults()->dictionaryRepresentation()->description(), "{b = b; a = new; c = c}");
    EXPECT_FALSE(defaults()->removeObjectForKey("b"));
    EXPECT_FALSE(defaults()->setObject_forKey(nullptr, "c"));
    EXPECT_EQ(defaults()->dictionaryRepresentation()->description(), "{a = new}");
}

TEST_F(NSUserDefaultsTest, ValuesOfAnotherClassAreNil) {
    defaults()->setObject_forKey(NSData::dataWithString("d"), "data");
    defaults()->setObject_forKey(NSString::string("s"), "text");
    EXPECT_EQ(defaults()->dataForKey("data")->stringView(), "d");
    EXPECT_FALSE(defaults()->dataForKey("text"));
    EXPECT_FALSE(defaults()->dataForKey("none"));
    EXPECT_EQ(defaults()->stringForKey("data"), std::nullopt);
}

TEST_F(NSUserDefaultsTest, TruthOfNumbersAndTexts) {
    EXPECT_FALSE(defaults()->boolForKey("absent"));
    for (const char* text : {"YES", "yes", "Yes", "true", "TRUE", "1"}) {
        defaults()->setObject_forKey(NSString::string(text), "key");
        EXPECT_TRUE(defaults()->boolForKey("key")) << text;
    }
    for (const char* text : {"NO", "no", "false", "0", "", "maybe"}) {
        defaults()->setObject_forKey(NSString::string(text), "key");
        EXPECT_FALSE(defaults()->boolForKey("key")) << text;
    }
    defaults()->setObject_forKey(NSNumber::numberWithInteger(-2), "key");
    EXPECT_TRUE(defaults()->boolForKey("key"));
    defaults()->setBool_forKey(false, "key");
    EXPECT_FALSE(defaults()->boolForKey("key"));
    defaults()->setObject_forKey(NSData::dataWithString("1"), "key");
    EXPECT_FALSE(defaults()->boolForKey("key"));
}

TEST_F(NSUserDefaultsTest, WholeNumbersOfNumbersAndTexts) {
    const auto of = [](const std::shared_ptr<NSObject>& value) {
        defaults()->setObject_forKey(value, "key");
        return defaults()->integerForKey("key");
    };
    EXPECT_EQ(defaults()->integerForKey("absent"), 0);
    EXPECT_EQ(of(NSNumber::numberWithInteger(-7)), -7);
    EXPECT_EQ(of(NSNumber::numberWithDouble(2.9)), 2);
    EXPECT_EQ(of(NSString::string("12 lines")), 12);
    EXPECT_EQ(of(NSString::string("lines")), 0);
}

TEST_F(NSUserDefaultsTest, AValueThatNoListHoldsIsAMistakeOfTheCaller) {
    EXPECT_THROW(defaults()->setObject_forKey(NSMutableSet::set(), "key"),
                 NSInvalidArgumentException);
    EXPECT_FALSE(std::filesystem::exists(file()));
}

TEST_F(NSUserDefaultsTest, TheDemonstrationKeepsTheSuitesNameInItsOwnFolder) {
    defaults()->setObject_forKey(NSString::string("person"), "who");
    {
        const auto demo = Environment::profile().overrideWith(
            {profile.path() / "demo", profile.path() / "demo", profile.path() / "demo"});
        EXPECT_FALSE(defaults()->objectForKey("who"));
        defaults()->setObject_forKey(NSString::string("demo"), "who");
        EXPECT_TRUE(std::filesystem::exists(profile.path() / "demo/group.com.zentu.Orvo.plist"));
    }
    EXPECT_EQ(defaults()->stringForKey("who"), "person");
}

TEST_F(NSUserDefaultsTest, ADamagedFileIsSetAsideAndTheSettingsBeginAnew) {
    const testing::LogCapture log;
    writeFile("no property list");
    EXPECT_FALSE(defaults()->objectForKey("key"));
    EXPECT_EQ(AtomicFile::read(file().string() + ".damaged-1")->stringView(), "no property list");
    EXPECT_FALSE(std::filesystem::exists(file()));
    ASSERT_EQ(log.messages().size(), 1U);
    EXPECT_EQ(log.messages()[0],
              file().string() +
                  " was damaged (property list, byte 0: the header bplist00 is missing) and now "
                  "lies at " +
                  file().string() + ".damaged-1; the settings begin anew");

    writeFile("again"); // found by a write this time
    EXPECT_FALSE(defaults()->setBool_forKey(true, "key"));
    EXPECT_EQ(AtomicFile::read(file().string() + ".damaged-1")->stringView(), "no property list");
    EXPECT_EQ(AtomicFile::read(file().string() + ".damaged-2")->stringView(), "again");
    EXPECT_TRUE(defaults()->boolForKey("key"));
}

TEST_F(NSUserDefaultsTest, WhatCanBeReadOrIsNotThereIsNotUnreadable) {
    EXPECT_FALSE(defaults()->unreadable());
    defaults()->setBool_forKey(true, "key");
    EXPECT_FALSE(defaults()->unreadable());
}

TEST_F(NSUserDefaultsTest, AListThatIsNoDictionaryIsDamaged) {
    const testing::LogCapture log;
    writeFile(std::string(PropertyList::write(*NSString::string("x"))->stringView()));
    EXPECT_FALSE(defaults()->objectForKey("key"));
    EXPECT_TRUE(std::filesystem::exists(file().string() + ".damaged-1"));
}

TEST_F(NSUserDefaultsTest, AFileThatCannotBeReadIsNeverWrittenOver) {
    const testing::LogCapture log;
    std::filesystem::create_directories(file()); // a folder in its place
    EXPECT_FALSE(defaults()->objectForKey("key"));
    EXPECT_EQ(log.messages(),
              (std::vector<std::string>{file().string() + " counts as empty: " + file().string() +
                                        ": Is a directory"}));
    ASSERT_TRUE(defaults()->unreadable());
    EXPECT_EQ(defaults()->unreadable()->localizedDescription(),
              file().string() + ": Is a directory");
    const auto error = defaults()->setBool_forKey(true, "key");
    ASSERT_TRUE(error);
    EXPECT_EQ(error->localizedDescription(), file().string() + ": Is a directory");
    EXPECT_TRUE(std::filesystem::is_directory(file()));
}

TEST_F(NSUserDefaultsTest, AFolderThatCannotBeMadeIsAnError) {
    std::ofstream(profile.path() / "data") << "in the way";
    const auto error = defaults()->setBool_forKey(true, "key");
    ASSERT_TRUE(error);
    EXPECT_NE(error->localizedDescription().find((profile.path() / "data").string()),
              std::string::npos);
}

TEST_F(NSUserDefaultsTest, WritesKeptInMemoryShowEverywhereAndLeaveTheDiskAlone) {
    defaults()->setObject_forKey(NSString::string("disk"), "a");
    defaults()->setObject_forKey(NSString::string("disk"), "b");
    const auto before = AtomicFile::read(file());
    {
        const auto scope = Environment::keepsWritesInMemory().overrideWith(true);
        EXPECT_FALSE(defaults()->setObject_forKey(NSString::string("memory"), "a"));
        EXPECT_FALSE(defaults()->setObject_forKey(NSString::string("memory"), "c"));
        EXPECT_FALSE(defaults()->removeObjectForKey("b"));
        EXPECT_EQ(defaults()->dictionaryRepresentation()->description(),
                  "{a = memory; c = memory}");
        EXPECT_FALSE(NSUserDefaults::initWithSuiteName("other")->objectForKey("a"));
        EXPECT_TRUE(equal(AtomicFile::read(file()), before));
    }
    EXPECT_EQ(defaults()->dictionaryRepresentation()->description(), "{a = disk; b = disk}");
}

TEST_F(NSUserDefaultsTest, WritesKeptInMemoryEndWithTheirScope) {
    {
        const auto scope = Environment::keepsWritesInMemory().overrideWith(true);
        defaults()->setBool_forKey(true, "key");
    }
    const auto scope = Environment::keepsWritesInMemory().overrideWith(true);
    EXPECT_FALSE(defaults()->objectForKey("key"));
}

TEST_F(NSUserDefaultsTest, ADamagedFileStaysWhereItIsWhileWritesAreKeptInMemory) {
    const testing::LogCapture log;
    writeFile("damaged");
    const auto scope = Environment::keepsWritesInMemory().overrideWith(true);
    EXPECT_FALSE(defaults()->setBool_forKey(true, "key"));
    EXPECT_TRUE(defaults()->boolForKey("key"));
    EXPECT_EQ(files(), (std::vector<std::string>{"group.com.zentu.Orvo.plist"}));
    ASSERT_TRUE(defaults()->unreadable());
    EXPECT_EQ(defaults()->unreadable()->localizedDescription(),
              file().string() +
                  " is damaged: property list, byte 0: the header bplist00 is missing");
}

TEST_F(NSUserDefaultsTest, ThreadsLoseNothingOfOneAnother) {
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([key = std::to_string(i)] {
            for (int j = 0; j < 25; ++j)
                defaults()->setObject_forKey(
                    NSNumber::numberWithInteger(defaults()->integerForKey(key) + 1), key);
        });
    for (auto& thread : threads)
        thread.join();
    for (int i = 0; i < 4; ++i)
        EXPECT_EQ(defaults()->integerForKey(std::to_string(i)), 25);
}

/// Runs `body` in a process of its own.
template <class Body>
pid_t runInChild(Body body) {
    const auto child = fork();
    if (child == 0) {
        body();
        _exit(0);
    }
    return child;
}

TEST_F(NSUserDefaultsTest, ProcessesLoseNothingOfOneAnother) {
    std::vector<pid_t> children;
    for (const char* key : {"left", "right"})
        children.push_back(runInChild([&] {
            for (int i = 0; i < 100; ++i)
                defaults()->setObject_forKey(
                    NSNumber::numberWithInteger(defaults()->integerForKey(key) + 1), key);
        }));
    for (const auto child : children) {
        int status = -1;
        ASSERT_EQ(waitpid(child, &status, 0), child);
        EXPECT_EQ(status, 0);
    }
    EXPECT_EQ(defaults()->integerForKey("left"), 100);
    EXPECT_EQ(defaults()->integerForKey("right"), 100);
}

TEST_F(NSUserDefaultsTest, AWriterKilledAtAnyMomentLosesNothing) {
    const auto ballast = NSData::dataWithString(std::string(100'000, 'b'));
    ASSERT_FALSE(defaults()->setObject_forKey(NSString::string("kept"), "other"));
    ASSERT_FALSE(defaults()->setObject_forKey(ballast, "ballast"));
    for (int round = 0; round < 40; ++round) {
        std::array<int, 2> confirmed{};
        ASSERT_EQ(pipe(confirmed.data()), 0);
        const auto child = runInChild([&] {
            for (std::int64_t i = 1;; ++i) {
                if (defaults()->setObject_forKey(NSNumber::numberWithInteger(i), "count") ||
                    ::write(confirmed[1], &i, sizeof i) != sizeof i)
                    _exit(1);
            }
        });
        close(confirmed[1]);
        std::int64_t count = 0;
        for (int i = 0; i <= round % 4; ++i)
            ASSERT_EQ(::read(confirmed[0], &count, sizeof count), ssize_t{sizeof count});
        // A moment within the next write, another one each time.
        for (std::atomic<int> spin = 0; spin < round * 20'000;)
            ++spin;
        kill(child, SIGKILL);
        int status = 0;
        ASSERT_EQ(waitpid(child, &status, 0), child);
        ASSERT_TRUE(WIFSIGNALED(status));
        while (::read(confirmed[0], &count, sizeof count) == ssize_t{sizeof count}) {
        }
        close(confirmed[0]);

        EXPECT_GE(defaults()->integerForKey("count"), count);
        EXPECT_LE(defaults()->integerForKey("count"), count + 1);
        EXPECT_EQ(defaults()->stringForKey("other"), "kept");
        EXPECT_TRUE(equal(defaults()->dataForKey("ballast"), ballast));
    }
    for (const auto& name : files())
        EXPECT_EQ(name.find("damaged"), std::string::npos) << name;
}

} // namespace
} // namespace orvo::NSUserDefaultsTests
