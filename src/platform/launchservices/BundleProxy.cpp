#include "platform/launchservices/BundleProxy.h"

namespace orvo {

std::shared_ptr<BundleProxy> BundleProxy::bundleProxyForCurrentProcess() {
    return currentProcess().get();
}

EnvironmentSlot<std::shared_ptr<BundleProxy>>& BundleProxy::currentProcess() {
    static EnvironmentSlot<std::shared_ptr<BundleProxy>> slot(
        [] { return std::shared_ptr<BundleProxy>(); });
    return slot;
}

std::string BundleProxy::description() const {
    return rootDescription() + " " + _bundleIdentifier;
}

} // namespace orvo
