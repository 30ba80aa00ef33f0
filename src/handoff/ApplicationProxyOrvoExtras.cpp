#include "handoff/ApplicationProxyOrvoExtras.h"

#include "platform/foundation/NSString.h"
#include "platform/launchservices/PlugInKitProxy.h"

namespace orvo::ApplicationProxyOrvoExtras {

std::shared_ptr<ApplicationProxy>
_orvo_containingApplicationProxy(std::shared_ptr<NSError>* error) {
    const auto proxy = BundleProxy::bundleProxyForCurrentProcess();
    if (!proxy) {
        if (error) // The spelling is what log searches look for.
            *error = NSError::errorWithDomain_code_userInfo(
                OrvoActivityErrorDomain,
                0,
                NSDictionary::dictionaryWithTextKeys(
                    {{NSDebugDescriptionErrorKey,
                      NSString::string("no appliction proxy object for current process")}}));
        return nullptr;
    }
    if (auto application = std::dynamic_pointer_cast<ApplicationProxy>(proxy))
        return application;
    if (const auto plugIn = std::dynamic_pointer_cast<PlugInKitProxy>(proxy))
        return std::dynamic_pointer_cast<ApplicationProxy>(plugIn->containingBundle());
    return nullptr;
}

} // namespace orvo::ApplicationProxyOrvoExtras
