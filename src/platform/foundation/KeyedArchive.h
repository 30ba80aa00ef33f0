#pragma once

#include "platform/foundation/NSError.h"

#include <cstddef>
#include <cstdint>
#include <string>

namespace orvo {

/// The key under which an archive of one object has it.
inline constexpr const char* NSKeyedArchiveRootObjectKey = "root";

/// What the writer and the reader of keyed archives agree on.
namespace KeyedArchive {

inline constexpr const char* ArchiverKey = "$archiver";
inline constexpr const char* ArchiverName = "NSKeyedArchiver";
inline constexpr const char* VersionKey = "$version";
inline constexpr std::int64_t Version = 100000;
inline constexpr const char* TopKey = "$top";
inline constexpr const char* ObjectsKey = "$objects";
/// The first of all objects, which stands for nil.
inline constexpr const char* Nil = "$null";
inline constexpr const char* ClassKey = "$class";
inline constexpr const char* ClassNameKey = "$classname";
inline constexpr const char* ClassesKey = "$classes";

/// Objects within objects.
inline constexpr std::size_t MaximumDepth = 256;
/// Objects, each counted once for every place at which it stands.
inline constexpr std::size_t MaximumObjects = 1'000'000;

/// How far an object reaches, with all that it holds.
struct Extent {
    std::size_t height = 1;
    std::size_t objects = 1;
    std::size_t bytes = 0; ///< of texts and data

    /// Includes a part; false when that goes beyond the limits.
    bool include(const Extent& part) noexcept;
};

/// The key as an object's dictionary has it: one of its own keys never looks like the archive's.
[[nodiscard]] std::string escapedKey(const std::string& key);

/// Of `NSCocoaErrorDomain`. `underlying` may be nil.
[[nodiscard]] std::shared_ptr<NSError> error(std::int64_t code,
                                             const std::string& what,
                                             const std::shared_ptr<NSError>& underlying = nullptr);

} // namespace KeyedArchive

} // namespace orvo
