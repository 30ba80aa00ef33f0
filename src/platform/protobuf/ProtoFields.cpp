#include "platform/protobuf/ProtoFields.h"

#include "platform/foundation/Hashing.h"

#include <fmt/format.h>

namespace orvo {

std::string protoEnumAsString(ProtoEnumNames names, std::int32_t value) {
    if (value >= 0 && std::cmp_less(value, names.size()))
        return names[static_cast<std::size_t>(value)];
    return fmt::format("(unknown: {})", value);
}

std::int32_t protoStringAsEnum(ProtoEnumNames names, const std::string& name) {
    for (std::size_t i = 0; i < names.size(); ++i)
        if (name == names[i])
            return static_cast<std::int32_t>(i);
    return 0;
}

std::uint64_t protoHash(std::uint64_t value) {
    return value * HashMultiplier;
}

std::uint64_t protoHash(double value) {
    return hashOfDouble(value);
}

} // namespace orvo
