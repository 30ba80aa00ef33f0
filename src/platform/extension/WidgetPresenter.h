#pragma once

#include "platform/foundation/CGGeometry.h"
#include "platform/foundation/NSObject.h"

#include <functional>

namespace orvo {

class WidgetHost;

/// Shows what a host holds: in a window, or in an area of the desktop. Main thread.
class WidgetPresenter : public virtual NSObject {
public:
    /// The content becomes as large as `size`, in points; it has been told. Call `alongside` once,
    /// when the change begins, and `completion` once, when it is over (both at once where nothing
    /// moves). Another change may come before that.
    virtual void widgetHost_transitionToContentSize(WidgetHost& host,
                                                    CGSize size,
                                                    std::function<void()> alongside,
                                                    std::function<void()> completion) = 0;
    /// The mode shown, or whether there is more to show, is another one.
    virtual void widgetHostDidChangeDisplayMode(WidgetHost& host) = 0;
    /// The host's view is another one.
    virtual void widgetHostDidChangeView(WidgetHost& host) = 0;
};

} // namespace orvo
