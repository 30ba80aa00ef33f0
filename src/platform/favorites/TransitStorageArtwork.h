#pragma once

#include "platform/geoservices/TransitArtworkDataSource.h"
#include "platform/protobuf/ProtoOpaque.h"

namespace orvo {

/// An artwork descriptor in its storable form: the message's bytes, made from a descriptor or read.
/// Immutable once made.
class TransitStorageArtwork final : public ProtoOpaque {
public:
    /// Nil for a nil artwork.
    [[nodiscard]] static std::shared_ptr<TransitStorageArtwork>
    initWithArtwork(const std::shared_ptr<TransitArtworkDataSource>& artwork);

    /// A descriptor equal to the one it was made from. Fields that this version does not know are
    /// left out; nil when the bytes are not an artwork.
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> artwork() const;

protected:
    [[nodiscard]] std::shared_ptr<ProtoOpaque> _alloc() const override {
        return std::make_shared<TransitStorageArtwork>();
    }
};

/// The artwork of a storable form that may be nil.
[[nodiscard]] std::shared_ptr<TransitArtworkDataSource>
artworkOf(const std::shared_ptr<TransitStorageArtwork>& storage);

} // namespace orvo
