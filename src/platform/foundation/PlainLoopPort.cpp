#include "platform/foundation/LoopPort.h"

#include <algorithm>
#include <cmath>
#include <poll.h>
#include <vector>

namespace orvo {

namespace {

constexpr double LongestPollSeconds = 1e6;

class PlainLoopPort final : public LoopPort {
public:
    void watch(int fileDescriptor, std::function<void()> ready) override {
        _watched.push_back({fileDescriptor, POLLIN, 0});
        _ready.push_back(std::move(ready));
    }

    void turn(std::optional<double> longestWait) override {
        auto watched = _watched; // a callback may turn the loop
        const int timeout =
            longestWait ? static_cast<int>(
                              std::ceil(std::clamp(*longestWait, 0.0, LongestPollSeconds) * 1000))
                        : -1;
        if (poll(watched.data(), watched.size(), timeout) <= 0)
            return;
        for (std::size_t i = 0; i < watched.size(); ++i)
            if (watched[i].revents != 0)
                _ready[i]();
    }

    int run() override {
        const int depth = ++_depth;
        while (_depth >= depth)
            turn(std::nullopt);
        return _exitCode;
    }

    bool leave(int exitCode) override {
        if (_depth == 0)
            return false;
        --_depth;
        _exitCode = exitCode;
        return true;
    }

private:
    std::vector<pollfd> _watched;
    std::vector<std::function<void()>> _ready;
    int _depth = 0; // how many runs are under way
    int _exitCode = 0;
};

} // namespace

std::unique_ptr<LoopPort> LoopPort::plain() {
    return std::make_unique<PlainLoopPort>();
}

} // namespace orvo
