#include "orvo/HandOffSize.h"

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/PropertyList.h"
#include "platform/protobuf/ProtoReader.h"

namespace orvo {

namespace {

/// The bytes of the messages under a field number, one after the other.
template <class Visit>
void visitMessages(std::span<const std::uint8_t> message, std::uint32_t field, Visit&& visit) {
    ProtoReader reader(message);
    while (!reader.isAtEnd()) {
        const auto tag = reader.readTag();
        if (tag.fieldNumber == field && tag.wireType == ProtoWireType::LengthDelimited)
            visit(reader.readBytes());
        else
            reader.skip(tag);
    }
}

void addIncident(HandOffSize& size, std::span<const std::uint8_t> incident) {
    constexpr std::uint32_t EntityField = 14;
    constexpr std::uint32_t StopField = 3;
    size.messageBytes += incident.size();
    ++size.records;
    visitMessages(incident, EntityField, [&](auto entity) {
        ++size.records;
        visitMessages(entity, StopField, [&](auto) { ++size.records; });
    });
}

} // namespace

HandOffSize HandOffSize::ofActivity(std::span<const std::uint8_t> message) {
    constexpr std::uint32_t LineField = 15;
    constexpr std::uint32_t IncidentField = 13;
    HandOffSize size;
    visitMessages(message, LineField, [&](auto line) {
        visitMessages(line, IncidentField, [&](auto incident) { addIncident(size, incident); });
    });
    return size;
}

HandOffSize HandOffSize::ofArchive(const NSData& archive, const HandOffSize& limit) {
    HandOffSize size;
    const auto root = std::dynamic_pointer_cast<NSDictionary>(PropertyList::read(archive.bytes()));
    const auto objects =
        root ? std::dynamic_pointer_cast<NSArray>(root->objectForKey("$objects")) : nullptr;
    if (!objects)
        return size;
    for (const auto& object : objects->elements()) {
        const auto* record = dynamic_cast<const NSDictionary*>(object.get());
        const auto reference =
            record ? std::dynamic_pointer_cast<PropertyListUID>(record->objectForKey("message"))
                   : nullptr;
        if (!reference || reference->value() >= objects->count())
            continue;
        const auto message = std::dynamic_pointer_cast<NSData>(
            objects->objectAtIndex(static_cast<std::size_t>(reference->value())));
        if (!message)
            continue;
        // The bytes are not even walked when they alone are too many.
        if (size.messageBytes + message->length() > limit.messageBytes) {
            size.messageBytes += message->length();
            return size;
        }
        addIncident(size, message->bytes());
        if (!size.isWithin(limit))
            return size;
    }
    return size;
}

} // namespace orvo
