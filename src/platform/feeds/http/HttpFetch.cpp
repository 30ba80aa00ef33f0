#include "platform/feeds/http/HttpFetch.h"

#include "platform/feeds/http/AsciiText.h"
#include "platform/feeds/http/HttpStatus.h"
#include "platform/feeds/http/HttpURL.h"
#include "platform/feeds/http/Inflation.h"
#include "platform/feeds/http/RetryPauses.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/NSDate.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo {

namespace {

constexpr const char* UserAgent = "orvo-transit-widget";

SourceErrorCode codeOf(HttpAnswer::Failure failure) {
    switch (failure) {
    case HttpAnswer::Failure::Untrusted:
        return SourceErrorCode::Untrusted;
    case HttpAnswer::Failure::TimedOut:
        return SourceErrorCode::TimedOut;
    case HttpAnswer::Failure::TooLarge:
        return SourceErrorCode::TooLarge;
    case HttpAnswer::Failure::Incomplete:
        return SourceErrorCode::Incomplete;
    case HttpAnswer::Failure::None:
    case HttpAnswer::Failure::Unreachable:
        break;
    }
    return SourceErrorCode::Unreachable;
}

bool isRedirect(int status) {
    return status == 301 || status == 302 || status == 303 || status == 307 || status == 308;
}

/// Those that any server may see.
SourceRequest::Pairs openHeaders(const HttpFetch::Validators& validators) {
    SourceRequest::Pairs headers{{"User-Agent", UserAgent}, {"Accept", "*/*"}};
    if (!validators.entityTag.empty())
        headers.emplace_back("If-None-Match", validators.entityTag);
    if (!validators.lastModified.empty())
        headers.emplace_back("If-Modified-Since", validators.lastModified);
    return headers;
}

void setHeader(SourceRequest::Pairs& headers, const std::string& name, const std::string& value) {
    std::erase_if(headers, [&](const auto& header) {
        return asciiLowercased(header.first) == asciiLowercased(name);
    });
    headers.emplace_back(name, value);
}

} // namespace

std::shared_ptr<HttpFetch> HttpFetch::start(std::weak_ptr<HttpTransport> transport,
                                            const SourceRequest& request,
                                            const Validators& validators,
                                            const LoadOptions& options,
                                            Completion completion) {
    const std::shared_ptr<HttpFetch> fetch(
        new HttpFetch(std::move(transport), request, validators, options, std::move(completion)));
    fetch->send();
    return fetch;
}

HttpFetch::HttpFetch(std::weak_ptr<HttpTransport> transport,
                     const SourceRequest& request,
                     const Validators& validators,
                     const LoadOptions& options,
                     Completion completion)
    : _transport(std::move(transport))
    , _request(request.withSecretsApart())
    , _options(options)
    , _deadline(Environment::monotonicClock().get()->seconds() + options.totalTimeout)
    , _openHeaders(openHeaders(validators))
    , _url(HttpURL::withQuery(HttpURL::normalized(_request.location).value_or(""), _request.query))
    , _completion(std::move(completion)) {}

void HttpFetch::cancel() {
    std::uint64_t exchange = 0;
    Completion dropped; // what it holds goes outside the lock
    {
        const std::lock_guard lock(_mutex);
        std::swap(dropped, _completion);
        std::swap(exchange, _exchange);
    }
    if (const auto transport = _transport.lock(); transport && exchange != 0)
        transport->cancel(exchange);
}

void HttpFetch::send() {
    HttpExchange exchange;
    exchange.url = _url;
    exchange.headers = _openHeaders;
    if (_isOwnServer) {
        for (const auto& [name, value] : _request.headers)
            setHeader(exchange.headers, name, value);
        if (const auto& user = _request.userPassword)
            setHeader(exchange.headers, "Authorization", "Basic " + HttpURL::base64(*user));
    }
    exchange.maximumBytes = _options.maximumBytes;
    exchange.idleTimeout = _options.idleTimeout;
    exchange.deadline = _deadline;
    exchange.progress = _options.progress;
    const auto transport = _transport.lock();
    const std::lock_guard lock(_mutex);
    if (!transport || !_completion)
        return;
    _exchange =
        transport->start(std::move(exchange), [fetch = shared_from_this()](HttpAnswer answer) {
            const double at = NSDate::date()->timeIntervalSince1970();
            DispatchQueue::globalQueue()->async(
                [fetch, at, answer = std::move(answer)] { fetch->answerCame(answer, at); });
        });
}

