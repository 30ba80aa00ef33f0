#include "viewmodel/OWTransitIncidentDataSourceErrorBuilder.h"

#include "platform/mapuikit/NetworkFailureDiagnosis.h"
#include "viewmodel/WidgetTexts.h"

namespace orvo {

std::shared_ptr<OWTransitIncidentDataSourceErrorBuilder>
OWTransitIncidentDataSourceErrorBuilder::initWithError(std::shared_ptr<NSError> error) {
    auto builder = std::make_shared<OWTransitIncidentDataSourceErrorBuilder>();
    builder->_error = std::move(error);
    return builder;
}

std::shared_ptr<OWTransitListItem> OWTransitIncidentDataSourceErrorBuilder::listItem() {
    if (!_listItem)
        _listItem = OWTransitListItem::initWithSummaryItem_expandedItems(_buildErrorItem(),
                                                                         NSArray::array());
    return _listItem;
}

std::shared_ptr<OWTransitItem> OWTransitIncidentDataSourceErrorBuilder::_buildErrorItem() const {
    auto title = WidgetTexts::localized("TransitWidgetLoadingError_Title");
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        std::move(title), _errorMessage(), nullptr, true, nullptr);
}

// NOLINTNEXTLINE(readability-convert-member-functions-to-static): the name is one of an instance
std::optional<std::string> OWTransitIncidentDataSourceErrorBuilder::_errorMessage() const {
    switch (static_cast<NetworkFailureDiagnosis>(CurrentNetworkFailureDiagnosis())) {
    case NetworkFailureDiagnosis::None:
    case NetworkFailureDiagnosis::Unknown:
        return WidgetTexts::localized("TransitWidgetLoadingError_Unknown");
    case NetworkFailureDiagnosis::AirplaneMode:
        return WidgetTexts::localized("TransitWidgetLoadingError_AirplaneMode");
    case NetworkFailureDiagnosis::CellDataDisabled:
        return WidgetTexts::localized("TransitWidgetLoadingError_CellDataDisabled");
    case NetworkFailureDiagnosis::NoInternet:
        return WidgetTexts::localized("TransitWidgetLoadingError_No_Internet");
    }
    return std::nullopt;
}

} // namespace orvo
