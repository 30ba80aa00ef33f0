#include "platform/feeds/http/_SourceLoad.h"

#include "platform/feeds/http/HttpStatus.h"
#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Log.h"
#include "platform/foundation/NSDate.h"

#include <algorithm>
#include <cmath>
#include <fmt/format.h>
#include <utility>

namespace orvo {

namespace {

double wallNow() {
    return NSDate::date()->timeIntervalSince1970();
}

std::shared_ptr<NSError> cancellation(const SourceRequest& request) {
    return NSError::errorWithMessage(NSCocoaErrorDomain,
                                     NSUserCancelledError,
                                     request.displayLocation() + ": the load was cancelled");
}

/// Each on its own, so that one that takes its time holds up nobody else.
void answer(SourceLoader::Completion completion, SourceBody body) {
    DispatchQueue::globalQueue()->async(
        [completion = std::move(completion), body = std::move(body)] { completion(body); });
}

SourceBody failedBody(std::shared_ptr<NSError> error) {
    SourceBody body;
    body.error = std::move(error);
    return body;
}

} // namespace

std::weak_ptr<HttpTransport> _SourceGround::transport() {
    const std::lock_guard lock(_mutex);
    return _transport;
}

void _SourceGround::dropTransport() {
    std::shared_ptr<HttpTransport> dropped; // it waits for its thread, and that outside the lock
    const std::lock_guard lock(_mutex);
    std::swap(dropped, _transport);
}

struct _SourceLoad::Caller final : public SourceLoad {
    Caller(std::weak_ptr<_SourceLoad> ofLoad, Progress itsProgress, Completion itsCompletion)
        : load(std::move(ofLoad))
        , progress(std::move(itsProgress))
        , completion(std::move(itsCompletion)) {}

    void cancel() override {
        if (const auto alive = load.lock())
            alive->cancel(*this);
    }

