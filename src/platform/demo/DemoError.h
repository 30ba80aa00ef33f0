#pragma once

#include <cstdint>

namespace orvo {

inline constexpr const char* DemoErrorDomain = "DemoErrorDomain";
enum class DemoErrorCode : std::int64_t {
    CannotServe = 1, ///< the port is taken or not permitted
    CannotWrite = 2, ///< the city's files
};

} // namespace orvo
