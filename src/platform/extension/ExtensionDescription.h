#pragma once

#include "platform/foundation/NSError.h"

#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>

namespace orvo {

inline constexpr const char* ExtensionErrorDomain = "OrvoExtensionErrorDomain";
enum class ExtensionErrorCode : std::int64_t {
    NoDescription = 1,    ///< the description is missing or cannot be read
    WrongDescription = 2, ///< it is no description, or lacks an entry
    NoPrincipalClass = 3, ///< the program has no such class
};

/// What an extension says of itself: the file `Info.plist` among the resources of its bundle, a
/// property list in text form with one entry for each of these. A value.
struct ExtensionDescription {
    static constexpr const char* FileName = "Info.plist";

    std::string bundleIdentifier;        ///< `BundleIdentifier`
    std::string containingApplication;   ///< `ContainingApplication`, its identifier
    std::string displayName;             ///< `DisplayName`, which hosts show above it
    std::string principalClass;          ///< `NSExtensionPrincipalClass`
    std::optional<std::string> iconName; ///< `IconName`, a fixed image; may be left out

    /// Nothing, with an error that names the file and what is wrong in it, unless all is there.
    [[nodiscard]] static std::optional<ExtensionDescription> read(const std::filesystem::path& file,
                                                                  std::shared_ptr<NSError>* error);
};

} // namespace orvo
