#pragma once

#include <cstdint>
#include <map>
#include <mutex>
#include <string>
#include <thread>
#include <tuple>
#include <variant>
#include <vector>

struct sd_bus;
struct sd_bus_message;

namespace orvo::testing {

/// A service on a bus that knows nothing but the properties it was given. It answers on a thread of
/// its own, so that the test's may wait for it. Any thread may change what it knows.
class MockBusService {
public:
    struct ObjectPaths {
        std::vector<std::string> paths;
    };
    using Value = std::variant<bool, std::uint32_t, ObjectPaths>;

    /// Owns `name` when it returns.
    /// @throws std::runtime_error when there is no such bus, or another owns the name
    MockBusService(const std::string& address, const std::string& name);
    MockBusService(const MockBusService&) = delete;
    MockBusService& operator=(const MockBusService&) = delete;
    ~MockBusService();

    void set(const std::string& path,
             const std::string& interface,
             const std::string& property,
             Value value);
    /// From now on it takes calls and never answers.
    void fallSilent();
    /// How many calls it has taken.
    [[nodiscard]] int calls() const;

private:
    static int take(sd_bus_message* message, void* self, void* error);
    int answer(sd_bus_message* question);
    void serve();

    sd_bus* _bus = nullptr;
    int _end = -1; // readable once it shall end
    mutable std::mutex _mutex;
    std::map<std::tuple<std::string, std::string, std::string>, Value> _properties;
    bool _isSilent = false;
    int _calls = 0;
    std::thread _thread;
};

} // namespace orvo::testing
