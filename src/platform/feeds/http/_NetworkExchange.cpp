#include "platform/feeds/http/_NetworkExchange.h"

#include "platform/feeds/http/HttpURL.h"
#include "platform/foundation/Environment.h"

#include <QNetworkProxyFactory>
#include <QSslError>
#include <QSslSocket>
#include <QTcpSocket>
#include <QTimer>
#include <QUrl>

#include <array>
#include <fmt/format.h>

namespace orvo {

namespace {

constexpr quint16 HttpPort = 80;
constexpr quint16 HttpsPort = 443;

double monotonicNow() {
    return Environment::monotonicClock().get()->seconds();
}

QUrl parsed(const HttpExchange& exchange) {
    return QUrl::fromEncoded(QByteArray::fromStdString(exchange.url));
}

bool isSecure(const QUrl& url) {
    return url.scheme() == QLatin1String("https");
}

std::unique_ptr<QTcpSocket> socketFor(const QUrl& url) {
    // TLS costs a library, which is loaded where it is needed.
    if (isSecure(url))
        return std::make_unique<QSslSocket>();
    return std::make_unique<QTcpSocket>();
}

quint16 portOf(const QUrl& url) {
    return static_cast<quint16>(url.port(isSecure(url) ? HttpsPort : HttpPort));
}

/// The one that the person's settings name for the URL; this machine itself is asked directly.
QNetworkProxy proxyFor(const QUrl& url) {
    const auto host = url.host();
    if (host == QLatin1String("localhost") || host == QLatin1String("127.0.0.1") ||
        host == QLatin1String("::1"))
        return QNetworkProxy::NoProxy;
    const auto proxies = QNetworkProxyFactory::systemProxyForQuery(QNetworkProxyQuery(url));
    return proxies.isEmpty() ? QNetworkProxy::NoProxy : proxies.first();
}

/// Whether the proxy is asked by HTTP itself, with the whole URL in place of the target.
bool isAskedForURLs(const QNetworkProxy& proxy, const QUrl& url) {
    return !isSecure(url) && (proxy.type() == QNetworkProxy::HttpProxy ||
                              proxy.type() == QNetworkProxy::HttpCachingProxy);
}

std::string requestHead(const HttpExchange& exchange, const QUrl& url, const QNetworkProxy& proxy) {
    const bool asksProxy = isAskedForURLs(proxy, url);
    auto hidden = QUrl::RemoveUserInfo | QUrl::RemoveFragment;
    if (!asksProxy)
        hidden |= QUrl::RemoveScheme | QUrl::RemoveAuthority;
    auto target = url.toEncoded(hidden).toStdString();
    if (url.path().isEmpty() && !asksProxy)
        target.insert(0, "/");
    auto head =
        fmt::format("GET {} HTTP/1.1\r\nHost: {}\r\nConnection: close\r\nAccept-Encoding: gzip\r\n",
                    target,
                    url.authority(QUrl::RemoveUserInfo | QUrl::FullyEncoded).toStdString());
    if (asksProxy && !proxy.user().isEmpty())
        head += fmt::format(
            "Proxy-Authorization: Basic {}\r\n",
            HttpURL::base64((proxy.user() + QLatin1Char(':') + proxy.password()).toStdString()));
    for (const auto& [name, value] : exchange.headers)
        head += fmt::format("{}: {}\r\n", name, value);
    return head + "\r\n";
}

} // namespace

_NetworkExchange::_NetworkExchange(HttpExchange exchange, Ended ended)
    : _exchange(std::move(exchange))
    , _ended(std::move(ended))
    , _parser(_exchange.maximumBytes)
    , _lastByteAt(monotonicNow())
    , _socket(socketFor(parsed(_exchange))) {
    watch();
    // Later, for a socket may fail inside the call.
    QTimer::singleShot(0, _socket.get(), [this] { connect(parsed(_exchange)); });
}

_NetworkExchange::~_NetworkExchange() {
    // It may be the caller: not deleted before it has returned.
    auto* socket = _socket.release();
    socket->disconnect();
    socket->abort();
    socket->deleteLater();
}

void _NetworkExchange::watch() {
    auto* socket = _socket.get();
    QObject::connect(socket, &QTcpSocket::readyRead, socket, [this] { bytesCame(); });
    QObject::connect(socket, &QTcpSocket::disconnected, socket, [this] { connectionEnded(); });
    QObject::connect(socket, &QTcpSocket::errorOccurred, socket, [this] { connectionFailed(); });
    if (auto* secure = qobject_cast<QSslSocket*>(socket))
        watch(*secure);
    else
        QObject::connect(socket, &QTcpSocket::connected, socket, [this] { sendRequest(); });
}

void _NetworkExchange::watch(QSslSocket& socket) {
    QObject::connect(&socket, &QSslSocket::encrypted, &socket, [this] { sendRequest(); });
    QObject::connect(
        &socket, &QSslSocket::sslErrors, &socket, [this](const QList<QSslError>& errors) {
            if (_tlsReason.empty() && !errors.isEmpty())
                _tlsReason = errors.first().errorString().toStdString();
        });
}

void _NetworkExchange::connect(const QUrl& url) {
    const auto proxy = proxyFor(url);
    _requestHead = requestHead(_exchange, url, proxy);
    if (isAskedForURLs(proxy, url)) {
        _socket->setProxy(QNetworkProxy::NoProxy);
        _socket->connectToHost(proxy.hostName(), proxy.port());
        return;
    }
    _socket->setProxy(proxy);
    if (auto* secure = qobject_cast<QSslSocket*>(_socket.get()))
        secure->connectToHostEncrypted(url.host(), portOf(url));
    else
        _socket->connectToHost(url.host(), portOf(url));
}

void _NetworkExchange::sendRequest() {
    _lastByteAt = monotonicNow();
    _socket->write(_requestHead.data(), static_cast<qint64>(_requestHead.size()));
}

void _NetworkExchange::bytesCame() {
    _lastByteAt = monotonicNow();
    std::array<char, 64 * 1024> part; // NOLINT(cppcoreguidelines-pro-type-member-init): read into
    while (!_parser.isComplete()) {
        const auto count = _socket->read(part.data(), part.size());
        if (count <= 0)
            break;
        _parser.feed(
            {reinterpret_cast<const std::uint8_t*>(part.data()), static_cast<std::size_t>(count)});
    }
    if (_exchange.progress && _parser.bodyLength() > 0)
        _exchange.progress(_parser.bodyLength(), _parser.announcedLength());
    if (_parser.isComplete())
        end(_parser.takeAnswer());
}

void _NetworkExchange::connectionEnded() {
    bytesCame();
    if (!_ended)
        return;
    _parser.endOfConnection();
    end(_parser.takeAnswer());
}

void _NetworkExchange::connectionFailed() {
    const auto error = _socket->error();
    if (error == QAbstractSocket::RemoteHostClosedError)
        connectionEnded();
    else if (error == QAbstractSocket::SslHandshakeFailedError)
        fail(HttpAnswer::Failure::Untrusted,
             "the server cannot be trusted: " +
                 (_tlsReason.empty() ? _socket->errorString().toStdString() : _tlsReason));
    else
        fail(HttpAnswer::Failure::Unreachable, _socket->errorString().toStdString());
}

void _NetworkExchange::checkTime(double now) {
    if (now >= _exchange.deadline)
        fail(HttpAnswer::Failure::TimedOut, "the whole answer did not come in time");
    else if (now - _lastByteAt >= _exchange.idleTimeout)
        fail(HttpAnswer::Failure::TimedOut,
             fmt::format("the server said nothing for {:g} seconds", _exchange.idleTimeout));
}

void _NetworkExchange::fail(HttpAnswer::Failure failure, std::string reason) {
    HttpAnswer answer;
    answer.failure = failure;
    answer.reason = std::move(reason);
    end(std::move(answer));
}

/// Nothing of the exchange may be used afterwards.
void _NetworkExchange::end(HttpAnswer answer) {
    if (const auto ended = std::exchange(_ended, {}))
        ended(std::move(answer));
}

} // namespace orvo
