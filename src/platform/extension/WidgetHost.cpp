#include "platform/extension/WidgetHost.h"

#include "platform/extension/WidgetPresenter.h"
#include "platform/extension/WidgetUpdateSchedule.h"
#include "platform/extension/_DisplayModeStore.h"
#include "platform/extension/_HeldWidget.h"
#include "platform/extension/_TransitionBlocks.h"
#include "platform/extension/_WidgetContext.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/NSNotificationCenter.h"
#include "platform/uikit/UIFontDescriptor.h"
#include "platform/uikit/UIView.h"
#include "platform/uikit/UIViewController.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace orvo {

namespace {

/// How many compact heights the expanded widget may have where no screen says it: five rows at
/// every text size.
constexpr double RowsWithoutScreen = 5.6;
/// What a widget may unfold to while its height is found out.
constexpr CGFloat Boundless = 10000;

CGFloat compactHeightIn(UIContentSizeCategory category) {
    const auto size = pointSizeOf(UIFontTextStyleBody, category);
    const auto standard = pointSizeOf(UIFontTextStyleBody, UIContentSizeCategory::L);
    return std::round(WidgetHost::CompactHeight * size / standard);
}

/// How many whole rows the expanded widget has room for.
double rowsWithin(const _WidgetContext& context) {
    return std::floor(
        context.widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode::Expanded).height /
        context.widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode::Compact).height);
}

} // namespace

class WidgetHost::Hold {
public:
    explicit Hold(WidgetHost& host)
        : _host(host) {
        ++_host._holds;
    }
    Hold(const Hold&) = delete;
    Hold& operator=(const Hold&) = delete;
    ~Hold() { --_host._holds; }

private:
    WidgetHost& _host;
};

std::shared_ptr<WidgetHost>
WidgetHost::hostWithExtension_settings(const Extension& extension,
                                       const WidgetHostSettings& settings) {
    auto host = std::make_shared<WidgetHost>();
    host->_initWithExtension_settings(extension, settings);
    return host;
}

WidgetHost::WidgetHost() = default;

WidgetHost::~WidgetHost() {
    if (!_widget)
        return;
    _context->setLargestModeTold({});
    _widget->end();
}

void WidgetHost::_initWithExtension_settings(const Extension& extension,
                                             const WidgetHostSettings& settings) {
    const auto weak = std::weak_ptr<WidgetHost>(strong(this));
    _extensionDescription = extension.description();
    _makePrincipalObject = [extension] {
        return extension.makePrincipalObject();
    };
    _settings = settings;
    _chosenMode =
        settings.mode.value_or(_DisplayModeStore::load(_extensionDescription.bundleIdentifier)
                                   .value_or(NCWidgetDisplayMode::Compact));
    _context = _WidgetContext::contextWithApplicationIdentifier(
        _extensionDescription.containingApplication);
    _context->setActiveMode(_chosenMode);
    _context->setLargestModeTold([weak] {
        if (const auto self = weak.lock())
            self->largestModeWasTold();
    });
    updateMaxima(UITraitCollection::system().get().preferredContentSizeCategory);
    _contentSize = _context->widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode::Compact);
    _schedule = WidgetUpdateSchedule::scheduleWithRequest([weak] {
        if (const auto self = weak.lock())
            self->requestUpdate();
    });
    makeWidget();
}

void WidgetHost::makeWidget() {
    _widget = std::make_unique<_HeldWidget>(
        _makePrincipalObject(), _context, [weak = std::weak_ptr<WidgetHost>(strong(this))] {
            if (const auto self = weak.lock())
                self->updateContentSize();
        });
}

// What is shown

const std::shared_ptr<UIViewController>& WidgetHost::controller() const noexcept {
    return _widget->controller();
}

const std::shared_ptr<UIView>& WidgetHost::view() {
    if (!_widget->isLoaded())
        loadView();
    return _widget->view();
}

void WidgetHost::loadView() {
    const Hold hold(*this);
    _widget->load(_contentSize, {0, SideMargin, 0, SideMargin});
    _contentSize.height = std::min(preferredHeight(), heightLimit());
    _widget->view()->setFrame({{0, 0}, _contentSize});
}

