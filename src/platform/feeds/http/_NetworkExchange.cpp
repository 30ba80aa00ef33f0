#include "platform/feeds/http/_NetworkExchange.h"

#include "platform/feeds/http/HttpURL.h"
#include "platform/feeds/http/_NetworkLibrary.h"
#include "platform/foundation/Environment.h"

#include <QTimer>
#include <QUrl>

#include <array>
#include <fmt/format.h>

namespace orvo {

namespace {

double monotonicNow() {
    return Environment::monotonicClock().get()->seconds();
}

std::string requestHead(const HttpExchange& exchange,
                        const std::optional<NetworkConnection::URLProxy>& proxy) {
    const auto url = QUrl::fromEncoded(QByteArray::fromStdString(exchange.url));
    auto hidden = QUrl::RemoveUserInfo | QUrl::RemoveFragment;
    if (!proxy)
        hidden |= QUrl::RemoveScheme | QUrl::RemoveAuthority;
    auto target = url.toEncoded(hidden).toStdString();
    if (url.path().isEmpty() && !proxy)
        target.insert(0, "/");
    auto head =
        fmt::format("GET {} HTTP/1.1\r\nHost: {}\r\nConnection: close\r\nAccept-Encoding: gzip\r\n",
                    target,
                    url.authority(QUrl::RemoveUserInfo | QUrl::FullyEncoded).toStdString());
    if (proxy && !proxy->user.empty())
        head += fmt::format("Proxy-Authorization: Basic {}\r\n",
                            HttpURL::base64(proxy->user + ':' + proxy->password));
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
    , _life(std::make_shared<bool>(true)) {
    // Later, for a connection may fail inside the call.
    QTimer::singleShot(0, [this, life = std::weak_ptr(_life)] {
        if (!life.expired())
            open();
    });
}

_NetworkExchange::~_NetworkExchange() = default;

NetworkConnection::Handlers _NetworkExchange::handlers() {
    return {.opened = [this] { sendRequest(); },
            .bytesCame = [this] { bytesCame(); },
            .ended =
                [this](NetworkConnection::End way, const std::string& reason) {
                    connectionEnded(way, reason);
                }};
}

void _NetworkExchange::open() {
    std::string reason;
    _connection = _NetworkLibrary::connectionTo(_exchange.url, handlers(), reason);
    if (_connection)
        _connection->open();
    else
        fail(HttpAnswer::Failure::Unreachable, std::move(reason));
}

void _NetworkExchange::sendRequest() {
    _lastByteAt = monotonicNow();
    _connection->write(requestHead(_exchange, _connection->urlProxy()));
}

void _NetworkExchange::read() {
    _lastByteAt = monotonicNow();
    std::array<char, 65536> part; // NOLINT(cppcoreguidelines-pro-type-member-init): read into
    while (!_parser.isComplete()) {
        const auto count = _connection->read(part);
        if (count == 0)
            break;
        _parser.feed({reinterpret_cast<const std::uint8_t*>(part.data()), count});
    }
    if (_exchange.progress && _parser.bodyLength() > 0)
        _exchange.progress(_parser.bodyLength(), _parser.announcedLength());
}

void _NetworkExchange::bytesCame() {
    read();
    if (_parser.isComplete())
        end(_parser.takeAnswer());
}

void _NetworkExchange::connectionEnded(NetworkConnection::End way, const std::string& reason) {
    switch (way) {
    case NetworkConnection::End::Untrusted:
        fail(HttpAnswer::Failure::Untrusted, "the server cannot be trusted: " + reason);
        return;
    case NetworkConnection::End::Failed:
        fail(HttpAnswer::Failure::Unreachable, reason);
        return;
    case NetworkConnection::End::Closed:
        read();
        if (!_parser.isComplete())
            _parser.endOfConnection();
        end(_parser.takeAnswer());
    }
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
