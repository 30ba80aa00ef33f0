#include "platform/feeds/SharedSourceLoader.h"

#include "platform/foundation/Environment.h"

#include <mutex>

namespace orvo {

namespace {

struct Shared {
    std::mutex mutex;
    std::filesystem::path folder;
    std::shared_ptr<SourceLoader> loader;
};

} // namespace

std::shared_ptr<SourceLoader> sharedSourceLoader() {
    // Never destroyed: a worker may still ask while the process ends.
    static auto& shared = *new Shared;
    const auto folder = Environment::profile().get().cache;
    const std::lock_guard lock(shared.mutex);
    if (!shared.loader || shared.folder != folder) {
        shared.loader = SourceLoader::make(folder);
        shared.folder = folder;
    }
    return shared.loader;
}

} // namespace orvo
