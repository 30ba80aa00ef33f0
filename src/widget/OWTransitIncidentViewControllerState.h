#pragma once

#include "platform/foundation/NSCoder.h"
#include "platform/foundation/NSCoding.h"
#include "platform/foundation/NSData.h"
#include "widget/result/Result.h"

namespace orvo {

/// What the widget showed when it disappeared, to be shown again before the first fetch of its next
/// life has ended. Immutable.
class OWTransitIncidentViewControllerState final : public virtual NSSecureCoding {
public:
    /// `lineItemsResult`: an array of `TransitLineItem`s, or the error.
    [[nodiscard]] static std::shared_ptr<OWTransitIncidentViewControllerState>
    initWithLineItemsResult_expanded(std::shared_ptr<Result> lineItemsResult, bool expanded);
    /// A success holds `TransitStorageLineItem`s. Nil where the coder holds no result.
    [[nodiscard]] static std::shared_ptr<OWTransitIncidentViewControllerState>
    initWithCoder(NSCoder& coder);
    /// Nil, with an error, for an archive that does not decode. Nil without an error for bytes that
    /// are no archive at all, and for an archive that holds no result. Archives of a record under
    /// its former name are read too.
    [[nodiscard]] static std::shared_ptr<OWTransitIncidentViewControllerState>
    unarchiveFromData_error(const std::shared_ptr<NSData>& data, std::shared_ptr<NSError>* error);

    [[nodiscard]] bool expanded() const noexcept { return _expanded; }
    [[nodiscard]] const std::shared_ptr<Result>& lineItemsResult() const noexcept {
        return _lineItemsResult;
    }

    /// Either the line items, as storable copies, or the error; then the flag.
    void encodeWithCoder(NSCoder& coder) const override;
    [[nodiscard]] std::string description() const override;

private:
    bool _expanded = false;
    std::shared_ptr<Result> _lineItemsResult;
};

} // namespace orvo
