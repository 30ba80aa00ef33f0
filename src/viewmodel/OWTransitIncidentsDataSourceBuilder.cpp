#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include "handoff/NSDataOrvoExtra.h"
#include "handoff/NSURLOWOpenable.h"
#include "handoff/OrvoActivity.h"
#include "handoff/SharedSession.h"
#include "platform/favorites/TransitStorageIncident.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/geoservices/MapURLBuilder.h"
#include "platform/mapuikit/MapItem.h"
#include "platform/mapuikit/SizedTransitArtwork.h"
#include "platform/mapuikit/TransitIncidentStringProvider.h"
#include "platform/uikit/UIImage.h"
#include "shared/OrvoMap.h"
#include "viewmodel/TransitArtworkEquality.h"
#include "viewmodel/WidgetTexts.h"

#include <algorithm>
#include <limits>

namespace orvo {

namespace {

constexpr std::int64_t RowShieldSize = 7;
constexpr std::int32_t TransitMapType = 3;
constexpr std::int32_t TransitFavoritesType = 2;

constexpr double FullAlpha = 1.0;
constexpr double DimmedAlpha = 0.3;
// Single precision, widened: not the same number as DimmedAlpha, and compared exactly.
constexpr double GenericAlpha = 0.3F;

std::shared_ptr<OWConfiguredArtwork> imageArtwork(const char* name, double alpha) {
    return OWConfiguredArtwork::initWithArtworkSource_alpha(UIImage::imageNamed(name), alpha);
}

/// A line's own shield, else its system's mark. The line's `artwork` is not for rows.
std::shared_ptr<TransitArtworkDataSource> artworkOfLine(const TransitLine& line) {
    if (auto alternate = line.alternateArtwork())
        return alternate;
    const auto system = line.system();
    return system ? system->artwork() : nullptr;
}

std::shared_ptr<TransitArtworkDataSource> artworkOfSystem(const TransitLine& line) {
    const auto system = line.system();
    return system ? system->artwork() : nullptr;
}

/// In braces, so that every compiler looks texts up and shares sessions in this order.
struct FixedRow {
    std::string primaryText;
    std::string secondaryText;
    std::shared_ptr<OWConfiguredArtwork> artwork;
    std::shared_ptr<OWOpenable> openable;
};

std::shared_ptr<OWTransitItem> fixedRow(FixedRow row) {
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        std::move(row.primaryText),
        std::move(row.secondaryText),
        std::move(row.artwork),
        false,
        std::move(row.openable));
}

std::shared_ptr<OWUserActivityData>
activityWithPayload(const char* type, const char* key, const std::shared_ptr<NSData>& payload) {
    if (!payload)
        return nullptr;
    return OWUserActivityData::initWithActivityType_userInfo(
        type, NSDictionary::dictionaryWithTextKeys({{key, payload}}));
}

/// The line with all its incidents, packed.
std::shared_ptr<NSData> payloadOfLine(const std::shared_ptr<TransitLineItem>& line) {
    OrvoActivity activity;
    activity.setLineItem(TransitStorageLineItem::initWithLineItem(line));
    activity.setDisplayOptions(std::make_shared<URLOptions>());
    activity.displayOptions()->setMapType(TransitMapType);
    return NSDataOrvoExtra::bzip2CompressedData(*activity.data());
}

std::shared_ptr<OWUserActivityData> lineActivity(const std::shared_ptr<NSData>& payload) {
    return activityWithPayload("com.zentu.Orvo.Transit.Incident", "bs", payload);
}

} // namespace

std::shared_ptr<OWTransitIncidentsDataSourceBuilder>
OWTransitIncidentsDataSourceBuilder::initWithLineItems_maxNumberOfItems_artworkCache_analytics(
    std::shared_ptr<NSArray> lineItems,
    std::uint64_t maxNumberOfItems,
    std::shared_ptr<ArtworkDataSourceCache> artworkCache,
    std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> analytics) {
    auto builder = std::make_shared<OWTransitIncidentsDataSourceBuilder>();
    builder->_lineItems = std::move(lineItems);
    builder->_maxNumberOfItems =
        maxNumberOfItems == 0 ? std::numeric_limits<std::uint64_t>::max() : maxNumberOfItems;
    builder->_artworkCache = std::move(artworkCache);
    builder->_analytics = std::move(analytics);
    return builder;
}

