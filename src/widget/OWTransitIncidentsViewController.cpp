#include "widget/OWTransitIncidentsViewController.h"

#include "fetching/OWTransitIncidentFetcher.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/NSNotificationCenter.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/RunLoop.h"
#include "platform/foundation/Signpost.h"
#include "platform/uikit/UIContentSizeCategory.h"
#include "platform/uikit/UIViewControllerTransitionCoordinator.h"
#include "platform/uikit/UIVisualEffectView.h"
#include "shared/NSUserDefaults_OrvoGroup.h"
#include "shared/WidgetLog.h"
#include "viewmodel/ArtworkDataSourceCacheTransitWidget.h"

#include <cmath>
#include <limits>
#include <utility>

namespace orvo {

namespace {

constexpr const char* SavedStateKey = "Orvo.TransitWidget.savedUIData";
constexpr const char* SizeCategorySelector = "_contentSizeCategoryDidChange";
constexpr const char* SuggestionsSubsystem = "com.zentu.Orvo.suggestions";
constexpr NSTimeInterval RefreshInterval = 1800;
constexpr std::uint64_t NoLimit = std::numeric_limits<std::uint64_t>::max();

std::shared_ptr<NSString> savedStateKey() {
    return NSString::string(SavedStateKey);
}

NCUpdateResult updateResultOf(const Result& result) {
    return result.isSuccess() ? NCUpdateResult::NewData : NCUpdateResult::Failed;
}

/// Calls it on the main thread, in a later turn where it is called on another one: whoever looks
/// the lines up answers where it likes.
OWTransitIncidentFetcherRequest::CompletionHandler
onMainThread(OWTransitIncidentFetcherRequest::CompletionHandler handler) {
    return [handler = std::move(handler)](const std::shared_ptr<Result>& result) {
        if (RunLoop::isMainThread())
            handler(result);
        else
            DispatchQueue::mainQueue()->async([handler, result] { handler(result); });
    };
}

/// A source that leaves a mark for tracing tools, and does nothing else.
std::shared_ptr<DispatchSource> markingSource(MemoryPressure degree,
                                              const char* event,
                                              const std::shared_ptr<DispatchQueue>& queue) {
    auto source = DispatchSource::memoryPressureSource(degree, queue);
    source->setEventHandler([event] {
        const auto log = Log::findOrCreate("TransitWidget", SuggestionsSubsystem);
        if (Signpost::isEnabled(*log))
            Signpost::emitEvent(*log, event, " enableTelemetry=YES ");
    });
    return source;
}

} // namespace

std::shared_ptr<OWTransitIncidentsViewController>
OWTransitIncidentsViewController::initWithNibName_bundle(const std::optional<std::string>& nibName,
                                                         const std::shared_ptr<NSObject>& bundle) {
    auto controller = std::make_shared<OWTransitIncidentsViewController>();
    return controller->_initWithNibName_bundle(nibName, bundle) ? controller : nullptr;
}

bool OWTransitIncidentsViewController::_initWithNibName_bundle(
    const std::optional<std::string>& nibName, const std::shared_ptr<NSObject>& bundle) {
    if (!UIViewController::_initWithNibName_bundle(nibName, bundle))
        return false;
    _analyticsDelegate =
        OWTransitIncidentsAnalyticsDelegate::initWithTransitIncidentsViewController(strong(this));
    return true;
}

OWTransitIncidentsViewController::~OWTransitIncidentsViewController() {
    for (const auto& source : {_systemMemoryPressureWarningSource,
                               _systemMemoryPressureCriticalSource,
                               _processMemoryPressureWarningSource,
                               _processMemoryPressureCriticalSource})
        if (source)
            source->cancel();
}

// The view's life

void OWTransitIncidentsViewController::viewDidLoad() {
    UIViewController::viewDidLoad();
    _startListeningToMemoryPressureEvents();
    _createSubviews();
}

void OWTransitIncidentsViewController::_createSubviews() {
    setTableView(UITableView::initWithFrame_style(view()->layoutMarginsGuide()->layoutFrame(),
                                                  UITableViewStyle::Plain));
    _tableView->setRowHeight(UITableViewAutomaticDimension);
    _tableView->setSeparatorEffect(UIVibrancyEffect::widgetTertiaryVibrancyEffect());
    const auto saved = _loadSavedUIData();
    setDataSource(
        OWTransitIncidentDataSource::
            initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
                saved ? saved->lineItemsResult() : nullptr,
                saved && saved->expanded(),
                artworkCache(),
                _maxNumberOfRowsFromAvailableWidgetSize(),
                _availablWidth()));
    _dataSource->configureTableView(_tableView);
    _dataSource->setDelegate(strong(this));
    view()->addSubview(_tableView);
}

