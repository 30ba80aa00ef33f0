#pragma once

#include "platform/feeds/http/HttpResponseParser.h"
#include "platform/feeds/http/HttpTransport.h"
#include "platform/feeds/http/NetworkConnection.h"

#include <memory>
#include <string>

namespace orvo {

/// One exchange over a connection of its own, which ends with it. The toolkit's sockets, TLS and
/// proxies; not its HTTP, which takes chunks that were cut short for a whole body. Lives on the
/// network's thread.
class _NetworkExchange {
public:
    using Ended = std::function<void(HttpAnswer)>;

    /// `ended` is called once, never inside a call; the exchange may be destroyed in it.
    _NetworkExchange(HttpExchange exchange, Ended ended);
    _NetworkExchange(const _NetworkExchange&) = delete;
    _NetworkExchange& operator=(const _NetworkExchange&) = delete;
    ~_NetworkExchange();

    /// Ends the exchange when its time is over by the environment's monotonic clock.
    void checkTime(double now);

private:
    [[nodiscard]] NetworkConnection::Handlers handlers();
    void open();
    void sendRequest();
    void read();
    void bytesCame();
    void connectionEnded(NetworkConnection::End way, const std::string& reason);
    void fail(HttpAnswer::Failure failure, std::string reason);
    void end(HttpAnswer answer);

    const HttpExchange _exchange;
    Ended _ended;
    HttpResponseParser _parser;
    double _lastByteAt;
    std::unique_ptr<NetworkConnection> _connection; // nil where none can be made
    std::shared_ptr<const bool> _life;              // ends with the exchange
};

} // namespace orvo
