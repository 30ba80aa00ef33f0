#include "presentation/OWTransitIncidentDataSource.h"

#include "platform/mapuikit/SizedTransitArtwork.h"
#include "presentation/OWTransitItemFixedHeightCell.h"
#include "presentation/OWTransitSummaryCell.h"
#include "shared/WidgetLog.h"
#include "viewmodel/OWTransitItemDataSourceBuilder.h"
#include "viewmodel/OWTransitSummaryItem.h"

#include <algorithm>
#include <utility>

namespace orvo {

namespace {

constexpr const char* ItemCellName = "OWTransitItemFixedHeightCell";
constexpr const char* SummaryCellName = "OWTransitSummaryCell";
constexpr const char* PlainCellName = "UITableViewCell";

constexpr double EstimatedRowHeight = 5;
constexpr double LeastArtworkWidth = 73;
constexpr double WidthForText = 214; ///< that shields leave

/// The row with a smaller shield.
std::shared_ptr<OWTransitItem>
downSized(const std::shared_ptr<OWTransitItem>& item,
          const std::shared_ptr<SizedTransitArtwork>& smallerArtwork) {
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        item->primaryText(),
        item->secondaryText(),
        OWConfiguredArtwork::initWithArtworkSource_alpha(smallerArtwork, item->artwork()->alpha()),
        item->isArtworkHidden(),
        item->openable());
}

} // namespace

std::shared_ptr<OWTransitIncidentDataSource> OWTransitIncidentDataSource::
    initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
        std::shared_ptr<Result> result,
        bool expanded,
        std::shared_ptr<ArtworkDataSourceCache> artworkCache,
        std::uint64_t maxNumberOfRows,
        double availableWidth) {
    auto dataSource = std::make_shared<OWTransitIncidentDataSource>();
    dataSource
        ->_initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
            std::move(result), expanded, std::move(artworkCache), maxNumberOfRows, availableWidth);
    return dataSource;
}

void OWTransitIncidentDataSource::
    _initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
        std::shared_ptr<Result> result,
        bool expanded,
        std::shared_ptr<ArtworkDataSourceCache> artworkCache,
        std::uint64_t maxNumberOfRows,
        double availableWidth) {
    _artworkCache = std::move(artworkCache);
    _maxNumberOfRows = maxNumberOfRows;
    _availableWidth = availableWidth;
    _transitLineItemResult = result ? std::move(result) : Result::resultWithValue(NSArray::array());
    _listItem = _builtListItem(nullptr);
    _expanded = _sanatizedExpandedValue_forListItem(expanded, _listItem);
    _updateAdjustedShieldItemsAndColumnWidth();
}

void OWTransitIncidentDataSource::configureTableView(
    const std::shared_ptr<UITableView>& tableView) {
    tableView->registerClass_forCellReuseIdentifier(
        OWTransitItemFixedHeightCell::initWithStyle_reuseIdentifier, ItemCellName);
    tableView->registerClass_forCellReuseIdentifier(
        OWTransitSummaryCell::initWithStyle_reuseIdentifier, SummaryCellName);
    tableView->setTableFooterView(UIView::initWithFrame({})); // hides the lines of empty rows
    const auto self = strong(this);
    tableView->setDelegate(self);
    tableView->setDataSource(self);
}

void OWTransitIncidentDataSource::updateTransitLineItemResult_captureAnalytics(
    const std::shared_ptr<Result>& result,
    const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics) {
    if (result == _transitLineItemResult) // the same object, not an equal one
        return;
    _transitLineItemResult = result;
    recalculateDataSourceItemsWithAnalytics(analytics);
}

void OWTransitIncidentDataSource::recalculateDataSourceItemsWithAnalytics(
    const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics) {
    setListItem(_builtListItem(analytics));
}

std::shared_ptr<OWTransitListItem> OWTransitIncidentDataSource::_builtListItem(
    const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics) const {
    return OWTransitDataSourceBuilderForResult(
               _transitLineItemResult, _maxNumberOfRows, _artworkCache, analytics)
        ->listItem();
}

void OWTransitIncidentDataSource::setListItem(const std::shared_ptr<OWTransitListItem>& listItem) {
    if (equal(listItem, _listItem))
        return;
    _listItem = listItem;
    _clearAdjustedItems();
    _updateAdjustedShieldItemsAndColumnWidth();
    _tellDelegate();
}

