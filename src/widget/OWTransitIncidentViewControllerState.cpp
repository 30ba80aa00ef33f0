#include "widget/OWTransitIncidentViewControllerState.h"

#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSKeyedUnarchiver.h"
#include "shared/OrvoMap.h"

#include <utility>

namespace orvo {

namespace {

constexpr const char* ClassName = "OWTransitIncidentViewControllerState";
constexpr const char* FormerClassName = "OWTransitListItemData";

// In the singular, unlike the property. Archives have them so.
constexpr const char* SuccessKey = "lineItemResultSuccess";
constexpr const char* ErrorKey = "lineItemResultError";
constexpr const char* ExpandedKey = "expanded";

std::shared_ptr<NSArray> storageItems(const std::shared_ptr<NSObject>& lineItems) {
    return OrvoMap(std::dynamic_pointer_cast<NSArray>(lineItems),
                   [](const auto& lineItem, std::size_t) {
                       return TransitStorageLineItem::initWithLineItem(
                           std::dynamic_pointer_cast<TransitLineItem>(lineItem));
                   });
}

/// Nil where there is none. A success that does not decode is none: the error is not looked for.
std::shared_ptr<Result> decodedResult(NSCoder& coder) {
    if (coder.containsValueForKey(SuccessKey)) {
        const auto items = std::dynamic_pointer_cast<NSArray>(
            coder.decodeObjectOfClasses_forKey({"NSArray", "TransitStorageLineItem"}, SuccessKey));
        return items ? Result::resultWithValue(items) : nullptr;
    }
    if (coder.containsValueForKey(ErrorKey)) {
        const auto error = coder.decodeObjectOfClass_forKey<NSError>("NSError", ErrorKey);
        return error ? Result::resultWithError(error) : nullptr;
    }
    return nullptr;
}

} // namespace

std::shared_ptr<OWTransitIncidentViewControllerState>
OWTransitIncidentViewControllerState::initWithLineItemsResult_expanded(
    std::shared_ptr<Result> lineItemsResult, bool expanded) {
    auto state = std::make_shared<OWTransitIncidentViewControllerState>();
    state->_lineItemsResult = std::move(lineItemsResult);
    state->_expanded = expanded;
    return state;
}

std::shared_ptr<OWTransitIncidentViewControllerState>
OWTransitIncidentViewControllerState::initWithCoder(NSCoder& coder) {
    auto result = decodedResult(coder);
    if (!result)
        return nullptr;
    return initWithLineItemsResult_expanded(std::move(result), coder.decodeBoolForKey(ExpandedKey));
}

std::shared_ptr<OWTransitIncidentViewControllerState>
OWTransitIncidentViewControllerState::unarchiveFromData_error(const std::shared_ptr<NSData>& data,
                                                              std::shared_ptr<NSError>* error) {
    // Why bytes cannot even be opened is of no interest to anybody.
    const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(data);
    if (!unarchiver)
        return nullptr;
    unarchiver->setClass_forClassName(ClassName, FormerClassName);
    unarchiver->setDecodingFailurePolicy(NSDecodingFailurePolicy::SetErrorAndReturn);
    const auto root = unarchiver->decodeTopLevelObjectOfClasses_forKey_error(
        {ClassName}, NSKeyedArchiveRootObjectKey, error);
    unarchiver->finishDecoding();
    return std::dynamic_pointer_cast<OWTransitIncidentViewControllerState>(root);
}

void OWTransitIncidentViewControllerState::encodeWithCoder(NSCoder& coder) const {
    if (_lineItemsResult)
        _lineItemsResult->withValue_orError(
            [&](const auto& lineItems) {
                coder.encodeObject_forKey(storageItems(lineItems), SuccessKey);
            },
            [&](const auto& error) { coder.encodeObject_forKey(error, ErrorKey); });
    coder.encodeBool_forKey(_expanded, ExpandedKey);
}

std::string OWTransitIncidentViewControllerState::description() const {
    return rootDescription() + " expanded: " + (_expanded ? "YES" : "NO") +
           " result: " + descriptionOf(_lineItemsResult);
}

} // namespace orvo
