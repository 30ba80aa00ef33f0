#pragma once

#include "platform/launchservices/BundleProxy.h"

namespace orvo {

/// A plug-in: an extension that lives in an application's bundle.
class PlugInKitProxy final : public BundleProxy {
public:
    /// `containingBundle` may be nil.
    [[nodiscard]] static std::shared_ptr<PlugInKitProxy>
    pluginKitProxyForIdentifier_containingBundle(std::string identifier,
                                                 std::shared_ptr<BundleProxy> containingBundle);

    /// The bundle that it lives in; nil when that is not known.
    [[nodiscard]] const std::shared_ptr<BundleProxy>& containingBundle() const noexcept {
        return _containingBundle;
    }

private:
    std::shared_ptr<BundleProxy> _containingBundle;
};

} // namespace orvo
