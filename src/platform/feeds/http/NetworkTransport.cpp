#include "platform/feeds/http/HttpTransport.h"
#include "platform/feeds/http/_NetworkExchange.h"
#include "platform/feeds/http/_NetworkThread.h"
#include "platform/foundation/Environment.h"

#include <QTimer>

#include <atomic>
#include <chrono>
#include <map>

namespace orvo {

namespace {

/// How often the environment's clock is looked at while something is under way.
constexpr std::chrono::milliseconds ClockInterval{100};

/// All exchanges under way. Made anywhere; used on the network's thread alone.
class Exchanges {
public:
    void start(std::uint64_t number,
               const HttpExchange& exchange,
               const HttpTransport::Completion& completion) {
        if (!_clock) {
            _clock = std::make_unique<QTimer>();
            QObject::connect(_clock.get(), &QTimer::timeout, _clock.get(), [this] { checkTime(); });
        }
        _clock->start(ClockInterval);
        _running.emplace(number,
                         std::make_unique<_NetworkExchange>(
                             exchange, [this, number, completion](HttpAnswer answer) {
                                 end(number);
                                 completion(std::move(answer));
                             }));
    }

    void end(std::uint64_t number) {
        if (_running.erase(number) != 0 && _running.empty())
            _clock->stop();
    }

    void endAll() {
        _running.clear();
        _clock.reset();
    }

private:
    void checkTime() {
        const double now = Environment::monotonicClock().get()->seconds();
        // One that ends leaves the map, so the next is looked up by its number.
        for (auto running = _running.begin(); running != _running.end();) {
            const auto number = running->first;
            running->second->checkTime(now);
            running = _running.upper_bound(number);
        }
    }

    std::unique_ptr<QTimer> _clock;
    std::map<std::uint64_t, std::unique_ptr<_NetworkExchange>> _running;
};

class NetworkTransport final : public HttpTransport {
public:
    ~NetworkTransport() override { _thread->end(); }

    std::uint64_t start(HttpExchange exchange, Completion completion) override {
        const auto number = ++_lastNumber;
        _thread->async([number,
                        exchanges = _exchanges,
                        exchange = std::move(exchange),
                        completion = std::move(completion)] {
            exchanges->start(number, exchange, completion);
        });
        return number;
    }

    void cancel(std::uint64_t exchange) override {
        _thread->async([exchange, exchanges = _exchanges] { exchanges->end(exchange); });
    }

private:
    const std::shared_ptr<Exchanges> _exchanges = std::make_shared<Exchanges>();
    const std::shared_ptr<_NetworkThread> _thread =
        std::make_shared<_NetworkThread>([exchanges = _exchanges] { exchanges->endAll(); });
    std::atomic<std::uint64_t> _lastNumber = 0;
};

} // namespace

std::shared_ptr<HttpTransport> HttpTransport::network() {
    return std::make_shared<NetworkTransport>();
}

} // namespace orvo
