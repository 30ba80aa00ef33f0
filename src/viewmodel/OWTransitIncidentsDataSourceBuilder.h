#pragma once

#include "handoff/OWUserActivityData.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSURL.h"
#include "platform/geoservices/TransitIncident.h"
#include "platform/geoservices/TransitLineItem.h"
#include "viewmodel/OWTransitIncidentFilter.h"
#include "viewmodel/OWTransitItem.h"
#include "viewmodel/OWTransitItemDataSourceBuilder.h"
#include "viewmodel/OWTransitSummaryItem.h"
#include "viewmodel/_OWDisplayedIncidents.h"

#include <cstdint>
#include <vector>

namespace orvo {

/// Turns the favourite lines into rows: one for each distinct incident of now, one for the lines
/// without any, and one for what is too many. It reports what it displays to analytics. Builds at
/// most once.
///
/// A line whose only incident is shared with an earlier favourite counts among the lines with good
/// service too. Kept so.
class OWTransitIncidentsDataSourceBuilder final : public OWTransitItemDataSourceBuilder {
public:
    /// `lineItems`: `TransitLineItem`s in the favourites' order. `maxNumberOfItems` 0 is no limit.
    /// `artworkCache` and `analytics` may be nil.
    [[nodiscard]] static std::shared_ptr<OWTransitIncidentsDataSourceBuilder>
    initWithLineItems_maxNumberOfItems_artworkCache_analytics(
        std::shared_ptr<NSArray> lineItems,
        std::uint64_t maxNumberOfItems,
        std::shared_ptr<ArtworkDataSourceCache> artworkCache,
        std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> analytics);

    [[nodiscard]] const std::shared_ptr<NSArray>& lineItems() const noexcept { return _lineItems; }
    [[nodiscard]] std::uint64_t maxNumberOfItems() const noexcept { return _maxNumberOfItems; }
    [[nodiscard]] const std::shared_ptr<ArtworkDataSourceCache>& artworkCache() const noexcept {
        return _artworkCache;
    }
    [[nodiscard]] const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>&
    analytics() const noexcept {
        return _analytics;
    }
    void setAnalytics(std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> analytics) {
        _analytics = std::move(analytics);
    }
    /// Made when first read.
    [[nodiscard]] const std::shared_ptr<OWTransitIncidentFilter>& incidentFilter();
    void setIncidentFilter(std::shared_ptr<OWTransitIncidentFilter> filter) {
        _incidentFilter = std::move(filter);
    }

    [[nodiscard]] std::shared_ptr<OWTransitListItem> listItem() override;

    [[nodiscard]] std::shared_ptr<OWTransitListItem> _buildTransitListItem();
    /// Nil where the incident has neither title nor second text.
    [[nodiscard]] std::shared_ptr<OWTransitItem>
    _itemForIncidentAtIndex_inLine(std::size_t index,
                                   const std::shared_ptr<TransitLineItem>& line) const;
    /// Nil when the payload cannot be made.
    [[nodiscard]] static std::shared_ptr<OWUserActivityData>
    _userActivityDataForLineItem(const std::shared_ptr<TransitLineItem>& line);
    [[nodiscard]] static std::shared_ptr<OWUserActivityData>
    _activityDataForIncidents(const std::vector<std::shared_ptr<TransitIncident>>& incidents);
    /// Rewrites the rows that two lines or more show: the systems' artwork, the lines' names before
    /// the text.
    void _updateItemsAffectingSeveralLines_itemToLinesMap(std::vector<_OWDisplayedRow>& rows) const;
    [[nodiscard]] std::shared_ptr<OWTransitSummaryItem>
    _summaryItemForIncidents_items_itemToLinesMap(
        const std::vector<std::shared_ptr<TransitIncident>>& incidents,
        const std::vector<_OWDisplayedRow>& rows) const;
    [[nodiscard]] static std::shared_ptr<NSURL> _urlForFavorites();
    [[nodiscard]] static std::shared_ptr<OWTransitItem>
    _incidentsOverflowItemForIncidents_incidentsToLineMapping(
        const std::vector<std::shared_ptr<TransitIncident>>& incidents,
        const std::shared_ptr<NSMapTable>& mapping);

private:
    using Rows = std::vector<std::shared_ptr<OWTransitItem>>;

    void _recordDisplayed(const std::vector<std::shared_ptr<TransitIncident>>& incidents,
                          const std::shared_ptr<NSMapTable>& mapping) const;
    [[nodiscard]] std::shared_ptr<OWTransitListItem> _noFavoritesListItem() const;
    void _collectLine(const std::shared_ptr<TransitLineItem>& line,
                      _OWDisplayedIncidents& displayed);
    [[nodiscard]] std::shared_ptr<OWTransitListItem>
    _shapedListItem(_OWDisplayedIncidents& displayed) const;
    void _cutOverflow(Rows& rows, const _OWDisplayedIncidents& displayed) const;
    /// As `_userActivityDataForLineItem`. What the rows of a line hand over is packed once for all
    /// of them: it holds every incident of the line, and a feed can have thousands.
    [[nodiscard]] std::shared_ptr<OWUserActivityData>
    _activityOfLine(const std::shared_ptr<TransitLineItem>& line) const;
    [[nodiscard]] std::shared_ptr<OWConfiguredArtwork>
    _sizedArtwork(const std::shared_ptr<TransitArtworkDataSource>& artwork) const;
    [[nodiscard]] std::shared_ptr<OWConfiguredArtwork>
    _sharedArtwork(const std::vector<std::shared_ptr<TransitLineItem>>& lines) const;

    std::shared_ptr<NSArray> _lineItems;
    std::uint64_t _maxNumberOfItems = 0;
    std::shared_ptr<ArtworkDataSourceCache> _artworkCache;
    std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> _analytics;
    std::shared_ptr<OWTransitIncidentFilter> _incidentFilter;
    std::shared_ptr<OWTransitListItem> _listItem;
    mutable std::shared_ptr<TransitLineItem> _packedLine;
    mutable std::shared_ptr<NSData> _payloadOfPackedLine;
};

} // namespace orvo
