#include "platform/foundation/LogWriter.h"

#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <fcntl.h>
#include <optional>
#include <sys/stat.h>
#include <unistd.h>

namespace orvo {
namespace {

LogRecord record(std::string message, std::string redacted) {
    return {LogLevel::Error,
            "com.zentu.Orvo",
            "Result",
            "%{private}@",
            std::move(message),
            std::move(redacted)};
}

TEST(LogWriter, WritesOneLineWithTimeAndOrigin) {
    EXPECT_EQ(LogWriter::line(record("", ""), "Received 3 items.", 1721784520.7),
              "2024-07-24T01:28:40Z com.zentu.Orvo Result error: Received 3 items.\n");
}

TEST(LogWriter, KeepsALineOneLineWhateverItQuotes) {
    EXPECT_EQ(LogWriter::line(record("", ""), "a\nb\x1b[31m\x7f\té", 0),
              "1970-01-01T00:00:00Z com.zentu.Orvo Result error: a\\nb\\x1b[31m\\x7f\\x09é\n");
}

TEST(LogWriter, TellsAStreamByDeviceAndInode) {
    const int file = open("/dev/null", O_RDONLY | O_CLOEXEC);
    struct stat status {};
    fstat(file, &status);
    const auto name = std::to_string(status.st_dev) + ":" + std::to_string(status.st_ino);
    EXPECT_TRUE(LogWriter::isConnectedTo(name.c_str(), file));
    EXPECT_FALSE(LogWriter::isConnectedTo((name + "1").c_str(), file));
    EXPECT_FALSE(LogWriter::isConnectedTo("", file));
    EXPECT_FALSE(LogWriter::isConnectedTo(nullptr, file));
    close(file);
    EXPECT_FALSE(LogWriter::isConnectedTo(name.c_str(), file));
}

/// What the standard writer puts on standard error with that value of `ORVO_LOG`.
std::string standardErrorWith(const char* asked) {
    const char* const given = std::getenv("ORVO_LOG");
    const auto earlier = given ? std::optional<std::string>(given) : std::nullopt;
    setenv("ORVO_LOG", asked, 1);
    const testing::StoppedClock clock(1721784520);
    ::testing::internal::CaptureStderr();
    LogWriter::standard()(record("secret", "<private>"));
    auto written = ::testing::internal::GetCapturedStderr();
    if (earlier)
        setenv("ORVO_LOG", earlier->c_str(), 1);
    else
        unsetenv("ORVO_LOG");
    return written;
}

TEST(LogWriter, WritesRedactedTextToStandardErrorByTheEnvironmentsClock) {
    EXPECT_EQ(standardErrorWith("debug"),
              "2024-07-24T01:28:40Z com.zentu.Orvo Result error: <private>\n");
}

TEST(LogWriter, LeavesStandardErrorToThePersonWhereNobodyAsksForALog) {
    EXPECT_EQ(standardErrorWith(""), "");
}

// The process's own settings are read once, so each of these asks in a process of its own.
class LogInAnotherProcess : public ::testing::Test {
protected:
    static void setVariables(const char* log) { setenv("ORVO_LOG", log, 1); }
    void SetUp() override { GTEST_FLAG_SET(death_test_style, "threadsafe"); }
};

TEST_F(LogInAnotherProcess, ShowsPrivateValuesWhereAsked) {
    EXPECT_EXIT(
        {
            setVariables("Mine=debug,private");
            Log::findOrCreate("Mine")->debug("it is %{private}@", "secret");
            std::exit(0);
        },
        ::testing::ExitedWithCode(0),
        "Mine debug: it is secret\n");
}

TEST_F(LogInAnotherProcess, WritesNothingBelowItsLevel) {
    EXPECT_EXIT(
        {
            setVariables("Mine=error");
            Log::findOrCreate("Mine")->write(LogLevel::Default, "quiet");
            Log::findOrCreate("Other")->info("quiet");
            Log::findOrCreate("Mine")->error("loud");
            std::exit(0);
        },
        ::testing::ExitedWithCode(0),
        "^[^\n]*Mine error: loud\n$");
}

TEST_F(LogInAnotherProcess, SaysWhatItDoesNotUnderstand) {
    EXPECT_EXIT(
        {
            setVariables("nonsense");
            Log::findOrCreate("Mine")->error("loud");
            std::exit(0);
        },
        ::testing::ExitedWithCode(0),
        "Log error: ORVO_LOG: 'nonsense' is neither.*\n.*Mine error: loud");
}

} // namespace
} // namespace orvo
