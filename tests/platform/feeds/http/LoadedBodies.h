#pragma once

#include "platform/feeds/http/SourceLoader.h"

#include <condition_variable>
#include <mutex>
#include <vector>

namespace orvo::testing {

/// Collects answers, and waits for them.
class LoadedBodies {
public:
    [[nodiscard]] SourceLoader::Completion completion() {
        return [this](SourceBody body) {
            // Told under the lock: the one who waits may take this object away at once.
            const std::lock_guard lock(_mutex);
            _bodies.push_back(std::move(body));
            _changed.notify_all();
        };
    }
    std::vector<SourceBody> waitFor(std::size_t count) {
        std::unique_lock lock(_mutex);
        _changed.wait(lock, [&] { return _bodies.size() >= count; });
        return _bodies;
    }

private:
    std::mutex _mutex;
    std::condition_variable _changed;
    std::vector<SourceBody> _bodies;
};

inline SourceBody
load(SourceLoader& loader, const SourceRequest& request, const LoadOptions& options = {}) {
    LoadedBodies bodies;
    (void)loader.load(request, options, bodies.completion());
    return bodies.waitFor(1).front();
}

inline SourceRequest requestFor(std::string location) {
    SourceRequest request;
    request.location = std::move(location);
    return request;
}

inline std::string textOf(const SourceBody& body) {
    return body.bytes ? std::string(body.bytes->stringView()) : "(nil)";
}

inline std::string messageOf(const SourceBody& body) {
    return body.error ? body.error->localizedDescription() : "";
}

inline SourceErrorCode codeOf(const SourceBody& body) {
    return body.error && body.error->domain() == SourceErrorDomain
               ? static_cast<SourceErrorCode>(body.error->code())
               : SourceErrorCode{};
}

} // namespace orvo::testing
