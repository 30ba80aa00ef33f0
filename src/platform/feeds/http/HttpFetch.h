#pragma once

#include "platform/feeds/http/HttpTransport.h"
#include "platform/feeds/http/SourceLoader.h"

#include <functional>
#include <memory>
#include <mutex>
#include <optional>

namespace orvo {

/// How a fetch ended.
struct HttpFetchResult {
    /// Exactly one of these two, unless `error` is set: the body, or that it is the known one.
    std::shared_ptr<NSData> body;
    bool isNotModified = false;
    /// Whether the server told where the body ends, or its compression did.
    bool isEndTold = true;
    std::string entityTag;    ///< ETag of the answer; empty for none
    std::string lastModified; ///< Last-Modified of the answer; empty for none
    double at = 0;            ///< when the answer came, in seconds since 1970
    std::shared_ptr<NSError> error;
    int status = 0; ///< of the last answer; 0 when none came
    /// For how many seconds the server asked to be left alone.
    std::optional<double> retryDelay;
};

/// One request for a remote source, over as many redirects as it takes: at most five, none from
/// https to http. The request's headers and user go to the server that it names, and to no other.
class HttpFetch : public std::enable_shared_from_this<HttpFetch> {
public:
    static constexpr int MostRedirects = 5;

    struct Validators {
        std::string entityTag;
        std::string lastModified;
    };
    using Completion = std::function<void(HttpFetchResult)>;

    /// `completion` is called on a worker queue; once, or never after `cancel()`. The transport is
    /// not kept alive: when it goes, the completion is not called.
    [[nodiscard]] static std::shared_ptr<HttpFetch> start(std::weak_ptr<HttpTransport> transport,
                                                          const SourceRequest& request,
                                                          const Validators& validators,
                                                          const LoadOptions& options,
                                                          Completion completion);
    void cancel();

private:
    HttpFetch(std::weak_ptr<HttpTransport> transport,
              const SourceRequest& request,
              const Validators& validators,
              const LoadOptions& options,
              Completion completion);

    void send();
    void answerCame(const HttpAnswer& answer, double at);
    [[nodiscard]] HttpFetchResult resultOf(const HttpAnswer& answer, double at) const;
    /// Puts the content of the answer's body into the result, or why it has none.
    void takeBody(const HttpAnswer& answer, HttpFetchResult& result) const;
    /// Goes where the answer points; nil, or why not.
    [[nodiscard]] std::shared_ptr<NSError> redirect(const HttpAnswer& answer);
    [[nodiscard]] std::shared_ptr<NSError> error(SourceErrorCode code,
                                                 const std::string& reason) const;
    void finish(HttpFetchResult result);

    const std::weak_ptr<HttpTransport> _transport;
    const SourceRequest _request; // its location holds no secrets
    const LoadOptions _options;
    const double _deadline;
    const SourceRequest::Pairs _openHeaders; // that any server may see
    // Of the hop under way; hops follow one another.
    std::string _url;
    bool _isOwnServer = true; // only ever the one that the request names has been asked
    int _redirects = 0;

    std::mutex _mutex;
    Completion _completion; // empty at the end
    std::uint64_t _exchange = 0;
};

} // namespace orvo
