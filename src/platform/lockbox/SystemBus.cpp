#include "platform/lockbox/SystemBus.h"

#include <algorithm>
#include <memory>
#include <systemd/sd-bus.h>

namespace orvo::lockbox {

namespace {

struct Unref {
    void operator()(sd_bus_message* message) const noexcept { sd_bus_message_unref(message); }
};
using Message = std::unique_ptr<sd_bus_message, Unref>;

} // namespace

SystemBus::SystemBus() {
    if (sd_bus_open_system(&_bus) < 0)
        _bus = nullptr;
}

SystemBus::~SystemBus() {
    // Not flushed: that would wait for a bus that does not read.
    sd_bus_close(_bus);
    sd_bus_unref(_bus);
}

std::chrono::microseconds SystemBus::timeLeft() const noexcept {
    const auto left = _deadline - std::chrono::steady_clock::now();
    return std::max(std::chrono::duration_cast<std::chrono::microseconds>(left),
                    std::chrono::microseconds::zero());
}

bool SystemBus::waitUntilReady() noexcept {
    // A call would wait for the greeting by itself, but a minute and a half of it.
    while (_bus) {
        if (sd_bus_is_ready(_bus) > 0)
            return true;
        const int worked = sd_bus_process(_bus, nullptr);
        const auto left = timeLeft();
        if (worked < 0 || left.count() == 0)
            return false;
        if (worked == 0 && sd_bus_wait(_bus, static_cast<std::uint64_t>(left.count())) < 0)
            return false;
    }
    return false;
}

std::optional<bool> SystemBus::readFlag(const char* service,
                                        const char* path,
                                        const char* interface,
                                        const char* property) noexcept {
    if (!waitUntilReady())
        return std::nullopt;
    sd_bus_message* made = nullptr;
    const int composed = sd_bus_message_new_method_call(
        _bus, &made, service, path, "org.freedesktop.DBus.Properties", "Get");
    const Message question(made);
    if (composed < 0 || sd_bus_message_set_auto_start(question.get(), 0) < 0 ||
        sd_bus_message_append(question.get(), "ss", interface, property) < 0)
        return std::nullopt;

    sd_bus_message* received = nullptr;
    // At least one: 0 would mean the bus's own patience.
    const auto left = std::max<std::int64_t>(timeLeft().count(), 1);
    const int asked =
        sd_bus_call(_bus, question.get(), static_cast<std::uint64_t>(left), nullptr, &received);
    const Message answer(received);
    int flag = 0;
    if (asked < 0 || sd_bus_message_read(answer.get(), "v", "b", &flag) < 0)
        return std::nullopt;
    return flag != 0;
}

} // namespace orvo::lockbox
