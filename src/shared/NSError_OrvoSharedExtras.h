#pragma once

#include "platform/foundation/NSError.h"

#include <string>

namespace orvo::OrvoSharedExtras {

/// The error that says that the person cancelled: `NSCocoaErrorDomain`, `NSUserCancelledError`, no
/// user info.
[[nodiscard]] std::shared_ptr<NSError> _orvo_cancellationError();

/// Whether domain and code are those of a cancellation. False for nil.
[[nodiscard]] bool _orvo_isCancellation(const std::shared_ptr<NSError>& self);

/// Whether both are the given ones. False for nil.
[[nodiscard]] bool _orvo_isErrorOfDomain_code(const std::shared_ptr<NSError>& self,
                                              const std::string& domain,
                                              std::int64_t code);

} // namespace orvo::OrvoSharedExtras
