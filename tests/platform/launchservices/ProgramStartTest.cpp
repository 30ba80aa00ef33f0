#include "platform/launchservices/ProgramStart.h"

#include "platform/launchservices/ScriptedProgram.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <csignal>

namespace orvo {
namespace {

TEST(ProgramStart, HandsArgumentsAndInputOver) {
    const testing::ScriptedProgram program;
    EXPECT_EQ(startProgram(program.path(), {"a", "b c"}, NSData::dataWithString("input")), 0);
    EXPECT_EQ(program.report(), "a b c|input");
}

TEST(ProgramStart, NilInputIsAnEmptyOne) {
    const testing::ScriptedProgram program;
    EXPECT_EQ(startProgram(program.path(), {}, nullptr), 0);
    EXPECT_EQ(program.report(), "|");
}

TEST(ProgramStart, InputLargerThanAnyPipeDoesNotMakeItWait) {
    const std::string large(std::size_t{4} << 20U, 'x');
    const testing::ScriptedProgram program;
    EXPECT_EQ(startProgram(program.path(), {}, NSData::dataWithString(large)), 0);
    EXPECT_EQ(program.report(), "|" + large);
}

TEST(ProgramStart, AnswersWhyItCouldNotStart) {
    const testing::TemporaryFolder folder;
    EXPECT_EQ(startProgram(folder.path() / "none", {}, nullptr), ENOENT);
    std::ofstream(folder.path() / "file") << "no program";
    EXPECT_EQ(startProgram(folder.path() / "file", {}, nullptr), EACCES);
}

TEST(ProgramStart, ItIsItsOwnSession) {
    const testing::TemporaryFolder folder;
    const auto pipe = folder.path() / "pipe";
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    // The process, its session.
    ASSERT_EQ(startProgram("/bin/sh",
                           {"-c", "echo $$ $(cut -d' ' -f6 /proc/$$/stat) > " + pipe.string()},
                           nullptr),
              0);
    std::ifstream report(pipe);
    long process = 0;
    long session = 1;
    report >> process >> session;
    EXPECT_EQ(process, session);
}

TEST(ProgramStart, SignalsThatAreBlockedHereReachIt) {
    const testing::TemporaryFolder folder;
    const auto pipe = folder.path() / "pipe";
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    sigset_t blocked;
    sigset_t earlier;
    sigemptyset(&blocked);
    sigaddset(&blocked, SIGTERM);
    pthread_sigmask(SIG_BLOCK, &blocked, &earlier);
    const int failure =
        startProgram("/bin/sh",
                     {"-c",
                      "while read name value; do test $name = SigBlk: && echo $value; done "
                      "< /proc/$$/status > " +
                          pipe.string()},
                     nullptr);
    pthread_sigmask(SIG_SETMASK, &earlier, nullptr);
    ASSERT_EQ(failure, 0);
    std::string mask;
    std::ifstream(pipe) >> mask;
    EXPECT_EQ(mask, "0000000000000000");
}

} // namespace
} // namespace orvo
