#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSError.h"

#include <functional>

namespace orvo {

/// One lookup of line items, made by the `LookupService` and started once.
class LineItemTicket : public virtual NSObject {
public:
    /// The array of `TransitLineItem`s in the order asked is meaningful only when the error is nil.
    using Handler = std::function<void(const std::shared_ptr<NSArray>& items,
                                       const std::shared_ptr<NSError>& error)>;
    using NetworkActivity = std::function<void(bool active)>;

    /// Starts the lookup. The handler is called once, on the main queue and never inside this call;
    /// the ticket need not be kept until then. `networkActivity`, which may be empty, is called on
    /// the main queue with true when the lookup begins and with false before the handler.
    /// @throws NSInvalidArgumentException when the ticket was submitted before
    virtual void submitWithHandler_networkActivity(Handler handler,
                                                   NetworkActivity networkActivity) = 0;
};

} // namespace orvo
