#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <string_view>

namespace orvo {

/// A connection to the server of one URL: with TLS where the URL asks for it, and by the proxy that
/// the person's settings name. What makes it is a library of its own, so only the standard library
/// stands here. Made, used and destroyed on one thread, which runs an event loop of the toolkit's.
class NetworkConnection {
public:
    enum class End {
        Closed,    ///< by the server
        Untrusted, ///< TLS
        Failed,    ///< no host, no connection, a broken one
    };
    /// All are given. The connection may be destroyed in each of them.
    struct Handlers {
        std::function<void()> opened;
        std::function<void()> bytesCame;
        /// Perhaps more than once. `reason` is in words.
        std::function<void(End end, const std::string& reason)> ended;
    };
    /// A proxy that is asked by HTTP itself, with the whole URL; empty names are none.
    struct URLProxy {
        std::string user;
        std::string password;
    };

    NetworkConnection() = default;
    NetworkConnection(const NetworkConnection&) = delete;
    NetworkConnection& operator=(const NetworkConnection&) = delete;
    /// Ends it; no handler is called any more.
    virtual ~NetworkConnection() = default;

    /// Looks for the way, and takes it. Once. It may end inside the call.
    virtual void open() = 0;
    /// What stands in between; nothing where it is none of this kind. Once it is opened.
    [[nodiscard]] virtual const std::optional<URLProxy>& urlProxy() const = 0;
    /// Once it is opened.
    virtual void write(std::string_view bytes) = 0;
    /// How many of the bytes that came were put there; 0 when there are none.
    [[nodiscard]] virtual std::size_t read(std::span<char> bytes) = 0;
};

/// What the library is asked for, by the name `OrvoMakeNetworkConnection`: a connection to the
/// server of `url`, http or https, normalized. It is the caller's.
using MakeNetworkConnection = NetworkConnection* (*)(const std::string& url,
                                                     const NetworkConnection::Handlers& handlers);

} // namespace orvo
