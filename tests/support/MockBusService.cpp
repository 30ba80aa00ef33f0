#include "support/MockBusService.h"

#include <poll.h>
#include <stdexcept>
#include <sys/eventfd.h>
#include <systemd/sd-bus.h>
#include <unistd.h>

namespace orvo::testing {

namespace {

sd_bus* connect(const std::string& address) {
    sd_bus* bus = nullptr;
    sd_bus_new(&bus);
    sd_bus_set_bus_client(bus, 1);
    if (sd_bus_set_address(bus, address.c_str()) < 0 || sd_bus_start(bus) < 0)
        throw std::runtime_error("no bus at " + address);
    return bus;
}

int append(sd_bus_message* message, const MockBusService::Value& value) {
    if (const bool* flag = std::get_if<bool>(&value))
        return sd_bus_message_append(message, "v", "b", static_cast<int>(*flag));
    if (const std::uint32_t* number = std::get_if<std::uint32_t>(&value))
        return sd_bus_message_append(message, "v", "u", *number);
    sd_bus_message_open_container(message, 'v', "ao");
    sd_bus_message_open_container(message, 'a', "o");
    for (const auto& path : std::get<MockBusService::ObjectPaths>(value).paths)
        sd_bus_message_append(message, "o", path.c_str());
    sd_bus_message_close_container(message);
    return sd_bus_message_close_container(message);
}

} // namespace

MockBusService::MockBusService(const std::string& address, const std::string& name)
    : _bus(connect(address))
    , _end(eventfd(0, EFD_CLOEXEC)) {
    sd_bus_add_filter(
        _bus,
        nullptr,
        [](sd_bus_message* message, void* self, sd_bus_error* error) {
            return take(message, self, error);
        },
        this);
    if (sd_bus_request_name(_bus, name.c_str(), 0) < 0)
        throw std::runtime_error("the bus has an owner of " + name);
    _thread = std::thread([this] { serve(); });
}

MockBusService::~MockBusService() {
    eventfd_write(_end, 1);
    _thread.join();
    close(_end);
    sd_bus_flush_close_unref(_bus);
}

void MockBusService::set(const std::string& path,
                         const std::string& interface,
                         const std::string& property,
                         Value value) {
    const std::lock_guard lock(_mutex);
    _properties.insert_or_assign({path, interface, property}, std::move(value));
}

void MockBusService::fallSilent() {
    const std::lock_guard lock(_mutex);
    _isSilent = true;
}

int MockBusService::calls() const {
    const std::lock_guard lock(_mutex);
    return _calls;
}

int MockBusService::take(sd_bus_message* message, void* self, void*) {
    return sd_bus_message_is_method_call(message, "org.freedesktop.DBus.Properties", "Get")
               ? static_cast<MockBusService*>(self)->answer(message)
               : 0;
}

int MockBusService::answer(sd_bus_message* question) {
    const std::lock_guard lock(_mutex);
    ++_calls;
    if (_isSilent)
        return 1;
    const char* interface = nullptr;
    const char* property = nullptr;
    sd_bus_message_read(question, "ss", &interface, &property);
    const auto known = _properties.find({sd_bus_message_get_path(question), interface, property});
    if (known == _properties.end())
        return sd_bus_reply_method_errorf(
            question, SD_BUS_ERROR_UNKNOWN_PROPERTY, "there is no %s", property);
    sd_bus_message* reply = nullptr;
    sd_bus_message_new_method_return(question, &reply);
    append(reply, known->second);
    sd_bus_send(_bus, reply, nullptr);
    sd_bus_message_unref(reply);
    return 1;
}

void MockBusService::serve() {
    for (;;) {
        while (sd_bus_process(_bus, nullptr) > 0) {
        }
        pollfd wanted[] = {{sd_bus_get_fd(_bus), static_cast<short>(sd_bus_get_events(_bus)), 0},
                           {_end, POLLIN, 0}};
        if (poll(wanted, std::size(wanted), -1) < 0 || wanted[1].revents != 0 ||
            (wanted[0].revents & (POLLHUP | POLLERR)) != 0)
            return;
    }
}

} // namespace orvo::testing
