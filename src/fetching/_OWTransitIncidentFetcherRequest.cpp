#include "fetching/_OWTransitIncidentFetcherRequest.h"

#include <utility>

namespace orvo {

std::shared_ptr<_OWTransitIncidentFetcherRequest>
_OWTransitIncidentFetcherRequest::initWithCompletionHandler(CompletionHandler handler) {
    auto request = std::make_shared<_OWTransitIncidentFetcherRequest>();
    return request->_initWithCompletionHandler(std::move(handler)) ? request : nullptr;
}

bool _OWTransitIncidentFetcherRequest::_initWithCompletionHandler(CompletionHandler handler) {
    if (handler)
        _handlers.push_back(std::move(handler));
    return true;
}

std::vector<OWTransitIncidentFetcherRequest::CompletionHandler>
_OWTransitIncidentFetcherRequest::handlers() const {
    const std::lock_guard lock(_monitor);
    return _handlers;
}

void _OWTransitIncidentFetcherRequest::setResultAndInvokeCompletionHandlers(
    const std::shared_ptr<Result>& result) {
    std::vector<CompletionHandler> handlers;
    {
        const std::lock_guard lock(_monitor);
        _setResult(result);
        handlers = _handlers;
    }
    for (const auto& handler : handlers)
        handler(result);
}

void _OWTransitIncidentFetcherRequest::addHandler(CompletionHandler handler) {
    if (!handler)
        return;
    if (const auto ended = result()) {
        handler(ended);
        return;
    }
    // A request that ends at this point keeps the handler and never calls it: one look at the
    // result decides. Those who join do so on the main thread, while they hold a request that has
    // not answered them yet, so the gap is small.
    const std::lock_guard lock(_monitor);
    _handlers.push_back(std::move(handler));
}

std::shared_ptr<Result> _OWTransitIncidentFetcherRequest::result() const {
    const std::lock_guard lock(_resultLock);
    return _result;
}

void _OWTransitIncidentFetcherRequest::_setResult(const std::shared_ptr<Result>& result) {
    const std::lock_guard lock(_resultLock);
    _result = result;
}

} // namespace orvo
