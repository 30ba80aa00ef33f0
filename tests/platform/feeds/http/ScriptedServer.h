#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace orvo::testing {

/// What a client asked.
struct ServedRequest {
    std::string method;
    std::string target;                         ///< path and query
    std::map<std::string, std::string> headers; ///< names in small letters
};

/// What the server does with it: sends the bytes, then closes the connection, or keeps it open
/// without another word.
struct ServedReply {
    std::string bytes;
    bool staysOpen = false;
};

/// `HTTP/1.1 STATUS x`, the headers (`ETag: "1"`), Content-Length and the body.
std::string httpReply(int status, const std::vector<std::string>& headers, const std::string& body);

/// A small real server on 127.0.0.1, on a thread of its own. Each connection carries one request;
/// connections are served one after the other but for those that stay open.
class ScriptedServer {
public:
    using Script = std::function<ServedReply(const ServedRequest& request)>;

    /// The script is called on the server's thread.
    explicit ScriptedServer(Script script);
    ScriptedServer(const ScriptedServer&) = delete;
    ScriptedServer& operator=(const ScriptedServer&) = delete;
    ~ScriptedServer();

    [[nodiscard]] std::uint16_t port() const { return _port; }
    /// `http://127.0.0.1:PORT` and the path.
    [[nodiscard]] std::string url(const std::string& path = "/alerts.pb") const;
    /// In order of arrival.
    [[nodiscard]] std::vector<ServedRequest> requests() const;

private:
    void serve();
    void answer(int connection);

    const Script _script;
    int _listener = -1;
    int _stop = -1;
    std::uint16_t _port = 0;
    mutable std::mutex _mutex;
    std::vector<ServedRequest> _requests;
    std::vector<int> _open;
    std::thread _thread;
};

} // namespace orvo::testing