const std::shared_ptr<OWTransitIncidentFilter>&
OWTransitIncidentsDataSourceBuilder::incidentFilter() {
    if (!_incidentFilter)
        _incidentFilter = std::make_shared<OWTransitIncidentFilter>();
    return _incidentFilter;
}

std::shared_ptr<OWTransitListItem> OWTransitIncidentsDataSourceBuilder::listItem() {
    if (!_listItem)
        _listItem = _buildTransitListItem();
    return _listItem;
}

std::shared_ptr<OWTransitListItem> OWTransitIncidentsDataSourceBuilder::_buildTransitListItem() {
    const auto lines = typed<TransitLineItem>(_lineItems);
    if (lines.empty())
        return _noFavoritesListItem();
    _OWDisplayedIncidents displayed;
    for (const auto& line : lines)
        _collectLine(line, displayed);
    _updateItemsAffectingSeveralLines_itemToLinesMap(displayed.rows());
    _recordDisplayed(displayed.incidents(), displayed.incidentsToLineMapping());
    return _shapedListItem(displayed);
}

void OWTransitIncidentsDataSourceBuilder::_recordDisplayed(
    const std::vector<std::shared_ptr<TransitIncident>>& incidents,
    const std::shared_ptr<NSMapTable>& mapping) const {
    if (_analytics)
        _analytics->recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
            _lineItems, NSArray::arrayOf(incidents), mapping);
}

std::shared_ptr<OWTransitListItem>
OWTransitIncidentsDataSourceBuilder::_noFavoritesListItem() const {
    _recordDisplayed({}, NSMapTable::identityMapTable());
    auto title = WidgetTexts::noFavoritesTitle();
    const auto item =
        OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
            std::move(title),
            WidgetTexts::noFavoritesSecondaryText(),
            nullptr,
            true,
            NSURLOWOpenable::openableWithURL(NSURL::URLWithString("orvo://?t=r")));
    return OWTransitListItem::initWithSummaryItem_expandedItems(item, NSArray::array());
}

void OWTransitIncidentsDataSourceBuilder::_collectLine(const std::shared_ptr<TransitLineItem>& line,
                                                       _OWDisplayedIncidents& displayed) {
    bool hasRow = false;
    const auto incidents = typed<TransitIncident>(line->incidents());
    for (std::size_t index = 0; index < incidents.size(); ++index) {
        if (!incidentFilter()->shouldDisplayIncident(*incidents[index]))
            continue;
        if (auto* row = displayed.rowOfIncident(incidents[index]->muid())) {
            row->lines.push_back(
                line); // the row is the first line's; this one stays without its own
            continue;
        }
        if (auto row = _itemForIncidentAtIndex_inLine(index, line)) {
            displayed.add(incidents[index], std::move(row), line);
            hasRow = true;
        }
    }
    if (!hasRow)
        displayed.addClearLine(line);
}

std::shared_ptr<OWTransitItem> OWTransitIncidentsDataSourceBuilder::_itemForIncidentAtIndex_inLine(
    std::size_t index, const std::shared_ptr<TransitLineItem>& line) const {
    const auto incidents = line->incidents();
    const auto incident =
        incidents && index < incidents->count()
            ? std::dynamic_pointer_cast<TransitIncident>(incidents->objectAtIndex(index))
            : nullptr;
    const auto strings = TransitIncidentStringProvider::sharedProvider();
    auto title = strings->cellTitleForIncident(incident);
    auto secondaryText = strings->cellSecondaryTextForIncident(incident);
    if (title.value_or("").empty() && secondaryText.value_or("").empty())
        return nullptr;
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        std::move(title),
        std::move(secondaryText),
        _sizedArtwork(artworkOfLine(*line)),
        false,
        _activityOfLine(line));
}