CGFloat WidgetHost::preferredHeight() const {
    if (const auto preferred = _widget->preferredHeight())
        return *preferred;
    if (displayMode() == NCWidgetDisplayMode::Compact || !_widget->isLoaded())
        return maximumSizeForDisplayMode(NCWidgetDisplayMode::Compact).height;
    return _widget->heightOfContentsWithin(std::min(heightLimit(), Boundless));
}

CGFloat WidgetHost::heightLimit() const {
    const auto free = _settings.freeHeight.value_or(std::numeric_limits<CGFloat>::infinity());
    const auto maximum = maximumSizeForDisplayMode(displayMode()).height;
    return maximum > 0 ? std::min(maximum, free) : free;
}

NCWidgetDisplayMode WidgetHost::displayMode() const {
    return _context->widgetActiveDisplayMode();
}

bool WidgetHost::offersExpanded() const {
    return _context->widgetLargestAvailableDisplayMode() == NCWidgetDisplayMode::Expanded;
}

CGSize WidgetHost::maximumSizeForDisplayMode(NCWidgetDisplayMode mode) const {
    return _context->widgetMaximumSizeForDisplayMode(mode);
}

void WidgetHost::updateMaxima(UIContentSizeCategory category) {
    const auto compact = compactHeightIn(category);
    auto expanded = _settings.freeHeight.value_or(RowsWithoutScreen * compact);
    if (_settings.maxRows)
        expanded = static_cast<CGFloat>(*_settings.maxRows) * compact;
    _context->setMaxima({_settings.width, compact}, {_settings.width, expanded});
}

void WidgetHost::updateContentSize() {
    if (_holds > 0 || _modeWillSettle || !_widget->isLoaded())
        return;
    const CGSize size{_settings.width, std::min(preferredHeight(), heightLimit())};
    if (size == _contentSize)
        return;
    _contentSize = size;
    transitionTo(size);
}

void WidgetHost::transitionTo(CGSize size) {
    const auto blocks = std::make_shared<_TransitionBlocks>();
    controller()->viewWillTransitionToSize_withTransitionCoordinator(size, blocks);
    const auto alongside = [blocks] {
        blocks->runAnimations();
    };
    const auto completion = [blocks] {
        blocks->runCompletions();
    };
    if (const auto presenter = _presenter.lock()) {
        presenter->widgetHost_transitionToContentSize(*this, size, alongside, completion);
        return;
    }
    const auto& view = _widget->view();
    view->setFrame({view->frame().origin, size});
    alongside();
    completion();
}

// Modes

void WidgetHost::setDisplayMode(NCWidgetDisplayMode mode) {
    if (mode == NCWidgetDisplayMode::Expanded && !offersExpanded())
        return;
    _chosenMode = mode;
    if (!_settings.mode)
        _DisplayModeStore::save(_extensionDescription.bundleIdentifier, mode);
    showMode(mode);
}

void WidgetHost::showMode(NCWidgetDisplayMode mode) {
    if (mode == displayMode())
        return;
    {
        const Hold hold(*this);
        _context->setActiveMode(mode);
        _widget->tellMode();
    }
    if (const auto presenter = _presenter.lock())
        presenter->widgetHostDidChangeDisplayMode(*this);
    updateContentSize();
}

NCWidgetDisplayMode WidgetHost::wantedMode() const {
    return offersExpanded() ? _chosenMode : NCWidgetDisplayMode::Compact;
}

void WidgetHost::largestModeWasTold() {
    const auto largest = _context->widgetLargestAvailableDisplayMode();
    if (largest != _toldLargestMode) {
        _toldLargestMode = largest;
        if (const auto presenter = _presenter.lock())
            presenter->widgetHostDidChangeDisplayMode(*this);
    }
    if (wantedMode() != displayMode() && !_modeWillSettle) {
        _modeWillSettle = true;
        DispatchQueue::mainQueue()->async([weak = std::weak_ptr<WidgetHost>(strong(this))] {
            if (const auto self = weak.lock())
                self->settleMode();
        });
    }
    if (_contentTold)
        _contentTold();
    // A widget that suddenly has no more than one row to show may tell of a failure that nobody
    // here asked for. Asking at this moment joins what has just ended, so that the failure is known
    // and asked about again later.
    if (largest == NCWidgetDisplayMode::Compact && _visible && _holds == 0 && _requestsRunning == 0)
        requestUpdate();
}

