#include "platform/launchservices/ApplicationProxy.h"

namespace orvo {

std::shared_ptr<ApplicationProxy>
ApplicationProxy::applicationProxyForIdentifier(std::string identifier) {
    auto proxy = std::make_shared<ApplicationProxy>();
    proxy->_initWithBundleIdentifier(std::move(identifier));
    return proxy;
}

} // namespace orvo
