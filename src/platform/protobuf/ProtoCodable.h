#pragma once

#include "platform/foundation/NSData.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSObject.h"
#include "platform/protobuf/ProtoReader.h"
#include "platform/protobuf/ProtoWriter.h"

namespace orvo {

/// The base of every message.
class ProtoCodable : public virtual NSCopying {
public:
    /// Reads fields to the end of the message. False after any error; the receiver is then half
    /// filled and not to be used.
    virtual bool readFrom(ProtoReader& reader) = 0;
    /// Cannot fail.
    virtual void writeTo(ProtoWriter& writer) const = 0;
    /// Takes every field that `other` has; sub-messages on both sides are merged. Nothing where
    /// `other` is of another class.
    virtual void mergeFrom(const ProtoCodable& other) = 0;
    /// Every field that is present under its name.
    [[nodiscard]] virtual std::shared_ptr<NSDictionary> dictionaryRepresentation() const = 0;

    /// The encoded bytes.
    [[nodiscard]] std::shared_ptr<NSData> data() const;
    /// The root description and the dictionary, a blank between.
    [[nodiscard]] std::string description() const override;
};

/// A new message of class T read from `bytes`; nil when they are not one.
template <class T>
[[nodiscard]] std::shared_ptr<T> protoMessageWithBytes(std::span<const std::uint8_t> bytes) {
    auto message = std::make_shared<T>();
    ProtoReader reader(bytes);
    return message->readFrom(reader) ? message : nullptr;
}

} // namespace orvo
