#pragma once

#include "handoff/OWOpenable.h"
#include "platform/foundation/NSURL.h"

namespace orvo {

/// A URL as something that a tap opens. It equals, hashes and describes as the URL that it wraps,
/// and equals that URL itself.
class NSURLOWOpenable final : public OWOpenable {
public:
    /// Nil for nil.
    [[nodiscard]] static std::shared_ptr<NSURLOWOpenable>
    openableWithURL(std::shared_ptr<NSURL> url);

    [[nodiscard]] const std::shared_ptr<NSURL>& url() const noexcept { return _url; }

    /// Opens through the extension context of a view controller. A context of another kind, or nil:
    /// nothing at all happens, and the handler is never called.
    void openInContext_completionHandler(const std::shared_ptr<NSObject>& context,
                                         CompletionHandler completionHandler) override;

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    std::shared_ptr<NSURL> _url;
};

} // namespace orvo
