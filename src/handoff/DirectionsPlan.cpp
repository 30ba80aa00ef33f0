#include "handoff/DirectionsPlan.h"

#include "platform/foundation/Exceptions.h"

namespace orvo {

std::string DirectionsPlan::displayMethodAsString(std::int32_t value) {
    return protoEnumAsString(DisplayMethodNames, value);
}

std::int32_t DirectionsPlan::StringAsDisplayMethod(const std::string& name) {
    return protoStringAsEnum(DisplayMethodNames, name);
}

std::string DirectionsPlan::transitPrioritizationAsString(std::int32_t value) {
    return protoEnumAsString(TransitPrioritizationNames, value);
}

std::int32_t DirectionsPlan::StringAsTransitPrioritization(const std::string& name) {
    return protoStringAsEnum(TransitPrioritizationNames, name);
}

} // namespace orvo