std::shared_ptr<OWUserActivityData> OWTransitIncidentsDataSourceBuilder::_activityOfLine(
    const std::shared_ptr<TransitLineItem>& line) const {
    if (_packedLine != line) {
        _payloadOfPackedLine = payloadOfLine(line);
        _packedLine = line;
    }
    return lineActivity(_payloadOfPackedLine);
}

std::shared_ptr<OWConfiguredArtwork> OWTransitIncidentsDataSourceBuilder::_sizedArtwork(
    const std::shared_ptr<TransitArtworkDataSource>& artwork) const {
    return OWConfiguredArtwork::initWithArtworkSource_alpha(
        SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(
            artwork, RowShieldSize, _artworkCache),
        FullAlpha);
}

std::shared_ptr<OWUserActivityData>
OWTransitIncidentsDataSourceBuilder::_userActivityDataForLineItem(
    const std::shared_ptr<TransitLineItem>& line) {
    return lineActivity(payloadOfLine(line));
}

std::shared_ptr<OWUserActivityData> OWTransitIncidentsDataSourceBuilder::_activityDataForIncidents(
    const std::vector<std::shared_ptr<TransitIncident>>& incidents) {
    const auto storage =
        OrvoMap(NSArray::arrayOf(incidents), [](const auto& incident, std::size_t) {
            return TransitStorageIncident::initWithIncident(
                std::dynamic_pointer_cast<TransitIncident>(incident));
        });
    const auto archive = NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
        storage, true, nullptr);
    return activityWithPayload("com.zentu.Orvo.Transit.IncidentList", "incidentListKey", archive);
}

void OWTransitIncidentsDataSourceBuilder::_updateItemsAffectingSeveralLines_itemToLinesMap(
    std::vector<_OWDisplayedRow>& rows) const {
    for (auto& row : rows) {
        if (row.lines.size() < 2)
            continue;
        row.item = OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
            row.item->primaryText(),
            WidgetTexts::_prependLineNames_toText({row.lines.begin(), row.lines.end()},
                                                  row.item->secondaryText()),
            _sharedArtwork(row.lines),
            row.item->isArtworkHidden(),
            row.item->openable());
    }
}

std::shared_ptr<OWConfiguredArtwork> OWTransitIncidentsDataSourceBuilder::_sharedArtwork(
    const std::vector<std::shared_ptr<TransitLineItem>>& lines) const {
    // The systems' artwork, never the lines' own. Lines before the first that has one are passed
    // over; after it, one that has none, or another, makes the row generic.
    std::shared_ptr<TransitArtworkDataSource> reference;
    bool isGeneric = false;
    for (const auto& line : lines) {
        const auto artwork = artworkOfSystem(*line);
        if (!reference)
            reference = artwork;
        else if (!sameTransitArtwork(reference, artwork))
            isGeneric = true;
    }
    return reference && !isGeneric ? _sizedArtwork(reference)
                                   : imageArtwork("WidgetGenericTransit", GenericAlpha);
}

std::shared_ptr<OWTransitListItem>
OWTransitIncidentsDataSourceBuilder::_shapedListItem(_OWDisplayedIncidents& displayed) const {
    Rows rows;
    for (const auto& row : displayed.rows())
        rows.push_back(row.item);
    if (rows.empty())
        return OWTransitListItem::initWithSummaryItem_expandedItems(
            fixedRow({WidgetTexts::goodServiceTitle(),
                      WidgetTexts::goodServiceSecondaryText(_lineItems->count()),
                      imageArtwork("good-v2", FullAlpha),
                      NSURLOWOpenable::openableWithURL(_urlForFavorites())}),
            NSArray::array());

    const bool hasClearLines = !displayed.clearLines().empty();
    const bool hasOneAdvisory = rows.size() == 1;
    std::shared_ptr<NSObject> summary = rows.front();
    if (!hasOneAdvisory)
        summary =
            _summaryItemForIncidents_items_itemToLinesMap(displayed.incidents(), displayed.rows());
    if (hasClearLines)
        rows.push_back(
            fixedRow({WidgetTexts::goodServiceTitle(),
                      WidgetTexts::clearServiceSecondaryText(displayed.clearLines().size()),
                      imageArtwork("good-alt-v2", DimmedAlpha),
                      NSURLOWOpenable::openableWithURL(_urlForFavorites())}));
    if (hasOneAdvisory && !hasClearLines)
        rows.clear(); // the one row is the compact one already
    else if (!hasOneAdvisory)
        _cutOverflow(rows, displayed);
    return OWTransitListItem::initWithSummaryItem_expandedItems(summary, NSArray::arrayOf(rows));
}

