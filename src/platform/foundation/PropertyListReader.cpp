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
#include <limits>
#include <optional>
#include <string_view>
#include <vector>

namespace orvo::PropertyList {

namespace {

constexpr std::string_view Magic = "bplist00";
constexpr std::size_t TrailerSize = 32;

/// The layout: header, objects one after another, the table of their offsets, trailer. An object
/// is a byte of kind and length, then its bytes, or for a container the numbers of its parts.
class Reader {
public:
    explicit Reader(std::span<const std::uint8_t> bytes)
        : _bytes(bytes) {}

    std::shared_ptr<NSObject> read();
    [[nodiscard]] const std::shared_ptr<NSError>& error() const noexcept { return _error; }

private:
    /// What is known of the object of one number.
    struct Slot {
        std::shared_ptr<NSObject> object;
        std::size_t height = 1;   ///< levels from here down
        std::size_t unfolded = 1; ///< objects from here down, each for every place where it stands
        bool isOpen = false;      ///< being read: meeting it again is a circle
    };
    /// An object without its content.
    struct Head {
        std::size_t offset;  ///< of the object
        unsigned kind;       ///< upper half of the first byte
        unsigned low;        ///< lower half
        std::size_t count;   ///< bytes, units or parts
        std::size_t content; ///< offset
    };

    std::nullptr_t fail(ErrorCode code, std::size_t offset, const std::string& what);
    bool readTrailer();
    bool checkOffsets();
    [[nodiscard]] std::uint64_t bigEndian(std::size_t offset, std::size_t length) const;
    bool take(std::size_t offset, std::size_t count, std::size_t unit);
    std::optional<Head> readHead(std::size_t offset);
    const Slot* readObject(std::uint64_t number, std::size_t level, std::size_t from);
    std::shared_ptr<NSObject> readContent(const Head& head, Slot& slot, std::size_t level);
    std::shared_ptr<NSObject> readSimple(const Head& head);
    std::shared_ptr<NSObject> readInteger(const Head& head);
    std::shared_ptr<NSObject> readReal(const Head& head);
    std::shared_ptr<NSObject> readDate(const Head& head);
    std::shared_ptr<NSObject> readData(const Head& head);
    std::shared_ptr<NSObject> readASCII(const Head& head);
    std::shared_ptr<NSObject> readUTF16(const Head& head);
    std::shared_ptr<NSObject> readUID(const Head& head);
    std::shared_ptr<NSObject> readArray(const Head& head, Slot& slot, std::size_t level);
    std::shared_ptr<NSObject> readDictionary(const Head& head, Slot& slot, std::size_t level);
    std::shared_ptr<NSObject>
    readPart(const Head& head, std::size_t part, Slot& whole, std::size_t level);

