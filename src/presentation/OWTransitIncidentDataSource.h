#pragma once

#include "analytics/OWTransitIncidentsAnalyticsDelegate.h"
#include "handoff/OWOpenable.h"
#include "platform/foundation/CGGeometry.h"
#include "platform/mapuikit/ArtworkDataSourceCache.h"
#include "platform/uikit/NSIndexPath.h"
#include "platform/uikit/table/UITableView.h"
#include "presentation/OWTransitItemArtworkColumnCalculator.h"
#include "viewmodel/OWTransitListItem.h"
#include "widget/result/Result.h"

#include <cstdint>
#include <memory>
#include <optional>

namespace orvo {

class OWTransitIncidentDataSource;

/// Hears of taps and of changes. Main thread.
class OWTransitIncidentDataSourceDelegate : public virtual NSObject {
public:
    /// A row that opens something was tapped.
    virtual void dataSource_didSelectOpenableItem_atIndexPath(
        const std::shared_ptr<OWTransitIncidentDataSource>& dataSource,
        const std::shared_ptr<OWOpenable>& item,
        const std::shared_ptr<NSIndexPath>& indexPath) = 0;
    /// Rows, or their size, are others now.
    virtual void
    dataSourceDidUpdateContent(const std::shared_ptr<OWTransitIncidentDataSource>& dataSource) = 0;
};

/// Turns the result of a fetch into the rows of the widget's table: one in the compact mode, all of
/// the list in the expanded mode. Main thread.
class OWTransitIncidentDataSource : public UITableViewDataSource, public UITableViewDelegate {
public:
    /// Nil for `result` counts as no favourite lines. `maxNumberOfRows`: the largest number is no
    /// limit. `availableWidth` in points. `artworkCache` may be nil. Tells no delegate.
    [[nodiscard]] static std::shared_ptr<OWTransitIncidentDataSource>
    initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
        std::shared_ptr<Result> result,
        bool expanded,
        std::shared_ptr<ArtworkDataSourceCache> artworkCache,
        std::uint64_t maxNumberOfRows,
        double availableWidth);

    /// Registers the cells, takes away the separators of empty rows, and serves the table.
    virtual void configureTableView(const std::shared_ptr<UITableView>& tableView);

    /// The very same result again does nothing; an equal one builds the rows anew.
    virtual void updateTransitLineItemResult_captureAnalytics(
        const std::shared_ptr<Result>& result,
        const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics);
    /// Builds the rows for the present moment. What is displayed is recorded where `analytics` is
    /// not nil.
    virtual void recalculateDataSourceItemsWithAnalytics(
        const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics);
    /// A changed count builds the rows anew, and the delegate hears of it only where they come out
    /// as others, whatever the height. A changed height alone is told.
    virtual void setRowHeight_maxNumberOfRows(double rowHeight, std::uint64_t maxNumberOfRows);
    /// As wide as `maxSize`, and as high as the rows of the present mode: neither the mode given
    /// nor the height of `maxSize` counts.
    [[nodiscard]] virtual CGSize preferredContentSizeForExpanded_maxSize(bool expanded,
                                                                         CGSize maxSize) const;

    [[nodiscard]] bool isExpanded() const noexcept { return _expanded; }
    /// Tells the delegate also where there is nothing to expand, and the mode stays compact.
    virtual void setExpanded(bool expanded);
    [[nodiscard]] double availableWidth() const noexcept { return _availableWidth; }
    /// Tells the delegate where what is shown in the present mode changes.
    virtual void setAvailableWidth(double width);
    [[nodiscard]] const std::shared_ptr<NSArray>& shieldAdjustedExpandedItems() const noexcept {
        return _shieldAdjustedExpandedItems;
    }
    /// Spelt so, unlike the other.
    [[nodiscard]] const std::shared_ptr<NSObject>& shieldAjustedSummaryItem() const noexcept {
        return _shieldAjustedSummaryItem;
    }
    [[nodiscard]] const std::shared_ptr<Result>& transitLineItemResult() const noexcept {
        return _transitLineItemResult;
    }
    [[nodiscard]] const std::shared_ptr<OWTransitListItem>& listItem() const noexcept {
        return _listItem;
    }
    /// An equal one does nothing. The mode stays as it is, also where the new list has nothing to
    /// expand: then there are no rows until the mode changes. Kept so.
    virtual void setListItem(const std::shared_ptr<OWTransitListItem>& listItem);
    [[nodiscard]] const std::shared_ptr<ArtworkDataSourceCache>& artworkCache() const noexcept {
        return _artworkCache;
    }
    /// Held weakly.
    [[nodiscard]] std::shared_ptr<OWTransitIncidentDataSourceDelegate> delegate() const {
        return _delegate.lock();
    }
    void setDelegate(const std::shared_ptr<OWTransitIncidentDataSourceDelegate>& delegate) {
        _delegate = delegate;
    }
    /// In points. After a fit of both modes it is that of the compact row, where this has a shield
    /// column.
    [[nodiscard]] double artworkColumnWidth() const noexcept { return _artworkColumnWidth; }
    /// Made when first read.
    [[nodiscard]] const std::shared_ptr<OWTransitItemArtworkColumnCalculator>&
    artworkColumnCalculator();
    void
    setArtworkColumnCalculator(std::shared_ptr<OWTransitItemArtworkColumnCalculator> calculator) {
        _artworkColumnCalculator = std::move(calculator);
    }