void OWTransitIncidentDataSource::setRowHeight_maxNumberOfRows(double rowHeight,
                                                               std::uint64_t maxNumberOfRows) {
    const bool isOtherHeight = rowHeight != _rowHeight;
    const bool isOtherCount = maxNumberOfRows != _maxNumberOfRows;
    _rowHeight = rowHeight;
    _maxNumberOfRows = maxNumberOfRows;
    if (isOtherCount)
        recalculateDataSourceItemsWithAnalytics(nullptr);
    else if (isOtherHeight)
        _tellDelegate();
}

void OWTransitIncidentDataSource::setExpanded(bool expanded) {
    if (expanded == _expanded)
        return;
    _expanded = _sanatizedExpandedValue_forListItem(expanded, _listItem);
    _tellDelegate();
}

void OWTransitIncidentDataSource::setAvailableWidth(double width) {
    if (width == _availableWidth)
        return;
    _availableWidth = width;
    const auto expandedItems = _shieldAdjustedExpandedItems;
    const auto summaryItem = _shieldAjustedSummaryItem;
    const double columnWidth = _artworkColumnWidth;
    _clearAdjustedItems();
    _updateAdjustedShieldItemsAndColumnWidth();
    const bool looksTheSame = columnWidth == _artworkColumnWidth &&
                              (!_expanded || equal(expandedItems, _shieldAdjustedExpandedItems)) &&
                              equal(summaryItem, _shieldAjustedSummaryItem);
    if (!looksTheSame)
        _tellDelegate();
}

CGSize OWTransitIncidentDataSource::preferredContentSizeForExpanded_maxSize(bool /*expanded*/,
                                                                            CGSize maxSize) const {
    const auto rows = _numberOfRowInFirstSectionForExpandedState(_expanded);
    return {maxSize.width, _rowHeight * static_cast<double>(rows)};
}

const std::shared_ptr<OWTransitItemArtworkColumnCalculator>&
OWTransitIncidentDataSource::artworkColumnCalculator() {
    if (!_artworkColumnCalculator)
        _artworkColumnCalculator = OWTransitItemArtworkColumnCalculator::init();
    return _artworkColumnCalculator;
}

bool OWTransitIncidentDataSource::_sanatizedExpandedValue_forListItem(
    bool expanded, const std::shared_ptr<OWTransitListItem>& listItem) {
    if (!expanded)
        return false;
    if (listItem && listItem->expandedItems() && listItem->expandedItems()->count() > 0)
        return true;
    widgetLog()->error(
        "Trying to set expanded state on widget datasource without expanded items to show, "
        "ignoring request to expand datasource state.\nListItem: %@",
        listItem);
    return false;
}

std::int64_t
OWTransitIncidentDataSource::_numberOfRowInFirstSectionForExpandedState(bool expanded) const {
    if (!expanded)
        return _shieldAjustedSummaryItem ? 1 : 0;
    return _shieldAdjustedExpandedItems
               ? static_cast<std::int64_t>(_shieldAdjustedExpandedItems->count())
               : 0;
}

ArtworkWidthCalculatorSizeParameter OWTransitIncidentDataSource::_sizeParameters() const {
    return {LeastArtworkWidth, std::max(_availableWidth - WidthForText, LeastArtworkWidth), {}};
}

void OWTransitIncidentDataSource::_updateAdjustedShieldItemsAndColumnWidth() {
    if (!_shieldAdjustedExpandedItems)
        _shieldAdjustedExpandedItems = _fitted(_listItem->expandedItems());
    if (_shieldAjustedSummaryItem)
        return;
    const auto& summaryItem = _listItem->summaryItem();
    _shieldAjustedSummaryItem = std::dynamic_pointer_cast<OWTransitItem>(summaryItem)
                                    ? _fitted(NSArray::arrayOf({summaryItem}))->objectAtIndex(0)
                                    : summaryItem;
}

std::shared_ptr<NSArray>
OWTransitIncidentDataSource::_fitted(const std::shared_ptr<NSArray>& items) {
    return artworkColumnCalculator()
        ->itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
            items, _sizeParameters(), &_artworkColumnWidth, downSized);
}

void OWTransitIncidentDataSource::_clearAdjustedItems() {
    _shieldAdjustedExpandedItems = nullptr;
    _shieldAjustedSummaryItem = nullptr;
}

void OWTransitIncidentDataSource::_tellDelegate() {
    if (const auto target = delegate())
        target->dataSourceDidUpdateContent(strong(this));
}