void OWTransitIncidentsViewController::viewWillLayoutSubviews() {
    UIViewController::viewWillLayoutSubviews();
    if (_tableView)
        _tableView->setFrame(view()->layoutMarginsGuide()->layoutFrame());
}

void OWTransitIncidentsViewController::viewWillAppear(bool animated) {
    UIViewController::viewWillAppear(animated);
    _visible = true;
    _createUpdaterForTransitLineItemsIfVisible();
    _contentSizeCategoryDidChange();
    NSNotificationCenter::defaultCenter()->addObserver_selector_name_object(
        strong(this),
        Selector(SizeCategorySelector),
        UIContentSizeCategoryDidChangeNotification,
        nullptr);
    if (const auto& context = extensionContext())
        context->setWidgetLargestAvailableDisplayMode(
            OWTransitListItemNCWidget::widgetLargestAvailableDisplayMode(*_dataSource->listItem()));
    _fetchUpdatesWithCompletitionHandler({});
}

void OWTransitIncidentsViewController::viewDidAppear(bool animated) {
    UIViewController::viewDidAppear(animated);
    _analyticsDelegate->startSessionIfNeeded();
}

void OWTransitIncidentsViewController::viewWillDisappear(bool animated) {
    _saveUIData();
    NSNotificationCenter::defaultCenter()->removeObserver(*this);
    setUpdater(nullptr);
    _visible = false;
    UIViewController::viewWillDisappear(animated);
}

void OWTransitIncidentsViewController::viewDidDisappear(bool animated) {
    _analyticsDelegate->recordCloseSessionSwiping();
    UIViewController::viewDidDisappear(animated);
}

void OWTransitIncidentsViewController::viewWillTransitionToSize_withTransitionCoordinator(
    CGSize size, const std::shared_ptr<UIViewControllerTransitionCoordinator>& coordinator) {
    // Without the base class's share. Kept so.
    if (_dataSource)
        _dataSource->setAvailableWidth(size.width);
    const std::weak_ptr<OWTransitIncidentsViewController> weak = strong(this);
    coordinator->animateAlongsideTransition_completion(
        [weak] {
            const auto self = weak.lock();
            if (!self || !self->_tableViewNeedsReload)
                return;
            self->_tableViewNeedsReload = false;
            self->_reloadRows();
        },
        {});
}

void OWTransitIncidentsViewController::didReceiveMemoryWarning() {
    UIViewController::didReceiveMemoryWarning();
    artworkCache()->purge();
}

void OWTransitIncidentsViewController::_reloadRows() {
    _tableView->reloadSections_withRowAnimation({0}, UITableViewRowAnimation::Automatic);
}

// The host's calls

void OWTransitIncidentsViewController::widgetPerformUpdateWithCompletionHandler(
    UpdateHandler completionHandler) {
    _fetchUpdatesWithCompletitionHandler(std::move(completionHandler));
}

void OWTransitIncidentsViewController::widgetActiveDisplayModeDidChange_withMaximumSize(
    NCWidgetDisplayMode mode, CGSize /*maximumSize*/) {
    _analyticsDelegate->recordWidgetChangeDisplayMode(mode);
    const auto& context = extensionContext();
    if (_dataSource) // a host may say so before it has loaded the view
        _dataSource->setExpanded(context && context->widgetActiveDisplayMode() ==
                                                NCWidgetDisplayMode::Expanded);
}

// Fetching

