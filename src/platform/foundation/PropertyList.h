#pragma once

#include "platform/foundation/NSData.h"
#include "platform/foundation/NSError.h"
#include "platform/foundation/NSObject.h"
#include "platform/foundation/PropertyListUID.h"

#include <span>

/// The binary property list format ("bplist00"): `NSString`, `NSNumber`, `NSData`, `NSDate`,
/// `NSArray`, `NSDictionary` with text keys, `PropertyListUID`. Both ways are bounded: reading
/// takes time and memory in proportion to the bytes given, whatever they claim, and no recursion
/// deeper than `MaximumDepth`. Any thread.
namespace orvo::PropertyList {

inline constexpr const char* ErrorDomain = "OrvoPropertyListErrorDomain";
/// User-info key of a reading error: the offset at which it was found, an `NSNumber`.
inline constexpr const char* ByteOffsetErrorKey = "OrvoPropertyListByteOffset";
enum class ErrorCode : std::int64_t {
    NotBinaryPropertyList = 1, ///< no header or trailer
    Corrupt = 2,               ///< lengths, offsets or references lead outside the bytes
    TooDeep = 3,
    TooLarge = 4, ///< shared objects would unfold beyond `MaximumObjects` or `maximumKeyBytes`
    Cyclic = 5,
    Unsupported = 6, ///< a kind of object that is none of those above
};
/// Levels, the root's and the innermost object's included.
inline constexpr std::size_t MaximumDepth = 512;
/// Objects, each counted once for every place at which it stands.
inline constexpr std::size_t MaximumObjects = 1'000'000;
/// Bytes of all dictionary keys of a list of `size` bytes, each counted once for every place.
[[nodiscard]] constexpr std::size_t maximumKeyBytes(std::size_t size) noexcept {
    return (std::size_t{1} << 20) + 256 * size;
}

/// Equal scalars are written once. The same content gives the same bytes. Text that is not valid
/// UTF-8 is written with U+FFFD for each bad sequence.
/// Nil, with an error, for an object (at any depth) that the format cannot hold, or more than the
/// limits above: what is written can be read.
[[nodiscard]] std::shared_ptr<NSData> write(const NSObject& root,
                                            std::shared_ptr<NSError>* error = nullptr);

/// Nil, with an error that says what is wrong and where (byte offset), for anything but a whole,
/// well-formed list. An object that stands at several places is one object. Unpaired surrogates in
/// text are read as U+FFFD; a key that a dictionary has twice keeps the later value.
[[nodiscard]] std::shared_ptr<NSObject> read(std::span<const std::uint8_t> bytes,
                                             std::shared_ptr<NSError>* error = nullptr);

} // namespace orvo::PropertyList
