#pragma once

#include "platform/feeds/http/BodyStore.h"
#include "platform/feeds/http/HttpFetch.h"
#include "platform/feeds/http/RetryPauses.h"
#include "platform/feeds/http/SourceLoader.h"

#include <mutex>
#include <vector>

namespace orvo {

/// What the loads of one loader share. Any thread.
class _SourceGround {
public:
    _SourceGround(const std::filesystem::path& cacheFolder,
                  std::shared_ptr<HttpTransport> transport)
        : _store(cacheFolder / "bodies")
        , _pauses(cacheFolder / "pauses")
        , _transport(std::move(transport)) {}

    [[nodiscard]] BodyStore& store() noexcept { return _store; }
    [[nodiscard]] RetryPauses& pauses() noexcept { return _pauses; }

    /// Expired once the loader has gone.
    [[nodiscard]] std::weak_ptr<HttpTransport> transport();
    void dropTransport();

private:
    BodyStore _store;
    RetryPauses _pauses;
    std::mutex _mutex;
    std::shared_ptr<HttpTransport> _transport;
};

/// One load of one request, for all its callers, from the first question to the answer.
class _SourceLoad : public std::enable_shared_from_this<_SourceLoad> {
public:
    using Completion = SourceLoader::Completion;
    using Ended = std::function<void(const _SourceLoad&)>;
    using Progress = decltype(LoadOptions::progress);

    /// `ended` is called once, before the callers are.
    _SourceLoad(std::shared_ptr<_SourceGround> ground,
                SourceRequest request,
                LoadOptions options,
                Ended ended);

    [[nodiscard]] const SourceRequest& request() const noexcept { return _request; }

    /// Adds a caller. Nil when the load has ended already.
    [[nodiscard]] std::shared_ptr<SourceLoad> join(Progress progress, Completion completion);
    /// To be called once, after the first caller was added.
    void start();
    /// Ends it for all callers with a cancellation error.
    void cancel();

private:
    struct Caller;

    // On worker queues, one after the other.
    void begin();
    void readFile(const std::filesystem::path& path);
    void fetch(bool mayBeConditional);
    void fetched(HttpFetchResult result);
    void notePause(double seconds, int status);
    void gotWhole(HttpFetchResult result);
    void gotValidated(const HttpFetchResult& result);

    [[nodiscard]] bool isConditional(const BodyRecord& record) const;
    void tellProgress(std::uint64_t soFar, std::optional<std::uint64_t> total);
    void cancel(const Caller& caller);
    /// With the last good body beside it.
    void fail(std::shared_ptr<NSError> error);
    void complete(const SourceBody& body);

    const std::shared_ptr<_SourceGround> _ground;
    const SourceRequest _request;
    const LoadOptions _options;
    const std::string _key;
    std::optional<BodyRecord> _known; // what the request under way is conditional on

    std::mutex _mutex;
    std::vector<std::shared_ptr<Caller>> _callers;
    bool _hasEnded = false;
    Ended _ended;
    std::shared_ptr<HttpFetch> _fetch;
};

/// The body that a failed load gives: the last good one, without outcome and error.
[[nodiscard]] SourceBody _lastGoodBody(const BodyStore& store, const std::string& key);

} // namespace orvo
