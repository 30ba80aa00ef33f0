#include "platform/feeds/http/ScriptedServer.h"

#include <algorithm>
#include <arpa/inet.h>
#include <array>
#include <cctype>
#include <netinet/in.h>
#include <poll.h>
#include <sstream>
#include <stdexcept>
#include <sys/eventfd.h>
#include <sys/socket.h>
#include <unistd.h>

namespace orvo::testing {

namespace {

ServedRequest parse(const std::string& head) {
    ServedRequest request;
    std::istringstream lines(head);
    std::string line;
    std::getline(lines, line);
    std::istringstream(line) >> request.method >> request.target;
    while (std::getline(lines, line)) {
        const auto colon = line.find(':');
        if (colon == std::string::npos)
            continue;
        auto name = line.substr(0, colon);
        std::ranges::transform(
            name, name.begin(), [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
        auto value = line.substr(colon + 1);
        value.erase(0, value.find_first_not_of(' '));
        value.erase(value.find_last_not_of("\r\n ") + 1);
        request.headers[name] = value;
    }
    return request;
}

void sendWhole(int connection, std::string_view bytes) {
    while (!bytes.empty()) {
        const auto count = send(connection, bytes.data(), bytes.size(), MSG_NOSIGNAL);
        if (count <= 0)
            return; // the client has heard enough
        bytes.remove_prefix(static_cast<std::size_t>(count));
    }
}

} // namespace

std::string
httpReply(int status, const std::vector<std::string>& headers, const std::string& body) {
    auto reply = "HTTP/1.1 " + std::to_string(status) + " x\r\nConnection: close\r\n";
    for (const auto& header : headers)
        reply += header + "\r\n";
    if (status != 304)
        reply += "Content-Length: " + std::to_string(body.size()) + "\r\n";
    return reply + "\r\n" + body;
}

ScriptedServer::ScriptedServer(Script script)
    : _script(std::move(script))
    , _listener(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0))
    , _stop(eventfd(0, EFD_CLOEXEC)) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof address;
    auto* generic = reinterpret_cast<sockaddr*>(&address);
    if (bind(_listener, generic, length) != 0 || listen(_listener, 64) != 0 ||
        getsockname(_listener, generic, &length) != 0)
        throw std::runtime_error("no port can be had on 127.0.0.1");
    _port = ntohs(address.sin_port);
    _thread = std::thread([this] { serve(); });
}

ScriptedServer::~ScriptedServer() {
    const std::uint64_t one = 1;
    [[maybe_unused]] const auto written = write(_stop, &one, sizeof one);
    _thread.join();
    for (const int connection : _open)
        close(connection);
    close(_stop);
    close(_listener);
}

std::string ScriptedServer::url(const std::string& path) const {
    return "http://127.0.0.1:" + std::to_string(_port) + path;
}

std::vector<ServedRequest> ScriptedServer::requests() const {
    const std::lock_guard lock(_mutex);
    return _requests;
}

void ScriptedServer::serve() {
    std::array<pollfd, 2> watched{pollfd{_listener, POLLIN, 0}, pollfd{_stop, POLLIN, 0}};
    while (poll(watched.data(), watched.size(), -1) >= 0 && watched[1].revents == 0)
        if (watched[0].revents != 0)
            answer(accept4(_listener, nullptr, nullptr, SOCK_CLOEXEC));
}

void ScriptedServer::answer(int connection) {
    std::string head;
    std::array<char, 4096> part{};
    while (head.find("\r\n\r\n") == std::string::npos) {
        const auto count = recv(connection, part.data(), part.size(), 0);
        if (count <= 0) {
            close(connection);
            return;
        }
        head.append(part.data(), static_cast<std::size_t>(count));
    }
    const auto request = parse(head);
    {
        const std::lock_guard lock(_mutex);
        _requests.push_back(request);
    }
    const auto reply = _script(request);
    sendWhole(connection, reply.bytes);
    if (reply.staysOpen) {
        _open.push_back(connection);
        return;
    }
    // A reset would take from the client what it has not read yet.
    shutdown(connection, SHUT_WR);
    while (recv(connection, part.data(), part.size(), 0) > 0) {
    }
    close(connection);
}

} // namespace orvo::testing