void HttpFetch::answerCame(const HttpAnswer& answer, double at) {
    if (answer.failure != HttpAnswer::Failure::None || !isRedirect(answer.status)) {
        finish(resultOf(answer, at));
        return;
    }
    HttpFetchResult result;
    result.at = at;
    result.status = answer.status;
    if ((result.error = redirect(answer)))
        finish(std::move(result));
    else
        send();
}

HttpFetchResult HttpFetch::resultOf(const HttpAnswer& answer, double at) const {
    HttpFetchResult result;
    result.at = at;
    result.status = answer.status;
    if (answer.failure != HttpAnswer::Failure::None) {
        result.error = error(codeOf(answer.failure), answer.reason);
        return result;
    }
    result.entityTag = answer.header("etag");
    result.lastModified = answer.header("last-modified");
    const bool wasConditional = _openHeaders.size() > openHeaders({}).size();
    if (answer.status == 200) {
        takeBody(answer, result);
    } else if (answer.status == 304 && wasConditional) {
        result.isNotModified = true;
    } else {
        result.error = error(SourceErrorCode::Status, describeHttpStatus(answer.status));
        result.retryDelay = retryDelay(answer.header("retry-after"), answer.header("date"), at);
    }
    return result;
}

void HttpFetch::takeBody(const HttpAnswer& answer, HttpFetchResult& result) const {
    const auto coding = asciiLowercased(answer.header("content-encoding"));
    if (coding.empty() || coding == "identity") {
        result.body = answer.body;
        result.isEndTold = answer.isEndTold;
        return;
    }
    if (coding != "gzip" && coding != "x-gzip") {
        result.error = error(SourceErrorCode::Incomplete,
                             "the body came in a compression that was not asked for");
        return;
    }
    auto inflation = inflateGzip(answer.body->bytes(), _options.maximumBytes);
    result.body = std::move(inflation.bytes);
    if (inflation.outcome == Inflation::Outcome::TooLarge)
        result.error = error(SourceErrorCode::TooLarge,
                             fmt::format("larger than {} bytes", _options.maximumBytes));
    else if (!result.body)
        result.error = error(SourceErrorCode::Incomplete, "the compressed body is not whole");
}

std::shared_ptr<NSError> HttpFetch::redirect(const HttpAnswer& answer) {
    const auto next = HttpURL::resolved(_url, answer.header("location"));
    if (!next)
        return error(SourceErrorCode::Redirect,
                     describeHttpStatus(answer.status) + ", but not to a web address");
    if (_redirects == MostRedirects)
        return error(SourceErrorCode::Redirect,
                     fmt::format("redirected more than {} times", MostRedirects));
    if (HttpURL::isSecure(_url) && !HttpURL::isSecure(*next))
        return error(SourceErrorCode::Redirect, "redirected from https to http");
    ++_redirects;
    _isOwnServer = _isOwnServer && HttpURL::isSameServer(_url, *next);
    _url = *next;
    return nullptr;
}

std::shared_ptr<NSError> HttpFetch::error(SourceErrorCode code, const std::string& reason) const {
    const auto place = _request.displayLocation();
    const auto detour =
        _redirects > 0 ? fmt::format(" (redirected to {})", displayLocation(_url)) : std::string();
    return sourceError(code,
                       place + _request.withoutSecrets(fmt::format("{}: {}", detour, reason)));
}

void HttpFetch::finish(HttpFetchResult result) {
    Completion completion;
    {
        const std::lock_guard lock(_mutex);
        std::swap(completion, _completion);
        _exchange = 0;
    }
    if (completion)
        completion(std::move(result));
}

} // namespace orvo
