#pragma once

#include "platform/foundation/NSData.h"
#include "platform/protobuf/ProtoWriter.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo::testing {

/// One alert of a GTFS-Realtime message, made by hand. What is empty is left out.
struct AlertEntity {
    std::string id = "alert";
    std::vector<std::string> routes;
    std::vector<std::string> agencies;
    std::string header = "Works";
    std::string headerLanguage;
    std::string description;
    std::int32_t effect = 2; // reduced service
    std::optional<std::uint64_t> start;
    std::optional<std::uint64_t> end;
    bool breaksOffInSelector = false;
};

inline void write(ProtoWriter& alert,
                  std::uint32_t field,
                  const std::string& text,
                  const std::string& language) {
    if (text.empty())
        return;
    ProtoWriter translation;
    translation.writeString(1, text);
    if (!language.empty())
        translation.writeString(2, language);
    ProtoWriter translated;
    translated.writeBytes(1, translation.bytes());
    alert.writeBytes(field, translated.bytes());
}

inline ProtoWriter encode(const AlertEntity& entity) {
    ProtoWriter alert;
    if (entity.start || entity.end) {
        ProtoWriter period;
        if (entity.start)
            period.writeUInt64(1, *entity.start);
        if (entity.end)
            period.writeUInt64(2, *entity.end);
        alert.writeBytes(1, period.bytes());
    }
    const auto writeSelector = [&](std::uint32_t field, const std::string& value) {
        ProtoWriter selector;
        selector.writeString(field, value);
        alert.writeBytes(5, selector.bytes());
    };
    for (const auto& agency : entity.agencies)
        writeSelector(1, agency);
    for (const auto& route : entity.routes)
        writeSelector(2, route);
    if (entity.breaksOffInSelector)
        alert.writeBytes(5, std::vector<std::uint8_t>{0x12, 0x7F}); // 127 bytes that are not there
    alert.writeInt32(7, entity.effect);
    write(alert, 10, entity.header, entity.headerLanguage);
    write(alert, 11, entity.description, "");
    ProtoWriter writer;
    writer.writeString(1, entity.id);
    writer.writeBytes(5, alert.bytes());
    return writer;
}

/// A whole message. `timestamp` 0 is left out.
inline std::shared_ptr<NSData> alertMessage(std::uint64_t timestamp,
                                            const std::vector<AlertEntity>& entities = {}) {
    ProtoWriter header;
    header.writeString(1, "2.0");
    if (timestamp != 0)
        header.writeUInt64(3, timestamp);
    ProtoWriter message;
    message.writeBytes(1, header.bytes());
    for (const auto& entity : entities)
        message.writeBytes(2, encode(entity).bytes());
    return NSData::dataWithBytes(message.bytes());
}

} // namespace orvo::testing
