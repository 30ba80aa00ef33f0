#pragma once

#include "analytics/OWTransitIncidentsAnalyticsDelegate.h"
#include "fetching/OWTransitIncidentFetcherRequest.h"
#include "fetching/OWTransitIncidentUpdater.h"
#include "platform/extension/NCWidgetProviding.h"
#include "platform/foundation/DispatchSource.h"
#include "platform/mapuikit/ArtworkDataSourceCache.h"
#include "platform/uikit/UIViewController.h"
#include "platform/uikit/table/UITableView.h"
#include "presentation/OWTransitIncidentDataSource.h"
#include "widget/OWTransitIncidentViewControllerState.h"
#include "widget/result/Result.h"

#include <cstdint>
#include <memory>

namespace orvo {

/// The widget: shows what it saved, fetches, shows what came, tells its host its size and modes,
/// and hands over to the map application at a tap. Main thread.
class OWTransitIncidentsViewController : public UIViewController,
                                         public NCWidgetProviding,
                                         public OWTransitIncidentUpdaterObserver,
                                         public OWTransitIncidentDataSourceDelegate {
public:
    [[nodiscard]] static std::shared_ptr<OWTransitIncidentsViewController>
    initWithNibName_bundle(const std::optional<std::string>& nibName,
                           const std::shared_ptr<NSObject>& bundle);
    ~OWTransitIncidentsViewController() override;

    // The view's life
    void viewDidLoad() override;
    void viewWillLayoutSubviews() override;
    void viewWillAppear(bool animated) override;
    void viewDidAppear(bool animated) override;
    void viewWillDisappear(bool animated) override;
    void viewDidDisappear(bool animated) override;
    void viewWillTransitionToSize_withTransitionCoordinator(
        CGSize size,
        const std::shared_ptr<UIViewControllerTransitionCoordinator>& coordinator) override;
    void didReceiveMemoryWarning() override;

    // The host's calls
    void widgetPerformUpdateWithCompletionHandler(UpdateHandler completionHandler) override;
    /// Records the mode given, but shows the one that the context has now; the size is not used.
    void widgetActiveDisplayModeDidChange_withMaximumSize(NCWidgetDisplayMode mode,
                                                          CGSize maximumSize) override;

    // The updater's and the data source's
    void
    transitIncidentUpdater_dateExpired(const std::shared_ptr<OWTransitIncidentUpdater>& updater,
                                       const std::shared_ptr<NSDate>& date) override;
    void transitIncidentUpdaterNeedsRefresh(
        const std::shared_ptr<OWTransitIncidentUpdater>& updater) override;
    void dataSource_didSelectOpenableItem_atIndexPath(
        const std::shared_ptr<OWTransitIncidentDataSource>& dataSource,
        const std::shared_ptr<OWOpenable>& item,
        const std::shared_ptr<NSIndexPath>& indexPath) override;
    void dataSourceDidUpdateContent(
        const std::shared_ptr<OWTransitIncidentDataSource>& dataSource) override;

    /// Nil until the view is loaded.
    [[nodiscard]] const std::shared_ptr<UITableView>& tableView() const noexcept {
        return _tableView;
    }
    virtual void setTableView(std::shared_ptr<UITableView> tableView) {
        _tableView = std::move(tableView);
    }
    /// Nil until the view is loaded.
    [[nodiscard]] const std::shared_ptr<OWTransitIncidentDataSource>& dataSource() const noexcept {
        return _dataSource;
    }
    void setDataSource(std::shared_ptr<OWTransitIncidentDataSource> dataSource) {
        _dataSource = std::move(dataSource);
    }
    /// Nil unless the widget is visible and holds line items.
    [[nodiscard]] const std::shared_ptr<OWTransitIncidentUpdater>& updater() const noexcept {
        return _updater;
    }
    /// Invalidates the former one. The same object again does nothing.
    void setUpdater(const std::shared_ptr<OWTransitIncidentUpdater>& updater);
    /// Made when first read.
    [[nodiscard]] const std::shared_ptr<ArtworkDataSourceCache>& artworkCache();
    /// Nil while nothing is fetched.
    [[nodiscard]] const std::shared_ptr<OWTransitIncidentFetcherRequest>& request() const noexcept {
        return _request;
    }
    /// That of the last fetch of this life; nil before, whatever was saved.
    [[nodiscard]] const std::shared_ptr<Result>& transitLineItemResult() const noexcept {
        return _transitLineItemResult;
    }
    /// Keeps the very object.
    void setTransitLineItemResult(const std::shared_ptr<Result>& result);
    [[nodiscard]] const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>&
    analyticsDelegate() const noexcept {
        return _analyticsDelegate;
    }
    void setAnalyticsDelegate(std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> delegate) {
        _analyticsDelegate = std::move(delegate);
    }

    void _createSubviews();
    void _startListeningToMemoryPressureEvents();
    /// While a fetch runs, only joins it, and only with a handler. The first handler hears when the
    /// rows are there, the others after it.
    void _fetchUpdatesWithCompletitionHandler(UpdateHandler handler);
    void _createUpdaterForTransitLineItemsIfVisible();
    /// How many compact rows the expanded widget has room for; the largest number is no limit.
    [[nodiscard]] std::uint64_t _maxNumberOfRowsFromAvailableWidgetSize() const;
    /// In points. Spelt so.
    [[nodiscard]] double _availablWidth();
    void _contentSizeCategoryDidChange();
    /// Keeps what is shown for the next life; what was kept before stays where it cannot be
    /// archived.
    void _saveUIData();
    /// Nil where nothing was saved, or it does not decode.
    [[nodiscard]] std::shared_ptr<OWTransitIncidentViewControllerState> _loadSavedUIData();

    [[nodiscard]] Method methodForSelector(const Selector& selector) override;
    [[nodiscard]] std::string className() const override {
        return "OWTransitIncidentsViewController";
    }

protected:
    bool _initWithNibName_bundle(const std::optional<std::string>& nibName,
                                 const std::shared_ptr<NSObject>& bundle);

private:
    void _reloadRows();

    bool _visible = false;
    bool _tableViewNeedsReload = false; // nothing sets it; the way that it opens stays closed
    std::shared_ptr<DispatchSource> _systemMemoryPressureWarningSource;
    std::shared_ptr<DispatchSource> _systemMemoryPressureCriticalSource;
    std::shared_ptr<DispatchSource> _processMemoryPressureWarningSource;
    std::shared_ptr<DispatchSource> _processMemoryPressureCriticalSource;
    std::shared_ptr<UITableView> _tableView;
    std::shared_ptr<OWTransitIncidentDataSource> _dataSource;
    std::shared_ptr<OWTransitIncidentUpdater> _updater;
    std::shared_ptr<ArtworkDataSourceCache> _artworkCache;
    std::shared_ptr<OWTransitIncidentFetcherRequest> _request;
    std::shared_ptr<Result> _transitLineItemResult;
    std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> _analyticsDelegate;
};

} // namespace orvo