    // The table's questions
    [[nodiscard]] std::optional<std::int64_t>
    numberOfSectionsInTableView(const std::shared_ptr<UITableView>& tableView) override;
    [[nodiscard]] std::int64_t
    tableView_numberOfRowsInSection(const std::shared_ptr<UITableView>& tableView,
                                    std::int64_t section) override;
    [[nodiscard]] std::shared_ptr<UITableViewCell>
    tableView_cellForRowAtIndexPath(const std::shared_ptr<UITableView>& tableView,
                                    const std::shared_ptr<NSIndexPath>& indexPath) override;
    [[nodiscard]] std::optional<CGFloat> tableView_estimatedHeightForRowAtIndexPath(
        const std::shared_ptr<UITableView>& tableView,
        const std::shared_ptr<NSIndexPath>& indexPath) override;
    void tableView_didSelectRowAtIndexPath(const std::shared_ptr<UITableView>& tableView,
                                           const std::shared_ptr<NSIndexPath>& indexPath) override;
    [[nodiscard]] std::optional<bool>
    tableView_shouldHighlightRowAtIndexPath(const std::shared_ptr<UITableView>& tableView,
                                            const std::shared_ptr<NSIndexPath>& indexPath) override;

    /// What is wanted, but not an expanded mode without rows.
    [[nodiscard]] static bool
    _sanatizedExpandedValue_forListItem(bool expanded,
                                        const std::shared_ptr<OWTransitListItem>& listItem);
    [[nodiscard]] std::int64_t _numberOfRowInFirstSectionForExpandedState(bool expanded) const;
    [[nodiscard]] ArtworkWidthCalculatorSizeParameter _sizeParameters() const;
    /// Fits the artwork of what has none fitted.
    void _updateAdjustedShieldItemsAndColumnWidth();
    /// An `OWTransitItem` or an `OWTransitSummaryItem`; nil where there is no such row.
    [[nodiscard]] std::shared_ptr<NSObject>
    _itemAtIndexPath(const std::shared_ptr<NSIndexPath>& indexPath) const;
    /// Nil for a row that opens nothing.
    [[nodiscard]] std::shared_ptr<OWOpenable>
    _openableItemAtIndexPath(const std::shared_ptr<NSIndexPath>& indexPath) const;

protected:
    void _initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
        std::shared_ptr<Result> result,
        bool expanded,
        std::shared_ptr<ArtworkDataSourceCache> artworkCache,
        std::uint64_t maxNumberOfRows,
        double availableWidth);

private:
    [[nodiscard]] std::shared_ptr<OWTransitListItem>
    _builtListItem(const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics) const;
    [[nodiscard]] std::shared_ptr<NSArray> _fitted(const std::shared_ptr<NSArray>& items);
    void _clearAdjustedItems();
    void _tellDelegate();

    double _rowHeight = 110;
    std::uint64_t _maxNumberOfRows = 0;
    bool _expanded = false;
    std::shared_ptr<NSArray> _shieldAdjustedExpandedItems;
    std::shared_ptr<NSObject> _shieldAjustedSummaryItem;
    std::shared_ptr<Result> _transitLineItemResult;
    double _availableWidth = 0;
    std::shared_ptr<OWTransitListItem> _listItem;
    std::shared_ptr<ArtworkDataSourceCache> _artworkCache;
    std::weak_ptr<OWTransitIncidentDataSourceDelegate> _delegate;
    /// Nobody reads or writes it.
    [[maybe_unused]] std::shared_ptr<NSArray> _analyticsTransitIncidentItems;
    double _artworkColumnWidth = 0;
    std::shared_ptr<OWTransitItemArtworkColumnCalculator> _artworkColumnCalculator;
};

} // namespace orvo
