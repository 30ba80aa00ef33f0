#pragma once

#include "platform/foundation/NSData.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace orvo {

/// One question to one server. Redirects are not followed, nothing is cached, no cookies are kept,
/// no body is decompressed.
struct HttpExchange {
    std::string url; ///< normalized
    std::vector<std::pair<std::string, std::string>> headers;
    std::uint64_t maximumBytes = 0; ///< of the body as it is sent; more ends the exchange
    double idleTimeout = 0;         ///< seconds without a byte that end the exchange
    double deadline = 0;            ///< its end, in seconds of the environment's monotonic clock
    /// Called while the body arrives, on the network's thread. May be empty.
    std::function<void(std::uint64_t soFar, std::optional<std::uint64_t> total)> progress;
};

/// How an exchange ended.
struct HttpAnswer {
    enum class Failure {
        None,        ///< status, headers and body are whole
        Unreachable, ///< no host, no connection, a broken one
        Untrusted,   ///< TLS
        TimedOut,
        TooLarge,
        Incomplete, ///< shorter than announced
    };
    Failure failure = Failure::None;
    std::string reason; ///< of a failure, in words; may name the host, but holds no URL
    int status = 0;     ///< 0 when none came
    std::vector<std::pair<std::string, std::string>> headers; ///< names in small letters
    std::shared_ptr<NSData> body;                             ///< never nil without a failure
    /// False where the server did not tell how long the body is: then it ends where the connection
    /// does, as one that was cut would.
    bool isEndTold = true;

    /// Empty when there is none.
    [[nodiscard]] std::string_view header(std::string_view nameInSmallLetters) const;
};

/// The way to the network. Any thread.
class HttpTransport {
public:
    using Completion = std::function<void(HttpAnswer)>;

    HttpTransport() = default;
    HttpTransport(const HttpTransport&) = delete;
    HttpTransport& operator=(const HttpTransport&) = delete;
    /// Exchanges under way end without their completion.
    virtual ~HttpTransport() = default;

    /// `completion` is called once, on a thread of the transport's, never inside the call; it must
    /// be quick. Answers a number above 0 that names the exchange.
    virtual std::uint64_t start(HttpExchange exchange, Completion completion) = 0;
    /// Ends the exchange; its completion is not called, unless it is under way already.
    virtual void cancel(std::uint64_t exchange) = 0;

    /// Over the machine's network, HTTP/1.1. Its thread and the toolkit's networking are made with
    /// the first exchange.
    [[nodiscard]] static std::shared_ptr<HttpTransport> network();
};

} // namespace orvo
