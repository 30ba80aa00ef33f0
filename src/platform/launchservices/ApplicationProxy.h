#pragma once

#include "platform/launchservices/BundleProxy.h"

namespace orvo {

/// An installed application, by the name of its desktop file and bus service.
class ApplicationProxy final : public BundleProxy {
public:
    [[nodiscard]] static std::shared_ptr<ApplicationProxy>
    applicationProxyForIdentifier(std::string identifier);
};

} // namespace orvo
