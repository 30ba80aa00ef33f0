#pragma once

#include "platform/foundation/NSError.h"

#include <memory>
#include <string>

/// Sets the demonstration city up in the profile in use, which must be the demonstration's: its
/// schedule, alerts and favourites are written anew for the environment's time, whatever is kept in
/// memory otherwise; everything else in the profile stays.
namespace orvo::DemoProfile {

/// Holds while the city's alerts come from a live server.
class Live {
public:
    explicit Live(int lock)
        : _lock(lock) {}
    Live(const Live&) = delete;
    Live& operator=(const Live&) = delete;
    ~Live();

private:
    int _lock;
};

/// With alerts from a file. Nil, or why it failed.
[[nodiscard]] std::shared_ptr<NSError> write();
/// With alerts from `url`. Nil, with an error, when that fails or another process is serving.
[[nodiscard]] std::unique_ptr<Live> writeLive(const std::string& url,
                                              std::shared_ptr<NSError>* error);
/// Writes it where it is not current. Nil, or why it failed.
[[nodiscard]] std::shared_ptr<NSError> ensure();
/// Whether there is a city, its time has come and not run out, and its server, if it has one, runs.
/// Writes nothing.
[[nodiscard]] bool isCurrent();
/// How long it stays so: at most `DemoIncidents::LifetimeSeconds`, which is also what is said of
/// one with a server; 0 where it is not current.
[[nodiscard]] double secondsLeft();

} // namespace orvo::DemoProfile
