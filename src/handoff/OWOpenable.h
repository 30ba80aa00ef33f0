#pragma once

#include "platform/foundation/NSError.h"
#include "platform/foundation/NSObject.h"

#include <functional>

namespace orvo {

/// What a tap on a row opens in the map application.
class OWOpenable : public virtual NSObject {
public:
    /// Told whether it was opened; the error is nil on success.
    using CompletionHandler =
        std::function<void(bool success, const std::shared_ptr<NSError>& error)>;

    /// `context` is who opens it, as a rule a view controller. The handler may be empty; the
    /// platform calls it on a queue of its choosing. Main thread.
    virtual void openInContext_completionHandler(const std::shared_ptr<NSObject>& context,
                                                 CompletionHandler completionHandler) = 0;
};

} // namespace orvo
