#pragma once

#include "platform/foundation/NSError.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <string>

namespace orvo {

/// Serves the live incidents of the demonstration city as `/alerts.pb` over HTTP, to this machine
/// only, with an ETag that stays while the incidents stay. It begins with the environment's wall
/// clock at the time it is made, and answers on the main thread's run loop while it lives.
class DemoAlertServer {
public:
    /// What was asked and answered: `GET /alerts.pb`, 200.
    using Observer = std::function<void(const std::string& request, int status)>;

    /// Port 0 is any free one. Nil, with an error that names the port, when it cannot be had.
    [[nodiscard]] static std::unique_ptr<DemoAlertServer>
    start(std::uint16_t port, Observer observer, std::shared_ptr<NSError>* error);
    DemoAlertServer(const DemoAlertServer&) = delete;
    DemoAlertServer& operator=(const DemoAlertServer&) = delete;
    ~DemoAlertServer();

    [[nodiscard]] std::uint16_t port() const;
    /// `http://127.0.0.1:8080/alerts.pb`.
    [[nodiscard]] std::string url() const;

private:
    struct Private;
    explicit DemoAlertServer(std::unique_ptr<Private> implementation);

    std::unique_ptr<Private> _private;
};

} // namespace orvo
