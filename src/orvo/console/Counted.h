#pragma once

#include <cstdint>
#include <string>
#include <string_view>

/// Numbers of things in words.
namespace orvo::Counted {

/// `1,234`.
[[nodiscard]] std::string grouped(std::uint64_t number);
/// `1 line`, `0 lines`, `1,234 lines`.
[[nodiscard]] std::string
text(std::uint64_t number, std::string_view singular, std::string_view plural);

} // namespace orvo::Counted
