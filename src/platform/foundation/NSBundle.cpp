#include "platform/foundation/NSBundle.h"

#include "platform/foundation/FolderBundle.h"

namespace orvo {

namespace {

std::filesystem::path resourceFolder() {
    std::error_code failed;
    const auto program = std::filesystem::read_symlink("/proc/self/exe", failed);
    const auto installed = program.parent_path().parent_path() / "share/orvo-transit-widget";
    return !failed && std::filesystem::is_directory(installed, failed)
               ? installed
               : std::filesystem::path(ORVO_BUILD_TREE_RESOURCES);
}

} // namespace

std::shared_ptr<NSBundle> NSBundle::mainBundle() {
    return main().get();
}

EnvironmentSlot<std::shared_ptr<NSBundle>>& NSBundle::main() {
    static EnvironmentSlot<std::shared_ptr<NSBundle>> slot(
        [] { return bundleWithPath(resourceFolder()); });
    return slot;
}

std::shared_ptr<NSBundle> NSBundle::bundleWithPath(const std::filesystem::path& folder) {
    return std::make_shared<FolderBundle>(folder);
}

} // namespace orvo
