#pragma once

#include "platform/foundation/NSObject.h"

namespace orvo {

/// The one place in which a selector kept in a variable is performed; answers what the method
/// answers, and nil for a nil object.
/// @throws NSInvalidArgumentException when the object does not respond
std::shared_ptr<NSObject> OrvoPerformSelector(const std::shared_ptr<NSObject>& object,
                                              const Selector& selector);

} // namespace orvo
