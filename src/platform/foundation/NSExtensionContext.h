#pragma once

#include "platform/foundation/CGGeometry.h"
#include "platform/foundation/NSObject.h"
#include "platform/foundation/NSURL.h"

#include <cstdint>
#include <functional>

namespace orvo {

/// How much of itself a widget shows.
enum class NCWidgetDisplayMode : std::int64_t { Compact = 0, Expanded = 1 };

/// What an extension knows of its host, and may ask of it. Main thread.
class NSExtensionContext : public virtual NSObject {
public:
    /// Asks the host to open a URL. The handler, which may be empty, is told whether that went
    /// well: once, never inside the call.
    virtual void openURL_completionHandler(const std::shared_ptr<NSURL>& url,
                                           std::function<void(bool success)> completionHandler) = 0;

    /// The mode in which the host shows the widget now.
    [[nodiscard]] virtual NCWidgetDisplayMode widgetActiveDisplayMode() const = 0;
    /// The largest mode that the widget offers. At first compact.
    [[nodiscard]] virtual NCWidgetDisplayMode widgetLargestAvailableDisplayMode() const = 0;
    virtual void setWidgetLargestAvailableDisplayMode(NCWidgetDisplayMode mode) = 0;
    /// The most that the widget may take up in a mode, in points; a height of 0 is no limit.
    [[nodiscard]] virtual CGSize
    widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode mode) const = 0;
};

} // namespace orvo
