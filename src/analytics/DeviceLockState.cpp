#include "analytics/DeviceLockState.h"

#include <cstdlib>
#include <dlfcn.h>
#include <syslog.h>

namespace orvo {

namespace {

using GetDeviceLockState = int (*)(const void* options);

constexpr const char* LibraryPath = "/System/Library/PrivateFrameworks/Lockbox.framework/Lockbox";
constexpr const char* InternalLibraryPath =
    "/ZentuInternal/Library/PrivateFrameworks/Lockbox.framework/Lockbox";

void* openLibrary(const char* path) {
    return dlopen((DeviceLockStateSystemRoot().get().string() + path).c_str(), RTLD_NOW);
}

std::filesystem::path defaultSystemRoot() {
    if (const char* const root = std::getenv("ORVO_SYSTEM_ROOT"))
        return root;
    std::error_code failed;
    const auto program = std::filesystem::read_symlink("/proc/self/exe", failed);
    const auto installed = program.parent_path().parent_path() / "lib/orvo-transit-widget";
    return !failed && std::filesystem::is_directory(installed, failed)
               ? installed
               : std::filesystem::path(ORVO_BUILD_TREE);
}

} // namespace

DeviceLockStateFunction SoftLinkDeviceLockState() {
    void* library = openLibrary(LibraryPath);
    if (!library)
        library = openLibrary(InternalLibraryPath);
    if (!library) // The wording, and the path of the first attempt alone, is what log searches look
                  // for.
        syslog(LOG_ERR, "### Failed to Soft Linked: %s", LibraryPath);
    // Looked up even without a library: the process may have the function from elsewhere.
    const auto function =
        reinterpret_cast<GetDeviceLockState>(dlsym(library, "LBXGetDeviceLockState"));
    if (!function)
        return {};
    return [function] {
        return function(nullptr);
    };
}

EnvironmentSlot<DeviceLockStateFunction>& DeviceLockStateSource() {
    // The library is opened at the first question, not when somebody first looks here.
    static EnvironmentSlot<DeviceLockStateFunction> slot([] {
        return DeviceLockStateFunction([] {
            static const DeviceLockStateFunction function = SoftLinkDeviceLockState();
            return function ? function() : 0;
        });
    });
    return slot;
}

int DeviceLockState() {
    return DeviceLockStateSource().get()();
}

EnvironmentSlot<std::filesystem::path>& DeviceLockStateSystemRoot() {
    static EnvironmentSlot<std::filesystem::path> slot(defaultSystemRoot);
    return slot;
}

} // namespace orvo