std::shared_ptr<NSObject>
OWTransitIncidentDataSource::_itemAtIndexPath(const std::shared_ptr<NSIndexPath>& indexPath) const {
    if (indexPath->section() >= 1)
        return nullptr;
    if (!_expanded)
        return _shieldAjustedSummaryItem;
    const auto row = static_cast<std::size_t>(indexPath->row());
    return _shieldAdjustedExpandedItems && row < _shieldAdjustedExpandedItems->count()
               ? _shieldAdjustedExpandedItems->objectAtIndex(row)
               : nullptr;
}

std::shared_ptr<OWOpenable> OWTransitIncidentDataSource::_openableItemAtIndexPath(
    const std::shared_ptr<NSIndexPath>& indexPath) const {
    const auto item = _itemAtIndexPath(indexPath);
    if (const auto transitItem = std::dynamic_pointer_cast<OWTransitItem>(item))
        return transitItem->openable();
    if (const auto summaryItem = std::dynamic_pointer_cast<OWTransitSummaryItem>(item))
        return summaryItem->userActivityData();
    return nullptr;
}

std::optional<std::int64_t>
OWTransitIncidentDataSource::numberOfSectionsInTableView(const std::shared_ptr<UITableView>&) {
    return 1;
}

std::int64_t
OWTransitIncidentDataSource::tableView_numberOfRowsInSection(const std::shared_ptr<UITableView>&,
                                                             std::int64_t /*section*/) {
    return _numberOfRowInFirstSectionForExpandedState(_expanded);
}

std::shared_ptr<UITableViewCell> OWTransitIncidentDataSource::tableView_cellForRowAtIndexPath(
    const std::shared_ptr<UITableView>& tableView, const std::shared_ptr<NSIndexPath>& indexPath) {
    const auto item = _itemAtIndexPath(indexPath);
    std::shared_ptr<UITableViewCell> cell;
    if (const auto transitItem = std::dynamic_pointer_cast<OWTransitItem>(item)) {
        const auto itemCell = std::dynamic_pointer_cast<OWTransitItemFixedHeightCell>(
            tableView->dequeueReusableCellWithIdentifier_forIndexPath(ItemCellName, indexPath));
        itemCell->setTransitItem(transitItem);
        itemCell->setTrailingArtworkColumnWidth(_artworkColumnWidth);
        itemCell->setRowHeight(_rowHeight);
        cell = itemCell;
    } else if (const auto summaryItem = std::dynamic_pointer_cast<OWTransitSummaryItem>(item)) {
        const auto summaryCell = std::dynamic_pointer_cast<OWTransitSummaryCell>(
            tableView->dequeueReusableCellWithIdentifier_forIndexPath(SummaryCellName, indexPath));
        summaryCell->setArtworkCache(_artworkCache);
        summaryCell->setItem(summaryItem);
        summaryCell->setRowHeight(_rowHeight);
        cell = summaryCell;
    } else {
        cell = UITableViewCell::initWithStyle_reuseIdentifier(UITableViewCellStyle::Default,
                                                              PlainCellName);
    }
    const auto rows = tableView_numberOfRowsInSection(tableView, indexPath->section());
    cell->setSeparatorStyleOverride(indexPath->row() == rows - 1
                                        ? UITableViewCellSeparatorStyle::None
                                        : UITableViewCellSeparatorStyle::SingleLine);
    return cell;
}

std::optional<CGFloat> OWTransitIncidentDataSource::tableView_estimatedHeightForRowAtIndexPath(
    const std::shared_ptr<UITableView>&, const std::shared_ptr<NSIndexPath>&) {
    return EstimatedRowHeight;
}

void OWTransitIncidentDataSource::tableView_didSelectRowAtIndexPath(
    const std::shared_ptr<UITableView>& tableView, const std::shared_ptr<NSIndexPath>& indexPath) {
    tableView->deselectRowAtIndexPath_animated(indexPath, true);
    const auto openable = _openableItemAtIndexPath(indexPath);
    const auto target = delegate();
    if (openable && target)
        target->dataSource_didSelectOpenableItem_atIndexPath(strong(this), openable, indexPath);
}

std::optional<bool> OWTransitIncidentDataSource::tableView_shouldHighlightRowAtIndexPath(
    const std::shared_ptr<UITableView>&, const std::shared_ptr<NSIndexPath>& indexPath) {
    return _openableItemAtIndexPath(indexPath) != nullptr;
}

} // namespace orvo
