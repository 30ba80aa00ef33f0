#include "print/PrintedWidget.h"

#include "platform/geoservices/TransitIncident.h"
#include "platform/geoservices/TransitLineItem.h"
#include "viewmodel/OWTransitIncidentFilter.h"

#include <algorithm>

namespace orvo {

namespace {

constexpr const char* GoodServiceImage = "good-v2";
constexpr int Percent = 100;

bool showsGoodService(const PrintedRow& summary) {
    return summary.artwork && summary.artwork->image == GoodServiceImage;
}

bool isClear(const TransitLineItem& line) {
    const OWTransitIncidentFilter filter;
    return std::ranges::none_of(
        typed<TransitIncident>(line.incidents()),
        [&](const auto& incident) { return filter.shouldDisplayIncident(*incident); });
}

void judge(PrintedWidget& widget, const std::shared_ptr<NSArray>& lineItems) {
    const auto lines = typed<TransitLineItem>(lineItems);
    if (lines.empty()) {
        widget.state = ServiceState::NoFavorites;
        return;
    }
    if (showsGoodService(widget.summary)) {
        widget.state = ServiceState::Good;
        widget.clearPercentage = Percent;
        return;
    }
    widget.state = ServiceState::Advisories;
    const auto clear =
        std::ranges::count_if(lines, [](const auto& line) { return isClear(*line); });
    widget.clearPercentage =
        static_cast<int>(clear * Percent / static_cast<std::ptrdiff_t>(lines.size()));
}

} // namespace

PrintedWidget PrintedWidget::of(const OWTransitListItem& list,
                                const std::shared_ptr<Result>& result) {
    PrintedWidget widget;
    widget.summary = PrintedRow::of(list.summaryItem());
    for (const auto& item : typed<NSObject>(list.expandedItems())) {
        const auto* before = widget.expanded.empty() ? nullptr : &widget.expanded.back();
        widget.expanded.push_back(PrintedRow::of(item, before));
    }
    result->withValue_orError(
        [&](const Result::Value& value) {
            judge(widget, std::dynamic_pointer_cast<NSArray>(value));
        },
        [](const Result::Error&) {});
    return widget;
}

} // namespace orvo