void OWTransitIncidentsViewController::_fetchUpdatesWithCompletitionHandler(UpdateHandler handler) {
    if (!RunLoop::isMainThread())
        throw NSInvalidArgumentException("updates are fetched on the main thread");
    const std::weak_ptr<OWTransitIncidentsViewController> weak = strong(this);
    if (_request) {
        if (handler)
            _request->addHandler(
                onMainThread([weak, handler = std::move(handler)](const auto& result) {
                    const auto answer = [handler, result] {
                        handler(updateResultOf(*result));
                    };
                    const auto self = weak.lock();
                    // On another thread it has ended, and who began it is still to hear: first.
                    if (self && self->_transitLineItemResult != result)
                        DispatchQueue::mainQueue()->async(answer);
                    else
                        answer();
                }));
        return;
    }
    _request =
        OWTransitIncidentFetcher::init()->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
            onMainThread(
                [weak, handler = std::move(handler)](const std::shared_ptr<Result>& result) {
                    const auto self = weak.lock();
                    if (self)
                        self->setTransitLineItemResult(result);
                    if (handler)
                        handler(updateResultOf(*result));
                    if (self)
                        self->_request = nullptr;
                }));
}

void OWTransitIncidentsViewController::setTransitLineItemResult(
    const std::shared_ptr<Result>& result) {
    _transitLineItemResult = result;
    _createUpdaterForTransitLineItemsIfVisible();
    if (_dataSource)
        _dataSource->updateTransitLineItemResult_captureAnalytics(_transitLineItemResult,
                                                                  _analyticsDelegate);
}

void OWTransitIncidentsViewController::setUpdater(
    const std::shared_ptr<OWTransitIncidentUpdater>& updater) {
    if (updater == _updater) // the same object
        return;
    if (_updater)
        _updater->invalidate();
    _updater = updater;
}

void OWTransitIncidentsViewController::_createUpdaterForTransitLineItemsIfVisible() {
    if (!_visible) {
        setUpdater(nullptr);
        return;
    }
    if (!_transitLineItemResult)
        return;
    _transitLineItemResult->withValue_orError(
        [this](const auto& lineItems) {
            setUpdater(OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(
                std::dynamic_pointer_cast<NSArray>(lineItems), RefreshInterval));
            _updater->setObserver(strong(this));
        },
        [this](const auto&) { setUpdater(nullptr); });
}

void OWTransitIncidentsViewController::transitIncidentUpdater_dateExpired(
    const std::shared_ptr<OWTransitIncidentUpdater>&, const std::shared_ptr<NSDate>&) {
    if (_visible)
        _dataSource->recalculateDataSourceItemsWithAnalytics(_analyticsDelegate);
}

void OWTransitIncidentsViewController::transitIncidentUpdaterNeedsRefresh(
    const std::shared_ptr<OWTransitIncidentUpdater>&) {
    if (_visible)
        _fetchUpdatesWithCompletitionHandler({});
}

// Rows

void OWTransitIncidentsViewController::dataSource_didSelectOpenableItem_atIndexPath(
    const std::shared_ptr<OWTransitIncidentDataSource>&,
    const std::shared_ptr<OWOpenable>& item,
    const std::shared_ptr<NSIndexPath>& indexPath) {
    item->openInContext_completionHandler(
        strong(this),
        [analytics = _analyticsDelegate, indexPath](bool success, const std::shared_ptr<NSError>&) {
            if (success)
                analytics->recordOpenItemAtIndexPath(indexPath);
        });
}

void OWTransitIncidentsViewController::dataSourceDidUpdateContent(
    const std::shared_ptr<OWTransitIncidentDataSource>& dataSource) {
    const auto& context = extensionContext();
    CGSize maximum;
    if (context) {
        context->setWidgetLargestAvailableDisplayMode(
            OWTransitListItemNCWidget::widgetLargestAvailableDisplayMode(*dataSource->listItem()));
        maximum = context->widgetMaximumSizeForDisplayMode(context->widgetActiveDisplayMode());
    }
    const auto size =
        _dataSource->preferredContentSizeForExpanded_maxSize(_dataSource->isExpanded(), maximum);
    _reloadRows();
    setPreferredContentSize(size);
}

const std::shared_ptr<ArtworkDataSourceCache>& OWTransitIncidentsViewController::artworkCache() {
    if (!_artworkCache)
        _artworkCache = ArtworkDataSourceCacheTransitWidget::memoryConstrainedImageViewCache();
    return _artworkCache;
}

// Sizes

