#pragma once

#include "platform/foundation/NSData.h"

#include <cstdint>
#include <initializer_list>
#include <string>
#include <string_view>
#include <vector>

namespace orvo::testing {

/// Writes protobuf fields by hand, right ones and wrong ones.
class Wire {
public:
    Wire& number(std::uint32_t field, std::uint64_t value) {
        varint(field << 3U);
        varint(value);
        return *this;
    }
    Wire& bytes(std::uint32_t field, std::string_view value) {
        varint((field << 3U) | 2U);
        varint(value.size());
        _bytes += value;
        return *this;
    }
    Wire& bytes(std::uint32_t field, const Wire& value) { return bytes(field, value._bytes); }
    Wire& key(std::uint32_t field, std::uint32_t type) {
        varint((field << 3U) | type);
        return *this;
    }
    /// Empty, in an old form that no field of a feed has.
    Wire& group(std::uint32_t field) { return key(field, 3).key(field, 4); }
    Wire& raw(std::string_view bytes) {
        _bytes += bytes;
        return *this;
    }
    Wire& varint(std::uint64_t value) {
        for (; value >= 0x80; value >>= 7U)
            _bytes += static_cast<char>((value & 0x7FU) | 0x80U);
        _bytes += static_cast<char>(value);
        return *this;
    }

    [[nodiscard]] const std::string& str() const { return _bytes; }

private:
    std::string _bytes;
};

struct Translation {
    std::string text;
    std::string language;
};

inline Wire translated(const std::vector<Translation>& translations) {
    Wire wire;
    for (const Translation& translation : translations) {
        Wire inner;
        inner.bytes(1, translation.text);
        if (!translation.language.empty())
            inner.bytes(2, translation.language);
        wire.bytes(1, inner);
    }
    return wire;
}

inline Wire period(std::uint64_t start, std::uint64_t end) {
    Wire wire;
    if (start > 0)
        wire.number(1, start);
    if (end > 0)
        wire.number(2, end);
    return wire;
}

inline Wire route(std::string_view id) {
    return Wire().bytes(2, id);
}

/// An alert to be changed in one thing: route R1, header and description in English, a detour.
class AlertMaker {
public:
    std::string id = "1";
    std::vector<Wire> selectors = {route("R1")};
    std::vector<Wire> activePeriods;
    std::vector<Wire> communicationPeriods;
    std::vector<Wire> impactPeriods;
    std::uint64_t cause = 0; // 0: absent
    std::uint64_t effect = 4;
    std::uint64_t severity = 0;
    std::vector<Translation> header = {{"Trams turn early", "en"}};
    std::vector<Translation> description = {{"No trams beyond the bridge.", "en"}};
    std::vector<Translation> spokenHeader;
    std::vector<Translation> link;
    Wire more; // further fields of the alert

    [[nodiscard]] Wire alert() const {
        Wire wire;
        for (const Wire& period : activePeriods)
            wire.bytes(1, period);
        for (const Wire& period : communicationPeriods)
            wire.bytes(2, period);
        for (const Wire& period : impactPeriods)
            wire.bytes(3, period);
        for (const Wire& selector : selectors)
            wire.bytes(5, selector);
        if (cause > 0)
            wire.number(6, cause);
        if (effect > 0)
            wire.number(7, effect);
        addText(wire, 8, link);
        addText(wire, 10, header);
        addText(wire, 11, description);
        addText(wire, 12, spokenHeader);
        if (severity > 0)
            wire.number(14, severity);
        return wire.raw(more.str());
    }
    [[nodiscard]] Wire entity() const {
        Wire wire;
        wire.bytes(1, id);
        return wire.bytes(5, alert());
    }

private:
    static void addText(Wire& wire, std::uint32_t field, const std::vector<Translation>& texts) {
        if (!texts.empty())
            wire.bytes(field, translated(texts));
    }
};

inline Wire header(std::uint64_t timestamp) {
    Wire wire;
    wire.bytes(1, "2.0").number(2, 0);
    if (timestamp > 0)
        wire.number(3, timestamp);
    return wire;
}

inline std::string message(const std::vector<Wire>& entities,
                           std::uint64_t timestamp = 1750000000) {
    Wire wire;
    wire.bytes(1, header(timestamp));
    for (const Wire& entity : entities)
        wire.bytes(2, entity);
    return wire.str();
}

inline std::string message(const std::vector<AlertMaker>& alerts,
                           std::uint64_t timestamp = 1750000000) {
    std::vector<Wire> entities;
    for (const AlertMaker& alert : alerts)
        entities.push_back(alert.entity());
    return message(entities, timestamp);
}

} // namespace orvo::testing
