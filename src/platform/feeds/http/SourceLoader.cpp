#include "platform/feeds/http/SourceLoader.h"

#include "platform/feeds/http/HttpTransport.h"
#include "platform/feeds/http/_SourceLoad.h"

#include <map>
#include <utility>
#include <vector>

namespace orvo {

LoadOptions LoadOptions::forSchedule() {
    LoadOptions options;
    options.idleTimeout = 30;
    options.totalTimeout = 900;
    options.wholeAfter = 30.0 * 24 * 3600;
    return options;
}

class SourceLoader::Engine {
public:
    Engine(const std::filesystem::path& cacheFolder, std::shared_ptr<HttpTransport> transport)
        : ground(std::make_shared<_SourceGround>(cacheFolder, std::move(transport))) {}

    const std::shared_ptr<_SourceGround> ground;
    std::mutex mutex;
    std::map<std::string, std::shared_ptr<_SourceLoad>> running; // by the request's key
};

std::shared_ptr<SourceLoader> SourceLoader::make(std::filesystem::path cacheFolder) {
    return make(std::move(cacheFolder), HttpTransport::network());
}

std::shared_ptr<SourceLoader> SourceLoader::make(std::filesystem::path cacheFolder,
                                                 std::shared_ptr<HttpTransport> transport) {
    return std::shared_ptr<SourceLoader>(
        new SourceLoader(std::make_shared<Engine>(std::move(cacheFolder), std::move(transport))));
}

SourceLoader::SourceLoader(std::shared_ptr<Engine> engine)
    : _engine(std::move(engine)) {}

SourceLoader::~SourceLoader() {
    std::map<std::string, std::shared_ptr<_SourceLoad>> running;
    {
        const std::lock_guard lock(_engine->mutex);
        std::swap(running, _engine->running);
    }
    for (const auto& [key, load] : running)
        load->cancel();
    _engine->ground->dropTransport();
}

std::shared_ptr<SourceLoad> SourceLoader::load(const SourceRequest& request,
                                               const LoadOptions& options,
                                               Completion completion) {
    const auto key = request.key();
    const std::lock_guard lock(_engine->mutex);
    if (const auto running = _engine->running.find(key); running != _engine->running.end())
        if (auto joined = running->second->join(options.progress, completion))
            return joined;
    auto load = std::make_shared<_SourceLoad>(
        _engine->ground,
        request,
        options,
        [key, weak = std::weak_ptr<Engine>(_engine)](const _SourceLoad& ended) {
            const auto engine = weak.lock();
            if (!engine)
                return;
            const std::lock_guard engineLock(engine->mutex);
            const auto found = engine->running.find(key);
            if (found != engine->running.end() && found->second.get() == &ended)
                engine->running.erase(found);
        });
    _engine->running[key] = load;
    auto first = load->join(options.progress, std::move(completion));
    load->start();
    return first;
}

SourceBody SourceLoader::lastGoodBody(const SourceRequest& request) const {
    return _lastGoodBody(_engine->ground->store(), request.key());
}

} // namespace orvo
