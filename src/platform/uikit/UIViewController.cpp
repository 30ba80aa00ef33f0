#include "platform/uikit/UIViewController.h"

#include "platform/uikit/UIView.h"

#include <utility>

namespace orvo {

namespace {

/// The root view of a controller, which hears when it is laid out.
class ControllerView final : public UIView {
public:
    static std::shared_ptr<ControllerView> forController(UIViewController& controller) {
        auto view = std::make_shared<ControllerView>();
        view->_initWithFrame({});
        view->_controller = std::weak_ptr<UIViewController>(
            std::shared_ptr<UIViewController>(controller.shared_from_this(), &controller));
        return view;
    }
    void layoutSubviews() override {
        if (const auto controller = _controller.lock())
            controller->viewWillLayoutSubviews();
        UIView::layoutSubviews();
    }

private:
    std::weak_ptr<UIViewController> _controller;
};

} // namespace

std::shared_ptr<UIViewController>
UIViewController::initWithNibName_bundle(const std::optional<std::string>& nibName,
                                         const std::shared_ptr<NSObject>& bundle) {
    auto controller = std::make_shared<UIViewController>();
    return controller->_initWithNibName_bundle(nibName, bundle) ? controller : nullptr;
}

bool UIViewController::_initWithNibName_bundle(const std::optional<std::string>& /*nibName*/,
                                               const std::shared_ptr<NSObject>& /*bundle*/) {
    _hasReachedBase("initWithNibName_bundle");
    return true;
}

const std::shared_ptr<UIView>& UIViewController::view() {
    if (!_view) {
        loadView();
        viewDidLoad();
    }
    return _view;
}

void UIViewController::setView(std::shared_ptr<UIView> view) {
    _view = std::move(view);
}

void UIViewController::loadView() {
    setView(ControllerView::forController(*this));
}

void UIViewController::setPreferredContentSize(CGSize size) {
    if (size == _preferredContentSize)
        return;
    _preferredContentSize = size;
    if (_preferredContentSizeChanged)
        _preferredContentSizeChanged(size);
}

} // namespace orvo
