#include "support/PrivateBus.h"

#include <csignal>
#include <fstream>
#include <spawn.h>
#include <stdexcept>
#include <sys/wait.h>
#include <unistd.h>

namespace orvo::testing {

namespace {

void writeConfiguration(const std::filesystem::path& file, const std::filesystem::path& socket) {
    std::ofstream(file)
        << "<!DOCTYPE busconfig PUBLIC \"-//freedesktop//DTD D-Bus Bus "
           "Configuration 1.0//EN\" "
           "\"http://www.freedesktop.org/standards/dbus/1.0/busconfig.dtd\">\n"
           "<busconfig><listen>unix:path="
        << socket.string()
        << "</listen><policy context=\"default\"><allow own=\"*\"/>"
           "<allow send_destination=\"*\" eavesdrop=\"true\"/><allow eavesdrop=\"true\"/>"
           "</policy></busconfig>\n";
}

std::string lineFrom(int descriptor) {
    std::string line;
    char character = 0;
    while (read(descriptor, &character, 1) == 1 && character != '\n')
        line += character;
    return line;
}

} // namespace

PrivateBus::PrivateBus() {
    const auto configuration = _folder.path() / "bus.conf";
    writeConfiguration(configuration, _folder.path() / "bus");
    int ends[2];
    if (pipe(ends) != 0)
        throw std::runtime_error("no pipe");
    std::string program = "dbus-daemon";
    std::string file = "--config-file=" + configuration.string();
    std::string stays = "--nofork";
    std::string address = "--print-address=1";
    char* const arguments[] = {program.data(), file.data(), stays.data(), address.data(), nullptr};
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, ends[1], STDOUT_FILENO);
    posix_spawn_file_actions_addclose(&actions, ends[0]);
    const int failed =
        posix_spawnp(&_process, "dbus-daemon", &actions, nullptr, arguments, environ);
    posix_spawn_file_actions_destroy(&actions);
    close(ends[1]);
    if (failed == 0)
        _address = lineFrom(ends[0]);
    close(ends[0]);
    if (_address.empty())
        throw std::runtime_error("dbus-daemon does not start");
}

PrivateBus::~PrivateBus() {
    if (_process > 0) {
        kill(_process, SIGTERM);
        waitpid(_process, nullptr, 0);
    }
}

} // namespace orvo::testing