std::uint64_t OWTransitIncidentsViewController::_maxNumberOfRowsFromAvailableWidgetSize() const {
    const auto& context = extensionContext();
    if (!context)
        return NoLimit;
    const double compact =
        context->widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode::Compact).height;
    const double expanded =
        context->widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode::Expanded).height;
    if (!(compact > 0))
        return NoLimit;
    const double rows = std::floor(expanded / compact);
    // What is no number of rows, or more than there are numbers, is no limit either.
    if (!(rows >= 1) || rows >= static_cast<double>(NoLimit))
        return NoLimit;
    return static_cast<std::uint64_t>(rows);
}

double OWTransitIncidentsViewController::_availablWidth() {
    const auto& context = extensionContext();
    return context ? context->widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode::Compact).width
                   : view()->bounds().size.width;
}

void OWTransitIncidentsViewController::_contentSizeCategoryDidChange() {
    const auto& context = extensionContext();
    const CGSize maximum =
        context ? context->widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode::Compact) : CGSize{};
    _dataSource->setRowHeight_maxNumberOfRows(maximum.height,
                                              _maxNumberOfRowsFromAvailableWidgetSize());
}

// Saved state

void OWTransitIncidentsViewController::_saveUIData() {
    const auto state = OWTransitIncidentViewControllerState::initWithLineItemsResult_expanded(
        _dataSource->transitLineItemResult(), _dataSource->isExpanded());
    const auto data =
        NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(state, true);
    if (!data) {
        widgetLog()->debug("Unable to cache view model to disk because it couldnt be converted to "
                           "NSData: %{private}@",
                           state);
        return;
    }
    widgetLog()->debug("Saving view model to NSUserDefault (key: %{private}@) : %{private}@",
                       savedStateKey(),
                       state);
    OrvoGroup::__orvo_groupUserDefaults()->setObject_forKey(data, SavedStateKey);
}

std::shared_ptr<OWTransitIncidentViewControllerState>
// NOLINTNEXTLINE(readability-convert-member-functions-to-static): the name is one of an instance
OWTransitIncidentsViewController::_loadSavedUIData() {
    const auto defaults = OrvoGroup::__orvo_groupUserDefaults();
    const auto stored = defaults->objectForKey(SavedStateKey);
    if (!stored) {
        widgetLog()->debug("No view model found in NSUserDefaults (key: %{private}@)",
                           savedStateKey());
        return nullptr;
    }
    std::shared_ptr<NSError> error;
    auto state = OWTransitIncidentViewControllerState::unarchiveFromData_error(
        std::dynamic_pointer_cast<NSData>(stored), &error);
    if (error) {
        widgetLog()->debug("Error parsing ViewModel data loaded from NSUserDefaults, removing it "
                           "(key: %{private}@): %{private}@ - error: %{private}@",
                           savedStateKey(),
                           state,
                           error);
        defaults->removeObjectForKey(SavedStateKey);
        return nullptr;
    }
    widgetLog()->debug("View model loaded from NSUserDefaults (key: %{private}@): %{private}@",
                       savedStateKey(),
                       state);
    return state;
}

// Memory

void OWTransitIncidentsViewController::_startListeningToMemoryPressureEvents() {
    const auto queue = DispatchQueue::serialQueue("com.zentu.Orvo.TransitWidget.memoryPresure");
    _systemMemoryPressureWarningSource =
        markingSource(MemoryPressure::Warning, "SystemMemoryPressureWarning", queue);
    _systemMemoryPressureCriticalSource =
        markingSource(MemoryPressure::Critical, "SystemMemoryPressureCritical", queue);
    _processMemoryPressureWarningSource =
        markingSource(MemoryPressure::ProcessLimitWarning, "ProcessMemoryPressureWarning", queue);
    _processMemoryPressureCriticalSource =
        markingSource(MemoryPressure::ProcessLimitCritical, "ProcessMemoryPressureCritical", queue);
    _systemMemoryPressureWarningSource->activate();
    _systemMemoryPressureCriticalSource->activate();
    _processMemoryPressureWarningSource->activate();
    _processMemoryPressureCriticalSource->activate();
}

NSObject::Method OWTransitIncidentsViewController::methodForSelector(const Selector& selector) {
    if (selector == Selector(SizeCategorySelector))
        return [this](const std::shared_ptr<NSObject>&) {
            _contentSizeCategoryDidChange();
            return nullptr;
        };
    return UIViewController::methodForSelector(selector);
}

} // namespace orvo
