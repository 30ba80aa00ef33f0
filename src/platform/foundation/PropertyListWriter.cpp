#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"
#include "platform/foundation/Text.h"

#include <algorithm>
#include <bit>
#include <fmt/format.h>
#include <optional>
#include <unordered_map>
#include <utility>
#include <vector>

namespace orvo::PropertyList {

namespace {

using Number = std::size_t; ///< of an object, from 0

void appendBigEndian(std::string& bytes, std::uint64_t value, std::size_t width) {
    for (std::size_t i = width; i-- > 0;)
        bytes.push_back(static_cast<char>(value >> (8 * i) & 0xFFU));
}

/// The least power of two of bytes that holds `value`, as its exponent.
unsigned widthExponent(std::uint64_t value) {
    if (value <= 0xFF)
        return 0;
    if (value <= 0xFFFF)
        return 1;
    return value <= 0xFFFFFFFF ? 2 : 3;
}

void appendUnsigned(std::string& bytes, std::uint64_t value) {
    const auto exponent = widthExponent(value);
    if (value >> 63U != 0) { // as eight bytes it would read as negative
        bytes.push_back(0x14);
        appendBigEndian(bytes, 0, 8);
        appendBigEndian(bytes, value, 8);
        return;
    }
    bytes.push_back(static_cast<char>(0x10U | exponent));
    appendBigEndian(bytes, value, std::size_t{1} << exponent);
}

void appendHead(std::string& bytes, unsigned kind, std::size_t count) {
    bytes.push_back(static_cast<char>(kind << 4U | std::min<std::size_t>(count, 0xF)));
    if (count >= 0xF)
        appendUnsigned(bytes, count);
}

std::string encodedText(std::string_view text) {
    std::string bytes;
    if (std::ranges::all_of(text, [](char c) { return static_cast<unsigned char>(c) < 0x80; })) {
        appendHead(bytes, 0x5, text.size());
        return bytes.append(text);
    }
    const auto units = Text::utf16(text);
    appendHead(bytes, 0x6, units.size());
    for (const auto unit : units)
        appendBigEndian(bytes, unit, 2);
    return bytes;
}

std::string encodedNumber(const NSNumber& number) {
    std::string bytes;
    if (const auto* flag = std::get_if<bool>(&number.value())) {
        bytes.push_back(*flag ? 0x09 : 0x08);
    } else if (const auto* real = std::get_if<double>(&number.value())) {
        bytes.push_back(0x23);
        appendBigEndian(bytes, std::bit_cast<std::uint64_t>(*real), 8);
    } else if (const auto* whole = std::get_if<std::int64_t>(&number.value());
               whole && *whole < 0) {
        bytes.push_back(0x13);
        appendBigEndian(bytes, static_cast<std::uint64_t>(*whole), 8);
    } else {
        appendUnsigned(bytes, number.unsignedIntegerValue());
    }
    return bytes;
}

std::string encodedData(const NSData& data) {
    std::string bytes;
    appendHead(bytes, 0x4, data.length());
    return bytes.append(data.stringView());
}

std::string encodedDate(const NSDate& date) {
    std::string bytes(1, '\x33');
    appendBigEndian(bytes, std::bit_cast<std::uint64_t>(date.timeIntervalSinceReferenceDate()), 8);
    return bytes;
}

std::string encodedUID(const PropertyListUID& uid) {
    const auto width = std::size_t{1} << widthExponent(uid.value());
    std::string bytes(1, static_cast<char>(0x80U | (width - 1)));
    appendBigEndian(bytes, uid.value(), width);
    return bytes;
}

std::optional<std::string> encodedScalar(const NSObject& object) {
    if (const auto* text = dynamic_cast<const NSString*>(&object))
        return encodedText(text->utf8());
    if (const auto* number = dynamic_cast<const NSNumber*>(&object))
        return encodedNumber(*number);
    if (const auto* data = dynamic_cast<const NSData*>(&object))
        return encodedData(*data);
    if (const auto* date = dynamic_cast<const NSDate*>(&object))
        return encodedDate(*date);
    if (const auto* uid = dynamic_cast<const PropertyListUID*>(&object))
        return encodedUID(*uid);
    return std::nullopt;
}

/// Numbers all objects first, since the width of a number depends on how many there are.
class Writer {
public:
    std::shared_ptr<NSData> write(const NSObject& root);
    [[nodiscard]] const std::shared_ptr<NSError>& error() const noexcept { return _error; }

private:
    struct Node {
        const std::string* scalar = nullptr; ///< whole; nil for a container
        unsigned kind = 0;
        std::size_t count = 0;
        std::vector<Number> parts; ///< of a dictionary the keys, then the values
    };

    void fail(ErrorCode code, const std::string& what);
    std::optional<Number> add(const NSObject& object, std::size_t level);
    Number addScalar(std::string bytes);
    std::optional<Number> addArray(const NSArray& array, std::size_t level);
    std::optional<Number> addDictionary(const NSDictionary& dictionary, std::size_t level);
    bool addParts(Number whole, const std::vector<const NSObject*>& parts, std::size_t level);
    [[nodiscard]] std::string assembled() const;

