#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSObject.h"

#include <functional>
#include <string>

namespace orvo {

/// What is known of an installed bundle: an application, or a plug-in inside one.
class BundleProxy : public virtual NSObject {
public:
    /// The bundle of this process; nil where it has none. By the process's bundle description.
    [[nodiscard]] static std::shared_ptr<BundleProxy> bundleProxyForCurrentProcess();
    /// What that answers. Default: nil, until a program's `main` says what it is.
    static EnvironmentSlot<std::shared_ptr<BundleProxy>>& currentProcess();

    [[nodiscard]] const std::string& bundleIdentifier() const noexcept { return _bundleIdentifier; }
    [[nodiscard]] std::string description() const override;

protected:
    void _initWithBundleIdentifier(std::string identifier) {
        _bundleIdentifier = std::move(identifier);
    }

private:
    std::string _bundleIdentifier;
};

} // namespace orvo
