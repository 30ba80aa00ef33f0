#pragma once

#include "platform/feeds/http/HttpTransport.h"

#include <condition_variable>
#include <deque>
#include <map>
#include <mutex>
#include <thread>

namespace orvo::testing {

/// Answers from a list on a thread of its own, and keeps what was asked. Without an answer left an
/// exchange waits until one is added.
class FakeTransport final : public HttpTransport {
public:
    FakeTransport()
        : _thread([this] { run(); }) {}
    ~FakeTransport() override {
        {
            const std::lock_guard lock(_mutex);
            _isEnding = true;
        }
        _changed.notify_all();
        _thread.join();
    }

    void answer(HttpAnswer answer) {
        {
            const std::lock_guard lock(_mutex);
            _answers.push_back(std::move(answer));
        }
        _changed.notify_all();
    }
    void answer(int status,
                std::vector<std::pair<std::string, std::string>> headers = {},
                const std::string& body = "") {
        HttpAnswer made;
        made.status = status;
        made.headers = std::move(headers);
        made.body = NSData::dataWithString(body);
        answer(std::move(made));
    }
    [[nodiscard]] std::vector<HttpExchange> asked() const {
        const std::lock_guard lock(_mutex);
        return _asked;
    }
    [[nodiscard]] std::size_t cancelled() const {
        const std::lock_guard lock(_mutex);
        return _cancelled;
    }
    /// Waits until so many exchanges were started.
    void waitUntilAsked(std::size_t count) {
        std::unique_lock lock(_mutex);
        _changed.wait(lock, [&] { return _asked.size() >= count; });
    }

    std::uint64_t start(HttpExchange exchange, Completion completion) override {
        std::uint64_t number = 0;
        {
            const std::lock_guard lock(_mutex);
            _asked.push_back(std::move(exchange));
            number = _asked.size();
            _waiting.emplace(number, std::move(completion));
        }
        _changed.notify_all();
        return number;
    }
    void cancel(std::uint64_t exchange) override {
        const std::lock_guard lock(_mutex);
        _cancelled += _waiting.erase(exchange);
    }

private:
    void run() {
        std::unique_lock lock(_mutex);
        while (true) {
            _changed.wait(lock,
                          [&] { return _isEnding || (!_answers.empty() && !_waiting.empty()); });
            if (_isEnding)
                return;
            auto answer = std::move(_answers.front());
            _answers.pop_front();
            auto completion = std::move(_waiting.begin()->second);
            _waiting.erase(_waiting.begin());
            lock.unlock();
            completion(std::move(answer));
            completion = nullptr;
            lock.lock();
        }
    }

    mutable std::mutex _mutex;
    std::condition_variable _changed;
    std::deque<HttpAnswer> _answers;
    std::map<std::uint64_t, Completion> _waiting;
    std::vector<HttpExchange> _asked;
    std::size_t _cancelled = 0;
    bool _isEnding = false;
    std::thread _thread;
};

} // namespace orvo::testing
