#include "platform/protobuf/ProtoCodable.h"

namespace orvo {

std::shared_ptr<NSData> ProtoCodable::data() const {
    ProtoWriter writer;
    writeTo(writer);
    return NSData::dataWithBytes(writer.bytes());
}

std::string ProtoCodable::description() const {
    return rootDescription() + " " + dictionaryRepresentation()->description();
}

} // namespace orvo
