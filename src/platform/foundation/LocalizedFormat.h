#pragma once

#include "platform/foundation/EnvironmentSlot.h"

#include <cstdint>
#include <functional>
#include <string>
#include <variant>
#include <vector>

namespace orvo {

/// A value for a format.
using FormatArgument = std::variant<std::string, std::uint64_t, std::int64_t, double>;

/// Fills a format: `%@`, `%lu`, `%ld`, `%d`, `%f`, `%%`, each also by position (`%2$@`), numbers as
/// the person's language writes them. A text that the bundle gave for a key with plural forms takes
/// the form of its first number in that language. Arguments are never read as formats; a value that
/// is missing prints as nothing. Any thread.
[[nodiscard]] std::string localizedStringWithFormat(const std::string& format,
                                                    const std::vector<FormatArgument>& arguments);

/// A list as the person's language separates it in the middle, without a word for "and" before the
/// last. Any thread.
[[nodiscard]] std::string localizedCommaDelimitedList(const std::vector<std::string>& items);

/// What joins such lists.
using CommaDelimitedListJoin = std::function<std::string(const std::vector<std::string>&)>;
EnvironmentSlot<CommaDelimitedListJoin>& commaDelimitedListJoin();

} // namespace orvo
