#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/protobuf/ProtoCodable.h"

#include <array>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <type_traits>
#include <vector>

namespace orvo {

/// The names of an enumeration's values, counted from 0.
using ProtoEnumNames = std::span<const char* const>;

/// The name of a value; `(unknown: 7)` for one out of range.
[[nodiscard]] std::string protoEnumAsString(ProtoEnumNames names, std::int32_t value);
/// The value of a name; 0 for an unknown one.
[[nodiscard]] std::int32_t protoStringAsEnum(ProtoEnumNames names, const std::string& name);

/// The hash of a present number: itself times the system's multiplier; of a present double, the
/// rule for fractions.
[[nodiscard]] std::uint64_t protoHash(std::uint64_t value);
[[nodiscard]] std::uint64_t protoHash(double value);

/// A number, a truth value or an enumeration, whose presence is a bit of the message's `_has`.
template <class Message, class Value>
struct ProtoScalarField {
    std::uint32_t number = 0;
    const char* name = nullptr;
    Value Message::*value = nullptr;
    std::uint32_t hasBit = 0;
    ProtoEnumNames names{}; ///< an enumeration's; else empty
};

/// A text; present when it is not nil.
template <class Message>
struct ProtoStringField {
    std::uint32_t number;
    const char* name;
    std::optional<std::string> Message::*value;
};

/// A sub-message; present when it is not nil.
template <class Message, class Sub>
struct ProtoMessageField {
    std::uint32_t number;
    const char* name;
    std::shared_ptr<Sub> Message::*value;
};

/// A list of sub-messages.
template <class Message, class Sub>
struct ProtoRepeatedField {
    std::uint32_t number;
    const char* name;
    std::vector<std::shared_ptr<Sub>> Message::*value;
};

} // namespace orvo
