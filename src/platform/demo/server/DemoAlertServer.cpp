#include "platform/demo/server/DemoAlertServer.h"

#include "platform/demo/DemoAlertFeed.h"
#include "platform/demo/DemoError.h"
#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSDate.h"

#include <QByteArray>
#include <QHostAddress>
#include <QTcpServer>
#include <QTcpSocket>

#include <fmt/format.h>

namespace orvo {

namespace {

constexpr const char* FeedPath = "/alerts.pb";
constexpr qsizetype LongestRequest = qsizetype{16} * 1024;

struct Request {
    std::string line; ///< `GET /alerts.pb`
    std::string method;
    std::string path;
    std::string knownTag; ///< `If-None-Match`, or empty
};

struct Response {
    int status = 0;
    const char* reason = "";
    std::string tag; ///< empty for none
    std::shared_ptr<NSData> body = NSData::dataWithString("");
};

/// Nothing for what is no request.
std::optional<Request> parse(const QByteArray& head) {
    const auto lines = head.split('\n');
    const auto words = lines.first().trimmed().split(' ');
    if (words.size() != 3 || !words[2].startsWith("HTTP/1."))
        return std::nullopt;
    Request request;
    request.method = words[0].toStdString();
    request.path = words[1].split('?').first().toStdString();
    request.line = request.method + " " + request.path;
    for (const auto& line : lines) {
        const auto colon = line.indexOf(':');
        if (colon > 0 && line.left(colon).trimmed().toLower() == "if-none-match")
            request.knownTag = line.mid(colon + 1).trimmed().toStdString();
    }
    return request;
}

double now() {
    return NSDate::date()->timeIntervalSince1970();
}

Response answer(const Request& request, double begun) {
    if (request.method != "GET" && request.method != "HEAD")
        return {405, "Method Not Allowed", {}};
    if (request.path != FeedPath)
        return {404, "Not Found", {}};
    const double time = now();
    const auto incidents = DemoIncidents::live(begun, time);
    // The header's time changes every second and says nothing new.
    const auto content = demoAlertFeed(incidents, 0);
    const std::string tag = fmt::format("\"{:016x}\"", stableHash(content->stringView()));
    if (request.knownTag == tag)
        return {304, "Not Modified", tag};
    return {200, "OK", tag, demoAlertFeed(incidents, time)};
}

QByteArray encoded(const Response& response, bool withBody) {
    std::string head = fmt::format("HTTP/1.1 {} {}\r\nConnection: close\r\nCache-Control: "
                                   "no-cache\r\n",
                                   response.status,
                                   response.reason);
    if (!response.tag.empty())
        head += fmt::format("ETag: {}\r\n", response.tag);
    if (response.status != 304)
        head += fmt::format("Content-Type: application/x-protobuf\r\nContent-Length: {}\r\n",
                            response.body->length());
    head += "\r\n";
    if (withBody)
        head += response.body->stringView();
    return QByteArray::fromStdString(head);
}

} // namespace

struct DemoAlertServer::Private {
    QTcpServer server;
    Observer observer;
    double begun = now();

    /// Called whenever something arrived; answers once the request's head is whole.
    void read(QTcpSocket& socket) const {
        const QByteArray arrived = socket.peek(LongestRequest);
        const auto end = arrived.indexOf("\r\n\r\n");
        if (end < 0 && arrived.size() < LongestRequest)
            return;
        (void)socket.readAll();
        const auto request = end < 0 ? std::nullopt : parse(arrived.left(end));
        const Response response =
            request ? answer(*request, begun) : Response{400, "Bad Request", {}};
        socket.write(encoded(response, !request || request->method != "HEAD"));
        socket.disconnectFromHost();
        if (observer)
            observer(request ? request->line : "no request", response.status);
    }
};

DemoAlertServer::DemoAlertServer(std::unique_ptr<Private> implementation)
    : _private(std::move(implementation)) {}

DemoAlertServer::~DemoAlertServer() = default;

std::unique_ptr<DemoAlertServer>
DemoAlertServer::start(std::uint16_t port, Observer observer, std::shared_ptr<NSError>* error) {
    auto implementation = std::make_unique<Private>();
    implementation->observer = std::move(observer);
    auto* self = implementation.get();
    QObject::connect(&self->server, &QTcpServer::newConnection, &self->server, [self] {
        while (QTcpSocket* socket = self->server.nextPendingConnection()) {
            QObject::connect(socket, &QTcpSocket::disconnected, socket, &QObject::deleteLater);
            QObject::connect(
                socket, &QTcpSocket::readyRead, socket, [self, socket] { self->read(*socket); });
        }
    });
    if (!self->server.listen(QHostAddress::LocalHost, port)) {
        if (error)
            *error =
                NSError::errorWithMessage(DemoErrorDomain,
                                          static_cast<std::int64_t>(DemoErrorCode::CannotServe),
                                          fmt::format("port {} of 127.0.0.1 cannot be had: {}",
                                                      port,
                                                      self->server.errorString().toStdString()));
        return nullptr;
    }
    return std::unique_ptr<DemoAlertServer>(new DemoAlertServer(std::move(implementation)));
}

std::uint16_t DemoAlertServer::port() const {
    return _private->server.serverPort();
}

std::string DemoAlertServer::url() const {
    return fmt::format("http://127.0.0.1:{}{}", port(), FeedPath);
}

} // namespace orvo
