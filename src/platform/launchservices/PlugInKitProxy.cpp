#include "platform/launchservices/PlugInKitProxy.h"

namespace orvo {

std::shared_ptr<PlugInKitProxy> PlugInKitProxy::pluginKitProxyForIdentifier_containingBundle(
    std::string identifier, std::shared_ptr<BundleProxy> containingBundle) {
    auto proxy = std::make_shared<PlugInKitProxy>();
    proxy->_initWithBundleIdentifier(std::move(identifier));
    proxy->_containingBundle = std::move(containingBundle);
    return proxy;
}

} // namespace orvo
