#include "platform/extension/_HeldWidget.h"

#include "platform/foundation/DispatchQueue.h"
#include "platform/uikit/UIViewController.h"
#include "platform/uikit/table/UIScrollView.h"

#include <algorithm>

namespace orvo {

namespace {

std::shared_ptr<UIView> outermost(std::shared_ptr<UIView> view) {
    while (const auto above = view->superview())
        view = above;
    return view;
}

} // namespace

_HeldWidget::_HeldWidget(std::shared_ptr<UIViewController> controller,
                         std::shared_ptr<NSExtensionContext> context,
                         std::function<void()> heightPreferred)
    : _controller(std::move(controller))
    , _context(std::move(context)) {
    _controller->setExtensionContext(_context);
    _controller->_setPreferredContentSizeChanged([this, told = std::move(heightPreferred)](CGSize) {
        _hasPreference = true;
        told();
    });
}

_HeldWidget::~_HeldWidget() {
    end();
}

std::shared_ptr<NCWidgetProviding> _HeldWidget::provider() const {
    return std::dynamic_pointer_cast<NCWidgetProviding>(_controller);
}

bool _HeldWidget::isLoaded() const {
    return _controller->isViewLoaded();
}

const std::shared_ptr<UIView>& _HeldWidget::view() const {
    return _controller->view();
}

void _HeldWidget::load(CGSize size, const NSDirectionalEdgeInsets& margins) {
    // The controller makes its view and then reads its width, so that comes between the two.
    _controller->loadView();
    view()->setDirectionalLayoutMargins(margins);
    view()->setFrame({{0, 0}, size});
    _controller->viewDidLoad();
    tellMode();
}

void _HeldWidget::tellMode() {
    const auto mode = _context->widgetActiveDisplayMode();
    if (const auto widget = provider())
        widget->widgetActiveDisplayModeDidChange_withMaximumSize(
            mode, _context->widgetMaximumSizeForDisplayMode(mode));
}

void _HeldWidget::appear() {
    _visible = true;
    _controller->viewWillAppear(false);
    _controller->viewDidAppear(false);
}

void _HeldWidget::disappear() {
    _visible = false;
    _controller->viewWillDisappear(false);
    _controller->viewDidDisappear(false);
}

void _HeldWidget::end() {
    _controller->_setPreferredContentSizeChanged({});
    if (_visible)
        disappear();
}

// NOLINTNEXTLINE(readability-make-member-function-const): what it holds changes
void _HeldWidget::traitsDidChange(const UITraitCollection& previous) {
    if (isLoaded())
        outermost(view())->_traitsDidChange(previous);
}

void _HeldWidget::requestUpdate(NCWidgetProviding::UpdateHandler handler) {
    if (const auto widget = provider()) {
        widget->widgetPerformUpdateWithCompletionHandler(std::move(handler));
        return;
    }
    DispatchQueue::mainQueue()->async([handler = std::move(handler)] {
        if (handler)
            handler(NCUpdateResult::NoData);
    });
}

std::optional<CGFloat> _HeldWidget::preferredHeight() const {
    if (!_hasPreference)
        return std::nullopt;
    return std::max<CGFloat>(_controller->preferredContentSize().height, 0);
}

CGFloat _HeldWidget::heightOfContentsWithin(CGFloat height) const {
    const auto frame = view()->frame();
    view()->setFrame({frame.origin, {frame.size.width, height}});
    view()->layoutIfNeeded();
    CGFloat bottom = 0;
    for (const auto& subview : view()->subviews()) {
        const auto scrolling = std::dynamic_pointer_cast<UIScrollView>(subview);
        const auto& place = subview->frame();
        const auto reach = scrolling ? scrolling->contentSize().height : place.size.height;
        bottom = std::max(bottom, place.origin.y + reach);
    }
    view()->setFrame(frame);
    return bottom;
}

} // namespace orvo