void OWTransitIncidentsDataSourceBuilder::_cutOverflow(
    Rows& rows, const _OWDisplayedIncidents& displayed) const {
    const std::size_t count = rows.size();
    if (count <= _maxNumberOfItems)
        return;
    const bool hasClearRow = !displayed.clearLines().empty();
    const std::size_t excess = count - static_cast<std::size_t>(_maxNumberOfItems);
    const std::size_t removed = excess + 1; // one more, for the overflow row
    const bool removesAll = removed == count;
    // The clear row stays last, unless there is room for the overflow row alone; then it goes too,
    // and it hides no incident.
    const std::size_t start = hasClearRow && !removesAll ? count - removed - 1 : count - removed;
    const std::size_t hidden = hasClearRow && removesAll ? excess : removed;

    const auto first = rows.begin() + static_cast<std::ptrdiff_t>(start);
    rows.erase(first, first + static_cast<std::ptrdiff_t>(removed));
    const auto& incidents = displayed.incidents();
    if (hidden < 2 || hidden > incidents.size())
        return;
    const std::vector<std::shared_ptr<TransitIncident>> hiddenIncidents(
        incidents.end() - static_cast<std::ptrdiff_t>(hidden), incidents.end());
    rows.insert(rows.begin() + static_cast<std::ptrdiff_t>(start),
                _incidentsOverflowItemForIncidents_incidentsToLineMapping(
                    hiddenIncidents, displayed.incidentsToLineMapping()));
}

std::shared_ptr<OWTransitSummaryItem>
// NOLINTNEXTLINE(readability-convert-member-functions-to-static): the name is one of an instance
OWTransitIncidentsDataSourceBuilder::_summaryItemForIncidents_items_itemToLinesMap(
    const std::vector<std::shared_ptr<TransitIncident>>& incidents,
    const std::vector<_OWDisplayedRow>& rows) const {
    std::vector<std::shared_ptr<TransitArtworkDataSource>> artworks;
    KeyIndex known;
    for (const auto& row : rows)
        for (const auto& line : row.lines) {
            auto artwork = artworkOfLine(*line);
            if (!artwork || known.find(*artwork))
                continue;
            known.insert(*artwork, artworks.size());
            artworks.push_back(std::move(artwork));
        }
    auto text = WidgetTexts::summaryText(incidents.size());
    return OWTransitSummaryItem::initWithText_artworks_userActivityData(
        std::move(text), NSArray::arrayOf(artworks), _activityDataForIncidents(incidents));
}

std::shared_ptr<NSURL> OWTransitIncidentsDataSourceBuilder::_urlForFavorites() {
    const auto builder = MapURLBuilder::URLForShowingFavoritesWithType(TransitFavoritesType);
    builder->setMapType(TransitMapType);
    shareSessionWithOrvo();
    return MapItem::_sharedSessionURLForPunchoutURL(builder->build()->absoluteString());
}

std::shared_ptr<OWTransitItem>
OWTransitIncidentsDataSourceBuilder::_incidentsOverflowItemForIncidents_incidentsToLineMapping(
    const std::vector<std::shared_ptr<TransitIncident>>& incidents,
    const std::shared_ptr<NSMapTable>& mapping) {
    // Distinct lines by object, and only the line in which each incident was first met.
    const auto lines = NSMapTable::identityMapTable();
    for (const auto& incident : incidents)
        if (const auto line = mapping->objectForKey(incident))
            lines->setObject_forKey(line, line);
    return fixedRow({WidgetTexts::overflowTitle(incidents.size()),
                     WidgetTexts::overflowSecondaryText(lines->count()),
                     imageArtwork("advisories-v2", DimmedAlpha),
                     _activityDataForIncidents(incidents)});
}

} // namespace orvo
