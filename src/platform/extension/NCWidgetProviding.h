#pragma once

#include "platform/foundation/CGGeometry.h"
#include "platform/foundation/NSExtensionContext.h"
#include "platform/foundation/NSObject.h"

#include <cstdint>
#include <functional>

namespace orvo {

/// How an update of a widget has ended.
enum class NCUpdateResult : std::int64_t { NewData = 0, NoData = 1, Failed = 2 };

/// What a widget's host asks of the widget. Main thread.
class NCWidgetProviding : public virtual NSObject {
public:
    using UpdateHandler = std::function<void(NCUpdateResult result)>;

    /// Bring what is shown up to date. The handler is called once, never inside this call; several
    /// requests may run at once.
    virtual void widgetPerformUpdateWithCompletionHandler(UpdateHandler completionHandler) = 0;
    /// The host shows the widget in another mode now, at most as large as `maximumSize`, in points.
    virtual void widgetActiveDisplayModeDidChange_withMaximumSize(NCWidgetDisplayMode mode,
                                                                  CGSize maximumSize) = 0;
};

} // namespace orvo
