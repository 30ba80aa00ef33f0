#pragma once

#include "platform/foundation/NSCoder.h"
#include "platform/foundation/NSData.h"
#include "platform/protobuf/ProtoCodable.h"

namespace orvo {

/// The key under which a storable record's message stands in an archive.
inline constexpr const char* StorageMessageKey = "message";

inline void encodeMessage(const ProtoCodable& message, NSCoder& coder) {
    coder.encodeObject_forKey(message.data(), StorageMessageKey);
}

/// Nil, with the coding failed, for bytes that are no such message; nil alone where there are none.
template <class T>
[[nodiscard]] std::shared_ptr<T> decodedMessage(NSCoder& coder) {
    const auto data = coder.decodeObjectOfClass_forKey<NSData>("NSData", StorageMessageKey);
    if (!data)
        return nullptr;
    auto message = protoMessageWithBytes<T>(data->bytes());
    if (!message)
        coder.failWithError(
            NSError::errorWithMessage(NSCocoaErrorDomain,
                                      NSCoderReadCorruptError,
                                      "The bytes of a storable record are no message."));
    return message;
}

} // namespace orvo
