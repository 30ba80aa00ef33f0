#pragma once

#include "platform/favorites/TransitStorageArtwork.h"
#include "platform/geoservices/TransitSystem.h"
#include "platform/protobuf/ProtoMessage.h"

namespace orvo {

/// A storable copy of a line's system.
class TransitStorageSystem final : public ProtoMessage<TransitStorageSystem>,
                                   public virtual TransitSystem {
public:
    /// Nil for a nil system.
    [[nodiscard]] static std::shared_ptr<TransitStorageSystem>
    initWithSystem(const std::shared_ptr<TransitSystem>& system);

    [[nodiscard]] std::optional<std::string> name() const override { return _name; }
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> artwork() const override {
        return artworkOf(_artwork);
    }

    [[nodiscard]] static auto schema() {
        using Self = TransitStorageSystem;
        return std::tuple{
            ProtoStringField<Self>{1, "name", &Self::_name},
            ProtoMessageField<Self, TransitStorageArtwork>{2, "artwork", &Self::_artwork}};
    }

private:
    friend class ProtoMessage<TransitStorageSystem>;

    std::optional<std::string> _name;
    std::shared_ptr<TransitStorageArtwork> _artwork;
};

} // namespace orvo
