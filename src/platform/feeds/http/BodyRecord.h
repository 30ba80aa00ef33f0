#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace orvo {

class NSObject;

/// What is known of a kept body. A value.
struct BodyRecord {
    std::string entityTag;    ///< ETag as it came; empty for none
    std::string lastModified; ///< Last-Modified as it came; empty for none
    double receivedAt = 0;    ///< when the bytes came, in seconds since 1970
    double validatedAt = 0;   ///< when they were last known to be current; at least `receivedAt`
    int validations = 0;      ///< how often, since they came
    std::uint64_t length = 0;
    std::uint64_t checksum = 0; ///< `stableHash()` of the bytes

    [[nodiscard]] bool hasValidator() const { return !entityTag.empty() || !lastModified.empty(); }
    /// Whether both speak of the same bytes.
    [[nodiscard]] bool hasBytesOf(const BodyRecord& other) const {
        return length == other.length && checksum == other.checksum;
    }

    /// A dictionary that a property list can hold.
    [[nodiscard]] std::shared_ptr<NSObject> propertyList() const;
    /// Nothing for what is no such dictionary, or one of another version.
    [[nodiscard]] static std::optional<BodyRecord> fromPropertyList(const NSObject* list);

    friend bool operator==(const BodyRecord&, const BodyRecord&) = default;
};

} // namespace orvo
