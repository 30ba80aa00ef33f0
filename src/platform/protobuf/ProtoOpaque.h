#pragma once

#include "platform/protobuf/ProtoCodable.h"

#include <vector>

namespace orvo {

/// A message whose schema is its owner's business: its bytes are carried through unchanged.
class ProtoOpaque : public ProtoCodable {
public:
    [[nodiscard]] const std::vector<std::uint8_t>& bytes() const noexcept { return _bytes; }
    void setBytes(std::vector<std::uint8_t> bytes) { _bytes = std::move(bytes); }

    bool readFrom(ProtoReader& reader) override;
    void writeTo(ProtoWriter& writer) const override;
    /// Appends the other's bytes: in this encoding that is what merging means.
    void mergeFrom(const ProtoCodable& other) override;
    /// The bytes under `bytes`, where there are any.
    [[nodiscard]] std::shared_ptr<NSDictionary> dictionaryRepresentation() const override;
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

protected:
    /// A new instance of the receiver's own class.
    [[nodiscard]] virtual std::shared_ptr<ProtoOpaque> _alloc() const {
        return std::make_shared<ProtoOpaque>();
    }

private:
    std::vector<std::uint8_t> _bytes;
};

} // namespace orvo
