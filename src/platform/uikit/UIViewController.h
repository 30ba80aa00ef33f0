#pragma once

#include "platform/foundation/CGGeometry.h"
#include "platform/foundation/NSExtensionContext.h"
#include "platform/foundation/NSObject.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace orvo {

class UIView;
class UIViewControllerTransitionCoordinator;

/// Manages one screen. The principal one of an extension is given the context of its host, which
/// tells it when its view appears and disappears. Main thread.
class UIViewController : public virtual NSObject {
public:
    /// Both arguments are for views described in a file; this platform has none.
    [[nodiscard]] static std::shared_ptr<UIViewController>
    initWithNibName_bundle(const std::optional<std::string>& nibName,
                           const std::shared_ptr<NSObject>& bundle);

    /// Nil outside an extension.
    [[nodiscard]] const std::shared_ptr<NSExtensionContext>& extensionContext() const noexcept {
        return _extensionContext;
    }
    /// For the host.
    void setExtensionContext(std::shared_ptr<NSExtensionContext> context) {
        _extensionContext = std::move(context);
    }

    /// Loaded when first asked for.
    [[nodiscard]] const std::shared_ptr<UIView>& view();
    [[nodiscard]] bool isViewLoaded() const noexcept { return _view != nullptr; }
    void setView(std::shared_ptr<UIView> view);
    /// Sets the view; an empty one unless overridden.
    virtual void loadView();
    /// Once, after the view has been made. An override of this or any of the next calls its base.
    virtual void viewDidLoad() { _hasReachedBase("viewDidLoad"); }
    /// Before the view lays out its subviews.
    virtual void viewWillLayoutSubviews() { _hasReachedBase("viewWillLayoutSubviews"); }
    virtual void viewWillAppear(bool /*animated*/) { _hasReachedBase("viewWillAppear"); }
    virtual void viewDidAppear(bool /*animated*/) { _hasReachedBase("viewDidAppear"); }
    virtual void viewWillDisappear(bool /*animated*/) { _hasReachedBase("viewWillDisappear"); }
    virtual void viewDidDisappear(bool /*animated*/) { _hasReachedBase("viewDidDisappear"); }
    /// The view is about to become as large as `size`.
    virtual void viewWillTransitionToSize_withTransitionCoordinator(
        CGSize /*size*/,
        const std::shared_ptr<UIViewControllerTransitionCoordinator>& /*coordinator*/) {
        _hasReachedBase("viewWillTransitionToSize_withTransitionCoordinator");
    }
    virtual void didReceiveMemoryWarning() { _hasReachedBase("didReceiveMemoryWarning"); }

    /// How large the content would like to be, in points.
    [[nodiscard]] CGSize preferredContentSize() const noexcept { return _preferredContentSize; }
    /// Tells whoever shows it where it is another one.
    virtual void setPreferredContentSize(CGSize size);
    /// For the host: called after every change of the preferred size.
    void _setPreferredContentSizeChanged(std::function<void(CGSize)> changed) {
        _preferredContentSizeChanged = std::move(changed);
    }

protected:
    bool _initWithNibName_bundle(const std::optional<std::string>& nibName,
                                 const std::shared_ptr<NSObject>& bundle);
    /// One of the calls above, by its name, has come as far as this class: whether an override lets
    /// it, and when, is seen here. Does nothing.
    virtual void _hasReachedBase(const char* /*call*/) {}

private:
    std::shared_ptr<NSExtensionContext> _extensionContext;
    std::shared_ptr<UIView> _view;
    CGSize _preferredContentSize;
    std::function<void(CGSize)> _preferredContentSizeChanged;
};

} // namespace orvo
