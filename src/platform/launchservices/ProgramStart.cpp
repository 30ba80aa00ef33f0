#include "platform/launchservices/ProgramStart.h"

#include "platform/foundation/FileDescriptor.h"

#include <cerrno>
#include <fcntl.h>
#include <spawn.h>
#include <sys/mman.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

extern char**
    environ; // NOLINT(readability-redundant-declaration): POSIX has it declared by the program

namespace orvo {

namespace {

/// A file without a name that holds the bytes, to be read from its start: unlike a pipe it never
/// makes the writer wait.
int openInput(const std::shared_ptr<NSData>& input) {
    if (!input)
        return open("/dev/null", O_RDONLY | O_CLOEXEC);
    const int file = memfd_create("orvo-hand-off", MFD_CLOEXEC);
    auto left = input->bytes();
    while (file >= 0 && !left.empty()) {
        const auto written = write(file, left.data(), left.size());
        if (written < 0) {
            close(file);
            return -1;
        }
        left = left.subspan(static_cast<std::size_t>(written));
    }
    if (file >= 0)
        lseek(file, 0, SEEK_SET);
    return file;
}

} // namespace

int startProgram(const std::filesystem::path& program,
                 const std::vector<std::string>& arguments,
                 const std::shared_ptr<NSData>& input) {
    const FileDescriptor standardInput(openInput(input));
    if (standardInput.number() < 0)
        return errno;
    std::string name = program.string();
    std::vector<std::string> copies = arguments;
    std::vector<char*> argv{name.data()};
    for (auto& argument : copies)
        argv.push_back(argument.data());
    argv.push_back(nullptr);

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, standardInput.number(), STDIN_FILENO);
    posix_spawnattr_t attributes;
    posix_spawnattr_init(&attributes);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETSID | POSIX_SPAWN_SETSIGMASK);
    // Whatever this program blocks for itself: what it starts can be asked to end.
    sigset_t none;
    sigemptyset(&none);
    posix_spawnattr_setsigmask(&attributes, &none);
    pid_t child = 0;
    const int failure =
        posix_spawn(&child, name.c_str(), &actions, &attributes, argv.data(), environ);
    posix_spawnattr_destroy(&attributes);
    posix_spawn_file_actions_destroy(&actions);
    if (failure == 0)
        std::thread([child] { waitpid(child, nullptr, 0); }).detach();
    return failure;
}

} // namespace orvo
