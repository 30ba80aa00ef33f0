#include "viewmodel/OWTransitListItem.h"

namespace orvo {

std::shared_ptr<OWTransitListItem>
OWTransitListItem::initWithSummaryItem_expandedItems(std::shared_ptr<NSObject> summaryItem,
                                                     std::shared_ptr<NSArray> expandedItems) {
    auto item = std::make_shared<OWTransitListItem>();
    item->_summaryItem = std::move(summaryItem);
    item->_expandedItems = std::move(expandedItems); // immutable, so a copy is the array itself
    return item;
}

bool OWTransitListItem::isEqual(const NSObject* other) const {
    const auto* item = dynamic_cast<const OWTransitListItem*>(other);
    return item && isEqualToListItem(*item);
}

bool OWTransitListItem::isEqualToListItem(const OWTransitListItem& other) const {
    return equal(_summaryItem, other._summaryItem) && equal(_expandedItems, other._expandedItems);
}

std::uint64_t OWTransitListItem::hash() const {
    return hashOf(_summaryItem) ^ hashOf(_expandedItems);
}

std::string OWTransitListItem::description() const {
    return rootDescription() + " summary: " + descriptionOf(_summaryItem) +
           " expanded: " + descriptionOf(_expandedItems);
}

NCWidgetDisplayMode
OWTransitListItemNCWidget::widgetLargestAvailableDisplayMode(const OWTransitListItem& listItem) {
    return listItem.expandedItems() && listItem.expandedItems()->count() > 0
               ? NCWidgetDisplayMode::Expanded
               : NCWidgetDisplayMode::Compact;
}

} // namespace orvo