void WidgetHost::settleMode() {
    _modeWillSettle = false;
    showMode(wantedMode());
    updateContentSize();
}

// Life

void WidgetHost::setShown(bool shown) {
    _shown = shown;
    updateVisibility();
}

void WidgetHost::setLocked(bool locked) {
    _locked = locked;
    updateVisibility();
}

void WidgetHost::updateVisibility() {
    const bool visible = _shown && !_locked;
    if (visible == _visible)
        return;
    _visible = visible;
    if (!visible) {
        _schedule->setVisible(false);
        _widget->disappear();
        return;
    }
    static_cast<void>(view());
    {
        const Hold hold(*this);
        _widget->appear();
    }
    updateContentSize();
    _schedule->setVisible(true);
}

void WidgetHost::requestUpdate(NCWidgetProviding::UpdateHandler handler) {
    ++_requestsRunning;
    _widget->requestUpdate([weak = std::weak_ptr<WidgetHost>(strong(this)),
                            handler = std::move(handler)](NCUpdateResult result) {
        if (const auto self = weak.lock()) {
            --self->_requestsRunning;
            self->_schedule->didAnswer(result != NCUpdateResult::Failed);
        }
        if (handler)
            handler(result);
    });
}

// What happens around it

void WidgetHost::setWidth(CGFloat width) {
    _settings.width = width;
    updateMaxima(UITraitCollection::system().get().preferredContentSizeCategory);
    updateContentSize();
}

void WidgetHost::setFreeHeight(std::optional<CGFloat> height) {
    _settings.freeHeight = height;
    updateMaxima(UITraitCollection::system().get().preferredContentSizeCategory);
    updateContentSize();
}

void WidgetHost::setTraits(const UITraitCollection& traits) {
    const auto previous = UITraitCollection::system().get();
    if (traits == previous)
        return;
    {
        const Hold hold(*this);
        const auto rows = rowsWithin(*_context);
        updateMaxima(traits.preferredContentSizeCategory);
        // A widget that hears of another row height and of another number of rows at once takes the
        // second to be all that matters. So it hears of one after the other.
        const auto compact =
            _context->widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode::Compact);
        const auto expanded =
            _context->widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode::Expanded);
        const bool isOtherCount = rowsWithin(*_context) != rows;
        if (isOtherCount)
            _context->setMaxima(compact, {expanded.width, rows * compact.height});
        UITraitCollection::setSystem(traits);
        if (isOtherCount) {
            _context->setMaxima(compact, expanded);
            NSNotificationCenter::defaultCenter()->postNotificationName_object(
                UIContentSizeCategoryDidChangeNotification, nullptr);
        }
        _widget->traitsDidChange(previous);
    }
    updateContentSize();
}

void WidgetHost::machineDidWake() {
    _schedule->somethingChanged();
}

void WidgetHost::networkDidChange() {
    _schedule->somethingChanged();
}

// NOLINTNEXTLINE(readability-make-member-function-const): what it holds changes
void WidgetHost::didReceiveMemoryWarning() {
    controller()->didReceiveMemoryWarning();
}

void WidgetHost::startWidgetAnew() {
    {
        const Hold hold(*this);
        const bool wasLoaded = _widget->isLoaded();
        const auto size = _contentSize;
        _widget->end();
        _schedule->setVisible(false);
        _visible = false;
        makeWidget();
        if (wasLoaded)
            loadView();
        _contentSize = size; // another one is a change that the presenter must hear of
    }
    if (const auto presenter = _presenter.lock())
        presenter->widgetHostDidChangeView(*this);
    updateContentSize();
    updateVisibility();
}

} // namespace orvo