    std::span<const std::uint8_t> _bytes;
    std::size_t _offsetSize = 0;
    std::size_t _referenceSize = 0;
    std::uint64_t _rootNumber = 0;
    std::size_t _tableOffset = 0; ///< objects end here
    std::vector<Slot> _slots;
    /// Objects that lie over one another could make much out of few bytes; read together they may
    /// take as many bytes as there are.
    std::size_t _bytesLeft = 0;
    std::size_t _keyBytes = 0;
    std::shared_ptr<NSError> _error;
};

std::nullptr_t Reader::fail(ErrorCode code, std::size_t offset, const std::string& what) {
    if (!_error)
        _error = NSError::errorWithDomain_code_userInfo(
            ErrorDomain,
            static_cast<std::int64_t>(code),
            NSDictionary::dictionaryWithTextKeys(
                {{NSLocalizedDescriptionKey,
                  NSString::string(fmt::format("property list, byte {}: {}", offset, what))},
                 {ByteOffsetErrorKey, NSNumber::numberWithUnsignedInteger(offset)}}));
    return nullptr;
}

std::uint64_t Reader::bigEndian(std::size_t offset, std::size_t length) const {
    std::uint64_t value = 0;
    for (const auto byte : _bytes.subspan(offset, length))
        value = value << 8 | byte;
    return value;
}

std::shared_ptr<NSObject> Reader::read() {
    if (!readTrailer() || !checkOffsets())
        return nullptr;
    _bytesLeft = _bytes.size();
    const auto* root = readObject(_rootNumber, 1, _bytes.size() - TrailerSize);
    return root ? root->object : nullptr;
}

bool Reader::readTrailer() {
    if (_bytes.size() < Magic.size() ||
        !std::equal(Magic.begin(), Magic.end(), _bytes.begin(), [](char a, std::uint8_t b) {
            return static_cast<std::uint8_t>(a) == b;
        })) {
        fail(ErrorCode::NotBinaryPropertyList, 0, "the header bplist00 is missing");
        return false;
    }
    if (_bytes.size() < Magic.size() + TrailerSize) {
        fail(ErrorCode::NotBinaryPropertyList, _bytes.size(), "too short to hold a trailer");
        return false;
    }
    const auto trailer = _bytes.size() - TrailerSize;
    _offsetSize = _bytes[trailer + 6]; // five bytes unused, one that says how keys are sorted
    _referenceSize = _bytes[trailer + 7];
    const auto count = bigEndian(trailer + 8, 8);
    _rootNumber = bigEndian(trailer + 16, 8);
    const auto tableOffset = bigEndian(trailer + 24, 8);
    if (_offsetSize < 1 || _offsetSize > 8 || _referenceSize < 1 || _referenceSize > 8) {
        fail(ErrorCode::Corrupt, trailer + 6, "offsets or references of an impossible width");
        return false;
    }
    if (tableOffset < Magic.size() || tableOffset > trailer ||
        count != (trailer - tableOffset) / _offsetSize ||
        (trailer - tableOffset) % _offsetSize != 0) {
        fail(ErrorCode::Corrupt, trailer + 8, "the table of offsets does not fit");
        return false;
    }
    if (count > MaximumObjects) {
        fail(ErrorCode::TooLarge, trailer + 8, fmt::format("{} objects", count));
        return false;
    }
    _tableOffset = static_cast<std::size_t>(tableOffset);
    _slots.resize(static_cast<std::size_t>(count));
    return true;
}

bool Reader::checkOffsets() {
    for (std::size_t i = 0; i < _slots.size(); ++i) {
        const auto entry = _tableOffset + i * _offsetSize;
        const auto offset = bigEndian(entry, _offsetSize);
        if (offset < Magic.size() || offset >= _tableOffset) {
            fail(ErrorCode::Corrupt,
                 entry,
                 fmt::format("the offset {} of object {} leads outside", offset, i));
            return false;
        }
    }
    return true;
}

/// Whether `count` times `unit` bytes lie there; they count as read.
bool Reader::take(std::size_t offset, std::size_t count, std::size_t unit) {
    if (offset > _tableOffset || count > (_tableOffset - offset) / unit) {
        fail(ErrorCode::Corrupt, offset, "an object ends behind the last");
        return false;
    }
    if (count * unit > _bytesLeft) {
        fail(ErrorCode::TooLarge, offset, "too many objects lie over one another");
        return false;
    }
    _bytesLeft -= count * unit;
    return true;
}

std::optional<Reader::Head> Reader::readHead(std::size_t offset) {
    if (!take(offset, 1, 1))
        return std::nullopt;
    const unsigned first = _bytes[offset];
    Head head{offset, first >> 4U, first & 0xFU, first & 0xFU, offset + 1};
    const bool hasLength = head.kind >= 4 && head.kind != 8;
    if (!hasLength || head.low != 0xF)
        return head;
    // A longer length follows as a whole number of its own.
    if (!take(head.content, 1, 1))
        return std::nullopt;
    const unsigned marker = _bytes[head.content++];
    if (marker < 0x10 || marker > 0x13) {
        fail(ErrorCode::Corrupt, head.content - 1, "a length that is no number");
        return std::nullopt;
    }
    const std::size_t width = std::size_t{1} << (marker & 0xFU);
    if (!take(head.content, width, 1))
        return std::nullopt;
    head.count = static_cast<std::size_t>(bigEndian(head.content, width));
    head.content += width;
    return head;
}

const Reader::Slot* Reader::readObject(std::uint64_t number, std::size_t level, std::size_t from) {
    if (number >= _slots.size())
        return fail(ErrorCode::Corrupt, from, fmt::format("there is no object {}", number));
    auto& slot = _slots[static_cast<std::size_t>(number)];
    if (slot.object)
        return &slot;
    if (slot.isOpen)
        return fail(ErrorCode::Cyclic, from, fmt::format("object {} contains itself", number));
    if (level > MaximumDepth)
        return fail(ErrorCode::TooDeep, from, "nested too deep");
    const auto offset = static_cast<std::size_t>(
        bigEndian(_tableOffset + static_cast<std::size_t>(number) * _offsetSize, _offsetSize));
    const auto head = readHead(offset);
    if (!head)
        return nullptr;
    slot.isOpen = true;
    slot.object = readContent(*head, slot, level);
    slot.isOpen = false;
    return slot.object ? &slot : nullptr;
}

std::shared_ptr<NSObject> Reader::readContent(const Head& head, Slot& slot, std::size_t level) {
    switch (head.kind) {
    case 0x0:
        return readSimple(head);
    case 0x1:
        return readInteger(head);
    case 0x2:
        return readReal(head);
    case 0x3:
        return readDate(head);
    case 0x4:
        return readData(head);
    case 0x5:
        return readASCII(head);
    case 0x6:
        return readUTF16(head);
    case 0x8:
        return readUID(head);
    case 0xA:
        return readArray(head, slot, level);
    case 0xD:
        return readDictionary(head, slot, level);
    default:
        return fail(ErrorCode::Unsupported,
                    head.offset,
                    fmt::format("an object of unknown kind {:#04x}", head.kind << 4U | head.low));
    }
}

std::shared_ptr<NSObject> Reader::readSimple(const Head& head) {
    if (head.low == 8 || head.low == 9)
        return NSNumber::numberWithBool(head.low == 9);
    return fail(ErrorCode::Unsupported,
                head.offset,
                fmt::format("an object of unknown kind {:#04x}", head.low));
}

/// One, two and four bytes are unsigned, eight and sixteen signed.
std::shared_ptr<NSObject> Reader::readInteger(const Head& head) {
    if (head.low > 4)
        return fail(ErrorCode::Corrupt, head.offset, "a whole number of an impossible width");
    const std::size_t width = std::size_t{1} << head.low;
    if (!take(head.content, width, 1))
        return nullptr;
    if (width < 16)
        return NSNumber::numberWithInteger(
            static_cast<std::int64_t>(bigEndian(head.content, width)));
    const auto high = bigEndian(head.content, 8);
    const auto low = bigEndian(head.content + 8, 8);
    constexpr std::uint64_t signBit = std::uint64_t{1} << 63U;
    if (high == 0)
        return low < signBit ? NSNumber::numberWithInteger(static_cast<std::int64_t>(low))
                             : NSNumber::numberWithUnsignedInteger(low);
    if (high == std::numeric_limits<std::uint64_t>::max() && low >= signBit)
        return NSNumber::numberWithInteger(static_cast<std::int64_t>(low));
    return fail(ErrorCode::Unsupported, head.offset, "a whole number of more than 64 bits");
}

std::shared_ptr<NSObject> Reader::readReal(const Head& head) {
    if (head.low != 2 && head.low != 3)
        return fail(ErrorCode::Corrupt, head.offset, "a real number of an impossible width");
    const std::size_t width = std::size_t{1} << head.low;
    if (!take(head.content, width, 1))
        return nullptr;
    const auto bits = bigEndian(head.content, width);
    return NSNumber::numberWithDouble(
        width == 8 ? std::bit_cast<double>(bits)
                   : static_cast<double>(std::bit_cast<float>(static_cast<std::uint32_t>(bits))));
}

std::shared_ptr<NSObject> Reader::readDate(const Head& head) {
    if (head.low != 3)
        return fail(ErrorCode::Corrupt, head.offset, "a date of an impossible width");
    if (!take(head.content, 8, 1))
        return nullptr;
    return NSDate::dateWithTimeIntervalSinceReferenceDate(
        std::bit_cast<double>(bigEndian(head.content, 8)));
}

std::shared_ptr<NSObject> Reader::readData(const Head& head) {
    if (!take(head.content, head.count, 1))
        return nullptr;
    return NSData::dataWithBytes(_bytes.subspan(head.content, head.count));
}

std::shared_ptr<NSObject> Reader::readASCII(const Head& head) {
    if (!take(head.content, head.count, 1))
        return nullptr;
    const auto bytes = _bytes.subspan(head.content, head.count);
    if (std::ranges::any_of(bytes, [](std::uint8_t byte) { return byte >= 0x80; }))
        return fail(ErrorCode::Corrupt, head.offset, "text in ASCII that is not ASCII");
    return NSString::string(std::string(bytes.begin(), bytes.end()));
}

std::shared_ptr<NSObject> Reader::readUTF16(const Head& head) {
    if (!take(head.content, head.count, 2))
        return nullptr;
    std::u16string units(head.count, u'\0');
    for (std::size_t i = 0; i < units.size(); ++i)
        units[i] = static_cast<char16_t>(bigEndian(head.content + 2 * i, 2));
    return NSString::string(Text::utf8(units));
}

std::shared_ptr<NSObject> Reader::readUID(const Head& head) {
    const std::size_t width = head.low + 1;
    if (width > 8)
        return fail(ErrorCode::Corrupt, head.offset, "a reference of an impossible width");
    if (!take(head.content, width, 1))
        return nullptr;
    return PropertyListUID::uidWithValue(bigEndian(head.content, width));
}

/// The object at position `part` of a container's references; the container's size grows by it.
std::shared_ptr<NSObject>
Reader::readPart(const Head& head, std::size_t part, Slot& whole, std::size_t level) {
    const auto at = head.content + part * _referenceSize;
    const auto* slot = readObject(bigEndian(at, _referenceSize), level + 1, at);
    if (!slot)
        return nullptr;
    whole.height = std::max(whole.height, slot->height + 1);
    whole.unfolded += slot->unfolded;
    if (whole.height > MaximumDepth)
        return fail(ErrorCode::TooDeep, at, "nested too deep");
    if (whole.unfolded > MaximumObjects)
        return fail(ErrorCode::TooLarge,
                    at,
                    fmt::format("shared objects unfold to more than {} objects", MaximumObjects));
    return slot->object;
}

std::shared_ptr<NSObject> Reader::readArray(const Head& head, Slot& slot, std::size_t level) {
    if (!take(head.content, head.count, _referenceSize))
        return nullptr;
    NSArray::Elements elements;
    elements.reserve(head.count);
    for (std::size_t i = 0; i < head.count; ++i) {
        auto element = readPart(head, i, slot, level);
        if (!element)
            return nullptr;
        elements.push_back(std::move(element));
    }
    return NSArray::arrayWithObjects(std::move(elements));
}

std::shared_ptr<NSObject> Reader::readDictionary(const Head& head, Slot& slot, std::size_t level) {
    if (!take(head.content, head.count, 2 * _referenceSize))
        return nullptr;
    NSDictionary::Entries entries;
    entries.reserve(head.count);
    for (std::size_t i = 0; i < head.count; ++i) {
        auto key = readPart(head, i, slot, level);
        auto value = key ? readPart(head, head.count + i, slot, level) : nullptr;
        if (!value)
            return nullptr;
        const auto* text = dynamic_cast<const NSString*>(key.get());
        if (!text)
            return fail(ErrorCode::Unsupported, head.offset, "a key that is no text");
        _keyBytes += text->utf8().size();
        if (_keyBytes > maximumKeyBytes(_bytes.size()))
            return fail(ErrorCode::TooLarge, head.offset, "long keys stand at too many places");
        entries.emplace_back(std::move(key), std::move(value));
    }
    return NSDictionary::dictionaryWithEntries(std::move(entries));
}

} // namespace

std::shared_ptr<NSObject> read(std::span<const std::uint8_t> bytes,
                               std::shared_ptr<NSError>* error) {
    Reader reader(bytes);
    auto root = reader.read();
    if (error)
        *error = reader.error();
    return root;
}

} // namespace orvo::PropertyList
