#pragma once

#include "platform/foundation/NSObject.h"
#include "widget/result/Result.h"

#include <functional>

namespace orvo {

/// A fetch under way, which later callers can join. Any thread.
class OWTransitIncidentFetcherRequest : public virtual NSObject {
public:
    using CompletionHandler = std::function<void(const std::shared_ptr<Result>& result)>;

    /// The handler is called once when the fetch ends, on whatever thread that is; for a fetch that
    /// has ended, inside this call. A nil handler is ignored.
    virtual void addHandler(CompletionHandler handler) = 0;
    /// Nil until the fetch has ended.
    [[nodiscard]] virtual std::shared_ptr<Result> result() const = 0;
};

} // namespace orvo
