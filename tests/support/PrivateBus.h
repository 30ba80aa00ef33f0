#pragma once

#include "support/TemporaryProfile.h"

#include <string>
#include <sys/types.h>

namespace orvo::testing {

/// A message bus of its own, on which anybody may own any name; nothing is started by it. Ends with
/// its scope.
class PrivateBus {
public:
    /// @throws std::runtime_error when there is no `dbus-daemon`
    PrivateBus();
    PrivateBus(const PrivateBus&) = delete;
    PrivateBus& operator=(const PrivateBus&) = delete;
    ~PrivateBus();

    [[nodiscard]] const std::string& address() const noexcept { return _address; }

private:
    TemporaryFolder _folder;
    pid_t _process = -1;
    std::string _address;
};

} // namespace orvo::testing
