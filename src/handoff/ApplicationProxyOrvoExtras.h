#pragma once

#include "platform/foundation/NSError.h"
#include "platform/launchservices/ApplicationProxy.h"

namespace orvo {

inline constexpr const char* OrvoActivityErrorDomain = "OrvoActivityErrorDomain";

namespace ApplicationProxyOrvoExtras {

/// The application that contains this process: the process's own bundle where that is an
/// application, or the bundle that contains it where it is a plug-in. Nil with an error when the
/// process has no bundle; nil without one when the bundle is of another kind or contained in none.
/// `error` may be null.
[[nodiscard]] std::shared_ptr<ApplicationProxy>
_orvo_containingApplicationProxy(std::shared_ptr<NSError>* error);

} // namespace ApplicationProxyOrvoExtras

} // namespace orvo
