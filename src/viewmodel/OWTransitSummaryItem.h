#pragma once

#include "handoff/OWUserActivityData.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>

namespace orvo {

/// The compact row for two or more advisories: how many there are, and the shields of their lines.
/// Immutable.
class OWTransitSummaryItem : public virtual NSObject {
public:
    /// `artworks`: `TransitArtworkDataSource`s as the lines have them, no two the same, in order.
    /// All may be nil.
    [[nodiscard]] static std::shared_ptr<OWTransitSummaryItem>
    initWithText_artworks_userActivityData(std::optional<std::string> text,
                                           std::shared_ptr<NSArray> artworks,
                                           std::shared_ptr<OWUserActivityData> userActivityData);

    [[nodiscard]] const std::optional<std::string>& primaryText() const noexcept {
        return _primaryText;
    }
    [[nodiscard]] const std::shared_ptr<NSArray>& artworks() const noexcept { return _artworks; }
    /// What a tap opens.
    [[nodiscard]] const std::shared_ptr<OWUserActivityData>& userActivityData() const noexcept {
        return _userActivityData;
    }

    /// Any kind of this class.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] bool isEqualToSummaryItem(const OWTransitSummaryItem& other) const;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    std::optional<std::string> _primaryText;
    std::shared_ptr<NSArray> _artworks;
    std::shared_ptr<OWUserActivityData> _userActivityData;
};

} // namespace orvo
