#include "platform/feeds/http/sockets/SocketConnection.h"

#include <QNetworkProxyFactory>
#include <QSslError>
#include <QSslSocket>
#include <QTcpSocket>
#include <QUrl>

#include <memory>
#include <utility>

namespace orvo {

namespace {

constexpr quint16 HttpPort = 80;
constexpr quint16 HttpsPort = 443;

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

bool isAskedForURLs(const QNetworkProxy& proxy, const QUrl& url) {
    return !isSecure(url) && (proxy.type() == QNetworkProxy::HttpProxy ||
                              proxy.type() == QNetworkProxy::HttpCachingProxy);
}

class SocketConnection final : public NetworkConnection {
public:
    SocketConnection(const std::string& url, Handlers handlers)
        : _url(QUrl::fromEncoded(QByteArray::fromStdString(url)))
        , _handlers(std::move(handlers))
        , _socket(socketFor(_url)) {
        watch();
    }

    ~SocketConnection() override {
        // It may be the caller: not deleted before it has returned.
        auto* socket = _socket.release();
        socket->disconnect();
        socket->abort();
        socket->deleteLater();
    }

    void open() override {
        const auto proxy = proxyFor(_url);
        if (isAskedForURLs(proxy, _url)) {
            _urlProxy = {proxy.user().toStdString(), proxy.password().toStdString()};
            _socket->setProxy(QNetworkProxy::NoProxy);
            _socket->connectToHost(proxy.hostName(), proxy.port());
            return;
        }
        _socket->setProxy(proxy);
        if (auto* secure = qobject_cast<QSslSocket*>(_socket.get()))
            secure->connectToHostEncrypted(_url.host(), portOf(_url));
        else
            _socket->connectToHost(_url.host(), portOf(_url));
    }

    [[nodiscard]] const std::optional<URLProxy>& urlProxy() const override { return _urlProxy; }

    void write(std::string_view bytes) override {
        _socket->write(bytes.data(), static_cast<qint64>(bytes.size()));
    }

    [[nodiscard]] std::size_t read(std::span<char> bytes) override {
        const auto count = _socket->read(bytes.data(), static_cast<qint64>(bytes.size()));
        return count > 0 ? static_cast<std::size_t>(count) : 0;
    }

private:
    // A handler may destroy this: each is the last thing that is done.
    void watch() {
        auto* socket = _socket.get();
        QObject::connect(socket, &QTcpSocket::readyRead, socket, [this] { bytesCame(); });
        QObject::connect(
            socket, &QTcpSocket::disconnected, socket, [this] { ended(End::Closed, ""); });
        QObject::connect(socket, &QTcpSocket::errorOccurred, socket, [this] { failed(); });
        if (auto* secure = qobject_cast<QSslSocket*>(socket))
            watch(*secure);
        else
            QObject::connect(socket, &QTcpSocket::connected, socket, [this] { opened(); });
    }

    void watch(QSslSocket& socket) {
        QObject::connect(&socket, &QSslSocket::encrypted, &socket, [this] { opened(); });
        QObject::connect(
            &socket, &QSslSocket::sslErrors, &socket, [this](const QList<QSslError>& errors) {
                if (_tlsReason.empty() && !errors.isEmpty())
                    _tlsReason = errors.first().errorString().toStdString();
            });
    }

    // Called as copies: what one holds must outlive it.
    void opened() {
        const auto handler = _handlers.opened;
        handler();
    }
    void bytesCame() {
        const auto handler = _handlers.bytesCame;
        handler();
    }
    void ended(End end, const std::string& reason) {
        const auto handler = _handlers.ended;
        handler(end, reason);
    }

    void failed() {
        const auto error = _socket->error();
        const auto text = _socket->errorString().toStdString();
        if (error == QAbstractSocket::RemoteHostClosedError)
            ended(End::Closed, text);
        else if (error == QAbstractSocket::SslHandshakeFailedError)
            ended(End::Untrusted, _tlsReason.empty() ? text : std::string(_tlsReason));
        else
            ended(End::Failed, text);
    }

    const QUrl _url;
    const Handlers _handlers;
    std::string _tlsReason; // of the first thing wrong with the certificate
    std::optional<URLProxy> _urlProxy;
    std::unique_ptr<QTcpSocket> _socket; // with TLS where the URL asks for it
};

} // namespace

} // namespace orvo

orvo::NetworkConnection*
OrvoMakeNetworkConnection(const std::string& url,
                          const orvo::NetworkConnection::Handlers& handlers) {
    return std::make_unique<orvo::SocketConnection>(url, handlers).release();
}
