#pragma once

#include "handoff/OWOpenable.h"
#include "platform/foundation/NSObject.h"
#include "viewmodel/OWConfiguredArtwork.h"

#include <optional>
#include <string>

namespace orvo {

/// One row. Immutable.
class OWTransitItem : public virtual NSCopying {
public:
    /// Every argument but the flag may be nil.
    [[nodiscard]] static std::shared_ptr<OWTransitItem>
    initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        std::optional<std::string> primaryText,
        std::optional<std::string> secondaryText,
        std::shared_ptr<OWConfiguredArtwork> artwork,
        bool artworkHidden,
        std::shared_ptr<OWOpenable> openable);

    [[nodiscard]] const std::optional<std::string>& primaryText() const noexcept {
        return _primaryText;
    }
    [[nodiscard]] const std::optional<std::string>& secondaryText() const noexcept {
        return _secondaryText;
    }
    [[nodiscard]] const std::shared_ptr<OWConfiguredArtwork>& artwork() const noexcept {
        return _artwork;
    }
    [[nodiscard]] bool isArtworkHidden() const noexcept { return _artworkHidden; }
    /// What a tap opens; nil for a row that cannot be tapped.
    [[nodiscard]] const std::shared_ptr<OWOpenable>& openable() const noexcept { return _openable; }

    /// Itself, or else only an object of exactly this class: never one of a subclass, unlike the
    /// other items. Kept so.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] bool isEqualToTransitItem(const OWTransitItem& other) const;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;
    /// A new instance of the receiver's own class.
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

protected:
    void _initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        std::optional<std::string> primaryText,
        std::optional<std::string> secondaryText,
        std::shared_ptr<OWConfiguredArtwork> artwork,
        bool artworkHidden,
        std::shared_ptr<OWOpenable> openable);
    [[nodiscard]] virtual std::shared_ptr<OWTransitItem> _alloc() const {
        return std::make_shared<OWTransitItem>();
    }

private:
    std::optional<std::string> _primaryText;
    std::optional<std::string> _secondaryText;
    std::shared_ptr<OWConfiguredArtwork> _artwork;
    bool _artworkHidden = false;
    std::shared_ptr<OWOpenable> _openable;
};

} // namespace orvo
