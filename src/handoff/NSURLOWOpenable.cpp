#include "handoff/NSURLOWOpenable.h"

#include "handoff/SharedSession.h"
#include "platform/mapuikit/MapItem.h"
#include "platform/uikit/UIViewController.h"

namespace orvo {

std::shared_ptr<NSURLOWOpenable> NSURLOWOpenable::openableWithURL(std::shared_ptr<NSURL> url) {
    if (!url)
        return nullptr;
    auto openable = std::make_shared<NSURLOWOpenable>();
    openable->_url = std::move(url);
    return openable;
}

void NSURLOWOpenable::openInContext_completionHandler(const std::shared_ptr<NSObject>& context,
                                                      CompletionHandler completionHandler) {
    const auto controller = std::dynamic_pointer_cast<UIViewController>(context);
    if (!controller)
        return;
    shareSessionWithOrvo();
    const auto converted = MapItem::_sharedSessionURLForPunchoutURL(_url->absoluteString());
    const auto extensionContext = controller->extensionContext();
    if (!extensionContext)
        return;
    extensionContext->openURL_completionHandler(
        converted, [handler = std::move(completionHandler)](bool success) {
            if (handler)
                handler(success, nullptr); // no error even where it did not open
        });
}

bool NSURLOWOpenable::isEqual(const NSObject* other) const {
    const auto* openable = dynamic_cast<const NSURLOWOpenable*>(other);
    return _url->isEqual(openable ? openable->_url.get() : other);
}

std::uint64_t NSURLOWOpenable::hash() const {
    return _url->hash();
}

std::string NSURLOWOpenable::description() const {
    return _url->description();
}

} // namespace orvo
