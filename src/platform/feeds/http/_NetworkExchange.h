#pragma once

#include "platform/feeds/http/HttpResponseParser.h"
#include "platform/feeds/http/HttpTransport.h"

#include <memory>
#include <string>

class QNetworkProxy;
class QSslSocket;
class QTcpSocket;
class QUrl;

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
    void watch();
    void watch(QSslSocket& socket);
    void connect(const QUrl& url);
    void sendRequest();
    void bytesCame();
    void connectionEnded();
    void connectionFailed();
    void fail(HttpAnswer::Failure failure, std::string reason);
    void end(HttpAnswer answer);

    const HttpExchange _exchange;
    Ended _ended;
    HttpResponseParser _parser;
    double _lastByteAt;
    std::string _requestHead;
    std::string _tlsReason;              // of the first thing wrong with the certificate
    std::unique_ptr<QTcpSocket> _socket; // with TLS where the URL asks for it
};

} // namespace orvo
