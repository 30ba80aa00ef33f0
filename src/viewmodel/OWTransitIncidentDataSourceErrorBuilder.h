#pragma once

#include "platform/foundation/NSError.h"
#include "viewmodel/OWTransitItem.h"
#include "viewmodel/OWTransitItemDataSourceBuilder.h"

namespace orvo {

/// Turns a failed fetch into one row that says so, with the likely cause as the network's state
/// tells it when the row is built. What the error says is not shown.
class OWTransitIncidentDataSourceErrorBuilder final : public OWTransitItemDataSourceBuilder {
public:
    [[nodiscard]] static std::shared_ptr<OWTransitIncidentDataSourceErrorBuilder>
    initWithError(std::shared_ptr<NSError> error);

    [[nodiscard]] const std::shared_ptr<NSError>& error() const noexcept { return _error; }
    void setError(std::shared_ptr<NSError> error) { _error = std::move(error); }

    [[nodiscard]] std::shared_ptr<OWTransitListItem> listItem() override;
    [[nodiscard]] std::optional<std::int64_t> analyticsResultType() const override { return 0; }
    [[nodiscard]] std::optional<std::shared_ptr<NSArray>>
    analyticsTransitIncidentItems() const override {
        return std::shared_ptr<NSArray>();
    }

    [[nodiscard]] std::shared_ptr<OWTransitItem> _buildErrorItem() const;
    /// Nil for a diagnosis that nothing is known of.
    [[nodiscard]] std::optional<std::string> _errorMessage() const;

private:
    std::shared_ptr<OWTransitListItem> _listItem;
    std::shared_ptr<NSError> _error;
};

} // namespace orvo
