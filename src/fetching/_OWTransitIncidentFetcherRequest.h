#pragma once

#include "fetching/OWTransitIncidentFetcherRequest.h"

#include <mutex>
#include <vector>

namespace orvo {

/// The fetcher's side of a request: it gathers the handlers and ends once.
class _OWTransitIncidentFetcherRequest final : public virtual OWTransitIncidentFetcherRequest {
public:
    /// `handler` may be nil.
    [[nodiscard]] static std::shared_ptr<_OWTransitIncidentFetcherRequest>
    initWithCompletionHandler(CompletionHandler handler);

    /// A copy of the list in the order of adding. One handler added twice is in it twice, and all
    /// stay after the end.
    [[nodiscard]] std::vector<CompletionHandler> handlers() const;

    /// Ends the request: stores the result and calls every handler with it, in the order of adding
    /// and without the lock.
    void setResultAndInvokeCompletionHandlers(const std::shared_ptr<Result>& result);

    void addHandler(CompletionHandler handler) override;
    [[nodiscard]] std::shared_ptr<Result> result() const override;

private:
    bool _initWithCompletionHandler(CompletionHandler handler);
    void _setResult(const std::shared_ptr<Result>& result);

    std::vector<CompletionHandler> _handlers;
    std::shared_ptr<Result> _result;

    /// Held while the handlers are changed or copied.
    mutable std::recursive_mutex _monitor;
    /// Makes `_result` atomic by itself; inside the monitor or without it.
    mutable std::mutex _resultLock;
};

} // namespace orvo