    const std::weak_ptr<_SourceLoad> load;
    const Progress progress;
    Completion completion; // moved out when it is called
};

_SourceLoad::_SourceLoad(std::shared_ptr<_SourceGround> ground,
                         SourceRequest request,
                         LoadOptions options,
                         Ended ended)
    : _ground(std::move(ground))
    , _request(std::move(request))
    , _options(std::move(options))
    , _key(_request.key())
    , _ended(std::move(ended)) {}

std::shared_ptr<SourceLoad> _SourceLoad::join(Progress progress, Completion completion) {
    const std::lock_guard lock(_mutex);
    if (_hasEnded)
        return nullptr;
    return _callers.emplace_back(
        std::make_shared<Caller>(weak_from_this(), std::move(progress), std::move(completion)));
}

void _SourceLoad::start() {
    DispatchQueue::globalQueue()->async([load = shared_from_this()] { load->begin(); });
}

void _SourceLoad::begin() {
    if (auto problem = _request.problem()) {
        complete(failedBody(std::move(problem)));
        return;
    }
    if (const auto path = _request.localPath()) {
        readFile(*path);
        return;
    }
    const auto pause =
        _ground->pauses().pending(_key, Environment::monotonicClock().get()->seconds());
    if (pause && !_options.inPause)
        fail(sourceError(SourceErrorCode::RetryLater,
                         fmt::format("{}: the server asked to be left alone for {:.0f} seconds "
                                     "more ({})",
                                     _request.displayLocation(),
                                     std::ceil(pause->seconds),
                                     describeHttpStatus(pause->status))));
    else
        fetch(!_options.unconditional);
}

void _SourceLoad::readFile(const std::filesystem::path& path) {
    const auto unreadable = [&](const std::string& message) {
        complete(failedBody(sourceError(SourceErrorCode::Unreadable, message)));
    };
    std::error_code ignored;
    const auto size = std::filesystem::file_size(path, ignored);
    if (!ignored && size > _options.maximumBytes) {
        complete(failedBody(sourceError(
            SourceErrorCode::TooLarge,
            fmt::format("{}: larger than {} bytes", path.string(), _options.maximumBytes))));
        return;
    }
    std::shared_ptr<NSError> error;
    SourceBody body;
    body.bytes = AtomicFile::read(path, &error);
    if (!body.bytes) {
        unreadable(error ? error->localizedDescription()
                         : path.string() + ": there is no such file");
        return;
    }
    if (auto refusal = _options.check ? _options.check(*body.bytes) : nullptr) {
        complete(failedBody(std::move(refusal)));
        return;
    }
    body.outcome = SourceBody::Outcome::Whole;
    body.fetchedAt = body.receivedAt = wallNow();
    complete(body);
}

bool _SourceLoad::isConditional(const BodyRecord& record) const {
    const double age = wallNow() - record.receivedAt;
    return record.hasValidator() && record.validations < _options.wholeAfterValidations &&
           age >= 0 && age <= _options.wholeAfter;
}

void _SourceLoad::fetch(bool mayBeConditional) {
    _known = _ground->store().record(_key);
    if (_known && !(mayBeConditional && isConditional(*_known)))
        _known.reset();
    HttpFetch::Validators validators;
    if (_known)
        validators = {_known->entityTag, _known->lastModified};
    auto options = _options;
    options.progress = [weak = weak_from_this()](std::uint64_t soFar,
                                                 std::optional<std::uint64_t> total) {
        if (const auto load = weak.lock())
            load->tellProgress(soFar, total);
    };
    const std::lock_guard lock(_mutex);
    if (_hasEnded)
        return;
    _fetch = HttpFetch::start(
        _ground->transport(),
        _request,
        validators,
        options,
        [load = shared_from_this()](HttpFetchResult result) { load->fetched(std::move(result)); });
}

void _SourceLoad::fetched(HttpFetchResult result) {
    if (result.retryDelay)
        notePause(*result.retryDelay, result.status);
    else if (!result.error && _options.inPause)
        _ground->pauses().forget(_key);
    if (result.error)
        fail(std::move(result.error));
    else if (result.isNotModified)
        gotValidated(result);
    else
        gotWhole(std::move(result));
}

void _SourceLoad::notePause(double seconds, int status) {
    const double now = Environment::monotonicClock().get()->seconds();
    if (const auto error = _ground->pauses().note(_key, seconds, status, now))
        Log::findOrCreate("Feeds")->error("that %@ wants a pause is not kept on the disk: %@",
                                          _request.displayLocation(),
                                          error->localizedDescription());
}

void _SourceLoad::gotWhole(HttpFetchResult result) {
    if (!result.isEndTold && !(_options.isWhole && _options.isWhole(result.body))) {
        fail(sourceError(SourceErrorCode::Incomplete,
                         _request.displayLocation() +
                             ": the server does not tell how long the body is, so that nobody can "
                             "know whether all of it came"));
        return;
    }
    if (auto refusal = _options.check ? _options.check(*result.body) : nullptr) {
        fail(std::move(refusal));
        return;
    }
    BodyRecord record;
    record.entityTag = std::move(result.entityTag);
    record.lastModified = std::move(result.lastModified);
    record.receivedAt = record.validatedAt = result.at;
    SourceBody body;
    body.outcome = SourceBody::Outcome::Whole;
    body.bytes = result.body;
    body.fetchedAt = body.receivedAt = result.at;
    if (const auto error = _ground->store().save(_key, std::move(record), std::move(result.body)))
        Log::findOrCreate("Feeds")->error("%@ is not kept on the disk: %@",
                                          _request.displayLocation(),
                                          error->localizedDescription());
    complete(body);
}

void _SourceLoad::gotValidated(const HttpFetchResult& result) {
    SourceBody body;
    body.bytes = _ground->store().body(_key, *_known);
    if (!body.bytes) {
        fetch(false); // what was validated is damaged: whole, then
        return;
    }
    auto record = *_known;
    record.validatedAt = std::max(result.at, record.receivedAt);
    ++record.validations;
    if (!result.entityTag.empty())
        record.entityTag = result.entityTag;
    if (const auto error = _ground->store().update(_key, record))
        Log::findOrCreate("Feeds")->error("%@ is not noted as validated: %@",
                                          _request.displayLocation(),
                                          error->localizedDescription());
    body.outcome = SourceBody::Outcome::Validated;
    body.fetchedAt = record.validatedAt;
    body.receivedAt = record.receivedAt;
    complete(body);
}

void _SourceLoad::tellProgress(std::uint64_t soFar, std::optional<std::uint64_t> total) {
    std::vector<std::shared_ptr<Caller>> callers;
    {
        const std::lock_guard lock(_mutex);
        callers = _callers;
    }
    for (const auto& caller : callers)
        if (caller->progress)
            caller->progress(soFar, total);
}

void _SourceLoad::cancel(const Caller& caller) {
    std::shared_ptr<Caller> cancelled;
    bool isLast = false;
    {
        const std::lock_guard lock(_mutex);
        const auto found =
            std::ranges::find(_callers, &caller, [](const auto& one) { return one.get(); });
        if (found == _callers.end())
            return;
        cancelled = std::move(*found);
        _callers.erase(found);
        isLast = _callers.empty();
    }
    answer(std::move(cancelled->completion), failedBody(cancellation(_request)));
    if (isLast)
        cancel();
}

void _SourceLoad::cancel() {
    complete(failedBody(cancellation(_request)));
}

void _SourceLoad::fail(std::shared_ptr<NSError> error) {
    auto body = _lastGoodBody(_ground->store(), _key);
    body.error = std::move(error);
    complete(body);
}

void _SourceLoad::complete(const SourceBody& body) {
    std::vector<std::shared_ptr<Caller>> callers;
    std::shared_ptr<HttpFetch> fetch;
    Ended ended;
    {
        const std::lock_guard lock(_mutex);
        if (_hasEnded)
            return;
        _hasEnded = true;
        std::swap(callers, _callers);
        std::swap(fetch, _fetch);
        std::swap(ended, _ended);
    }
    if (fetch)
        fetch->cancel();
    ended(*this);
    for (const auto& caller : callers)
        answer(std::move(caller->completion), body);
}

SourceBody _lastGoodBody(const BodyStore& store, const std::string& key) {
    SourceBody body;
    const auto record = store.record(key);
    if (!record)
        return body;
    body.bytes = store.body(key, *record);
    if (body.bytes) {
        body.fetchedAt = record->validatedAt;
        body.receivedAt = record->receivedAt;
    }
    return body;
}

} // namespace orvo
