#include "platform/feeds/http/_NetworkLibrary.h"

#include <dlfcn.h>

namespace orvo::_NetworkLibrary {

namespace {

constexpr const char* FolderBesidePrograms = "lib/orvo-transit-widget";
constexpr const char* FileName = "OrvoSockets.so";

std::filesystem::path defaultFile() {
    std::error_code failed;
    const auto program = std::filesystem::read_symlink("/proc/self/exe", failed);
    const auto installed = program.parent_path().parent_path() / FolderBesidePrograms;
    const auto folder = !failed && std::filesystem::is_directory(installed, failed)
                            ? installed
                            : std::filesystem::path(ORVO_BUILD_TREE) / FolderBesidePrograms;
    return folder / FileName;
}

/// Of the latest call that failed, on this thread.
std::string loaderReason() {
    const char* const reason = dlerror();
    return reason ? reason : "unknown";
}

} // namespace

EnvironmentSlot<std::filesystem::path>& file() {
    static EnvironmentSlot<std::filesystem::path> slot(defaultFile);
    return slot;
}

std::unique_ptr<NetworkConnection> connectionTo(const std::string& url,
                                                const NetworkConnection::Handlers& handlers,
                                                std::string& reason) {
    // Never closed; opened again it is only found.
    void* const library = dlopen(file().get().c_str(), RTLD_NOW | RTLD_LOCAL);
    const auto make =
        library
            ? reinterpret_cast<MakeNetworkConnection>(dlsym(library, "OrvoMakeNetworkConnection"))
            : nullptr;
    if (make)
        return std::unique_ptr<NetworkConnection>(make(url, handlers));
    reason = "the network's library cannot be used: " + loaderReason();
    return nullptr;
}

} // namespace orvo::_NetworkLibrary
