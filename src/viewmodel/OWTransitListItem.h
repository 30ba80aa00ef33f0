#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSExtensionContext.h"
#include "platform/foundation/NSObject.h"

namespace orvo {

/// Everything that the widget shows. Immutable.
class OWTransitListItem : public virtual NSObject {
public:
    /// `summaryItem` is an `OWTransitSummaryItem` or an `OWTransitItem`; `expandedItems` holds
    /// `OWTransitItem`s.
    [[nodiscard]] static std::shared_ptr<OWTransitListItem>
    initWithSummaryItem_expandedItems(std::shared_ptr<NSObject> summaryItem,
                                      std::shared_ptr<NSArray> expandedItems);

    /// The compact mode's one row.
    [[nodiscard]] const std::shared_ptr<NSObject>& summaryItem() const noexcept {
        return _summaryItem;
    }
    /// The expanded mode's rows, in order.
    [[nodiscard]] const std::shared_ptr<NSArray>& expandedItems() const noexcept {
        return _expandedItems;
    }

    /// Any kind of this class.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] bool isEqualToListItem(const OWTransitListItem& other) const;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    std::shared_ptr<NSObject> _summaryItem;
    std::shared_ptr<NSArray> _expandedItems;
};

namespace OWTransitListItemNCWidget {

/// The largest mode that the list item can fill: expanded with at least one expanded item, else
/// compact.
[[nodiscard]] NCWidgetDisplayMode
widgetLargestAvailableDisplayMode(const OWTransitListItem& listItem);

} // namespace OWTransitListItemNCWidget

} // namespace orvo
