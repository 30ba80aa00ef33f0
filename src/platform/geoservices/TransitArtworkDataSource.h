#pragma once

#include "platform/foundation/NSObject.h"
#include "platform/geoservices/TransitIconDataSource.h"
#include "platform/geoservices/TransitShieldDataSource.h"
#include "platform/geoservices/TransitTextDataSource.h"

#include <optional>
#include <string>

namespace orvo {

/// Describes a line's or system's artwork: which kind, and what each kind shows. Immutable.
///
/// Equality is the one rule by which two artworks are called the same: every field below, in order.
class TransitArtworkDataSource final : public virtual NSObject {
public:
    struct Fields {
        std::int32_t artworkSourceType = 0; ///< `TransitArtworkSourceType`
        std::int32_t artworkUseType = 0;
        std::shared_ptr<TransitShieldDataSource> shieldDataSource;
        std::shared_ptr<TransitIconDataSource> iconDataSource;
        std::shared_ptr<TransitShieldDataSource> iconFallbackShieldDataSource;
        std::shared_ptr<TransitTextDataSource> textDataSource;
        bool hasRoutingIncidentBadge = false;
        std::optional<std::string> accessibilityText; ///< as a voice should say it
    };

    [[nodiscard]] static std::shared_ptr<TransitArtworkDataSource> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }
    [[nodiscard]] std::int32_t artworkSourceType() const { return _fields.artworkSourceType; }
    [[nodiscard]] std::int32_t artworkUseType() const { return _fields.artworkUseType; }
    [[nodiscard]] std::shared_ptr<TransitShieldDataSource> shieldDataSource() const {
        return _fields.shieldDataSource;
    }
    [[nodiscard]] std::shared_ptr<TransitIconDataSource> iconDataSource() const {
        return _fields.iconDataSource;
    }
    [[nodiscard]] std::shared_ptr<TransitShieldDataSource> iconFallbackShieldDataSource() const {
        return _fields.iconFallbackShieldDataSource;
    }
    [[nodiscard]] std::shared_ptr<TransitTextDataSource> textDataSource() const {
        return _fields.textDataSource;
    }
    [[nodiscard]] bool hasRoutingIncidentBadge() const { return _fields.hasRoutingIncidentBadge; }
    [[nodiscard]] std::optional<std::string> accessibilityText() const {
        return _fields.accessibilityText;
    }

    /// Every field, in order of declaration; two nils are equal.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;

private:
    Fields _fields;
};

} // namespace orvo