    std::vector<Node> _nodes;
    std::unordered_map<std::string, Number> _scalars; ///< by their bytes, which tell kinds apart
    std::size_t _unfolded = 0;
    std::size_t _keyBytes = 0;
    std::shared_ptr<NSError> _error;
};

void Writer::fail(ErrorCode code, const std::string& what) {
    if (!_error)
        _error = NSError::errorWithMessage(
            ErrorDomain, static_cast<std::int64_t>(code), "property list: " + what);
}

std::shared_ptr<NSData> Writer::write(const NSObject& root) {
    if (!add(root, 1))
        return nullptr;
    auto bytes = assembled();
    if (_keyBytes > maximumKeyBytes(bytes.size())) {
        fail(ErrorCode::TooLarge, "long keys stand at too many places");
        return nullptr;
    }
    return NSData::dataWithString(bytes);
}

std::optional<Number> Writer::add(const NSObject& object, std::size_t level) {
    if (level > MaximumDepth) {
        fail(ErrorCode::TooDeep, "nested too deep");
        return std::nullopt;
    }
    if (++_unfolded > MaximumObjects) {
        fail(ErrorCode::TooLarge, fmt::format("more than {} objects", MaximumObjects));
        return std::nullopt;
    }
    if (auto bytes = encodedScalar(object))
        return addScalar(*std::move(bytes));
    if (const auto* array = dynamic_cast<const NSArray*>(&object))
        return addArray(*array, level);
    if (const auto* dictionary = dynamic_cast<const NSDictionary*>(&object))
        return addDictionary(*dictionary, level);
    fail(ErrorCode::Unsupported,
         fmt::format("an object of class {} has no place in it", object.className()));
    return std::nullopt;
}

Number Writer::addScalar(std::string bytes) {
    const auto [entry, isNew] = _scalars.try_emplace(std::move(bytes), _nodes.size());
    if (isNew)
        _nodes.push_back({&entry->first, 0, 0, {}});
    return entry->second;
}

bool Writer::addParts(Number whole, const std::vector<const NSObject*>& parts, std::size_t level) {
    std::vector<Number> numbers;
    numbers.reserve(parts.size());
    for (const auto* part : parts) {
        const auto number = add(*part, level + 1);
        if (!number)
            return false;
        numbers.push_back(*number);
    }
    _nodes[whole].parts = std::move(numbers);
    return true;
}

std::optional<Number> Writer::addArray(const NSArray& array, std::size_t level) {
    const auto number = _nodes.size();
    _nodes.push_back({nullptr, 0xA, array.count(), {}});
    std::vector<const NSObject*> parts;
    parts.reserve(array.count());
    for (const auto& element : array.elements())
        parts.push_back(element.get());
    return addParts(number, parts, level) ? std::optional(number) : std::nullopt;
}

std::optional<Number> Writer::addDictionary(const NSDictionary& dictionary, std::size_t level) {
    const auto number = _nodes.size();
    _nodes.push_back({nullptr, 0xD, dictionary.count(), {}});
    std::vector<const NSObject*> parts;
    parts.reserve(2 * dictionary.count());
    for (const auto& [key, value] : dictionary.entries()) {
        const auto* text = dynamic_cast<const NSString*>(key.get());
        if (!text) {
            fail(ErrorCode::Unsupported,
                 fmt::format("a key of class {} is no text", key->className()));
            return std::nullopt;
        }
        _keyBytes += text->utf8().size();
        parts.push_back(text);
    }
    for (const auto& [key, value] : dictionary.entries())
        parts.push_back(value.get());
    return addParts(number, parts, level) ? std::optional(number) : std::nullopt;
}

std::string Writer::assembled() const {
    const std::size_t referenceSize = std::size_t{1} << widthExponent(_nodes.size() - 1);
    std::string bytes = "bplist00";
    std::vector<std::size_t> offsets;
    offsets.reserve(_nodes.size());
    for (const auto& node : _nodes) {
        offsets.push_back(bytes.size());
        if (node.scalar) {
            bytes += *node.scalar;
            continue;
        }
        appendHead(bytes, node.kind, node.count);
        for (const auto part : node.parts)
            appendBigEndian(bytes, part, referenceSize);
    }
    const auto tableOffset = bytes.size();
    const std::size_t offsetSize = std::size_t{1} << widthExponent(tableOffset);
    for (const auto offset : offsets)
        appendBigEndian(bytes, offset, offsetSize);
    bytes.append(6, '\0');
    appendBigEndian(bytes, offsetSize, 1);
    appendBigEndian(bytes, referenceSize, 1);
    appendBigEndian(bytes, _nodes.size(), 8);
    appendBigEndian(bytes, 0, 8); // the root's number
    appendBigEndian(bytes, tableOffset, 8);
    return bytes;
}

} // namespace

std::shared_ptr<NSData> write(const NSObject& root, std::shared_ptr<NSError>* error) {
    Writer writer;
    auto data = writer.write(root);
    if (error)
        *error = writer.error();
    return data;
}

} // namespace orvo::PropertyList
