#include "platform/extension/_WidgetContext.h"

#include "platform/foundation/Log.h"
#include "platform/launchservices/ApplicationLauncher.h"

namespace orvo {

std::shared_ptr<_WidgetContext>
_WidgetContext::contextWithApplicationIdentifier(std::string identifier) {
    auto context = std::make_shared<_WidgetContext>();
    context->_applicationIdentifier = std::move(identifier);
    return context;
}

void _WidgetContext::openURL_completionHandler(
    const std::shared_ptr<NSURL>& url, std::function<void(bool success)> completionHandler) {
    ApplicationLauncher::sharedLauncher()->openURLs(
        _applicationIdentifier,
        {url->absoluteString()},
        [handler = std::move(completionHandler)](const std::shared_ptr<NSError>& error) {
            if (error)
                Log::findOrCreate("WidgetHost")->error("%@", error);
            if (handler)
                handler(!error);
        });
}

void _WidgetContext::setWidgetLargestAvailableDisplayMode(NCWidgetDisplayMode mode) {
    _largestMode = mode;
    if (_largestModeTold)
        _largestModeTold();
}

} // namespace orvo
